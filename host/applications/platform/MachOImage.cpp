#include "host/applications/platform/MappedImage.h"

#include <cstdint>

#include <dlfcn.h>
#include <libproc.h>
#include <mach-o/dyld.h>
#include <sys/proc_info.h>
#include <unistd.h>

#include "host/platform/RegularFile.h"

namespace tessel
{
namespace
{
// The header of the image that the handle stands for, or null.
const mach_header* headerOf(void* library)
{
    for (std::uint32_t index = _dyld_image_count(); index-- > 0;)
    {
        void* image = dlopen(_dyld_get_image_name(index), RTLD_NOLOAD | RTLD_LAZY);
        if (image)
            dlclose(image);
        if (image == library)
            return _dyld_get_image_header(index);
    }
    return nullptr;
}
} // namespace

bool isMappedFrom(void* library, const RegularFile& file)
{
    const auto address = reinterpret_cast<std::uint64_t>(headerOf(library));
    proc_regionwithpathinfo region = {};
    const int size = proc_pidinfo(getpid(), PROC_PIDREGIONPATHINFO, address, &region, sizeof region);
    if (address == 0 || size != static_cast<int>(sizeof region))
        return true;
    const vinfo_stat& mapped = region.prp_vip.vip_vi.vi_stat;
    return mapped.vst_ino == file.identity().inode &&
           mapped.vst_dev == static_cast<std::uint32_t>(file.identity().device);
}

const void* addressIn(void* library)
{
    return headerOf(library);
}

bool isInLibrary(const void* address)
{
    Dl_info found = {};
    return dladdr(address, &found) != 0;
}
} // namespace tessel
