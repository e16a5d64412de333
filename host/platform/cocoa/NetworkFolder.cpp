#include "host/platform/NetworkFolder.h"

#include <sys/mount.h>
#include <sys/param.h>

namespace tessel
{
bool isOnNetwork(const std::string& folder)
{
    struct statfs system = {};
    return statfs(folder.c_str(), &system) == 0 && (system.f_flags & MNT_LOCAL) == 0;
}
} // namespace tessel
