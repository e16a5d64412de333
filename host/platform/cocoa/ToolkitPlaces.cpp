#include "host/platform/ToolkitPlaces.h"

namespace tessel
{
// The system keeps what belongs to the program under the program's name.
std::string keepToolkitFilesIn(const std::string&)
{
    return {};
}
} // namespace tessel
