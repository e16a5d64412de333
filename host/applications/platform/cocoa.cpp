#include "host/applications/platform/ObjectiveCRuntime.h"

namespace tessel
{
bool needsBundleLoading(const std::string&)
{
    return true;
}

bool mustStayMapped(void*)
{
    return false; // the system knows which images its runtime needs and keeps them itself
}

std::string firstUnresolvedFunction(void*)
{
    return {}; // the system resolves every function when it maps the image
}
} // namespace tessel
