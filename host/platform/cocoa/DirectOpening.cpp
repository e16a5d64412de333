#include "host/platform/DirectOpening.h"

#include <array>
#include <utility>

#include <fcntl.h>
#include <sys/param.h>

namespace tessel
{
Descriptor openDirectly(const std::string& path, int flags)
{
    Descriptor file(open(path.c_str(), flags | O_NOFOLLOW_ANY));
    // Letters in another case lead there as well, and folders that are in two places.
    std::array<char, MAXPATHLEN> real = {};
    const bool isThatPath = file && fcntl(file.number(), F_GETPATH, real.data()) == 0 && path == real.data();
    return isThatPath ? std::move(file) : Descriptor(-1);
}
} // namespace tessel
