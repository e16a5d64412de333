#include "host/applications/platform/MappedImage.h"

#include <cstddef>

#include <sys/mman.h>

#include "host/applications/platform/ElfLinkMap.h"
#include "host/applications/platform/ElfMappings.h"

namespace tessel
{
namespace
{
constexpr std::size_t kPage = 4096;

// The first page of a file, in memory.
class MappedPage
{
public:
    explicit MappedPage(int descriptor) : mPage(mmap(nullptr, kPage, PROT_READ, MAP_PRIVATE, descriptor, 0))
    {
    }
    ~MappedPage()
    {
        if (mPage != MAP_FAILED)
            munmap(mPage, kPage);
    }
    MappedPage(const MappedPage&) = delete;
    MappedPage& operator=(const MappedPage&) = delete;

    std::optional<FileIdentity> file() const
    {
        return mPage == MAP_FAILED ? std::nullopt : fileMappedAt(mPage);
    }

private:
    void* mPage;
};
} // namespace

// Where mappings and files name their devices differently, a page of the file shows how a mapping of it is
// named.
bool isMappedFrom(void* library, const RegularFile& file)
{
    const link_map* map = linkMapOf(library);
    const auto ofLibrary = map ? fileMappedAt(map->l_ld) : std::nullopt;
    if (!ofLibrary || *ofLibrary == file.identity())
        return true;
    const auto ofPage = MappedPage(file.descriptor()).file();
    return !ofPage || *ofPage == *ofLibrary;
}

const void* addressIn(void* library)
{
    const link_map* map = linkMapOf(library);
    return map ? map->l_ld : nullptr;
}

// The way of those that unwind the stack: it takes no longer among ten thousand libraries.
bool isInLibrary(const void* address)
{
    dl_find_object found = {};
    return _dl_find_object(const_cast<void*>(address), &found) == 0;
}
} // namespace tessel
