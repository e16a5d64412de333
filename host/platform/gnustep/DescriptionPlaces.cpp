#include "host/platform/DescriptionPlaces.h"

namespace tessel
{
std::vector<std::string> descriptionPlaces()
{
    return {"Resources/Info-gnustep.plist", "Info-gnustep.plist", "Resources/Info.plist", "Info.plist"};
}
} // namespace tessel
