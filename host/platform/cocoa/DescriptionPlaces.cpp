#include "host/platform/DescriptionPlaces.h"

namespace tessel
{
std::vector<std::string> descriptionPlaces()
{
    return {"Contents/Info.plist", "Resources/Info.plist", "Info.plist"};
}
} // namespace tessel
