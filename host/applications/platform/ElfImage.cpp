// The system's list of mappings names the file of each. Its devices are not always those that files answer
// (with layered file systems they are others), so a page of the file is mapped too, and the two entries
// compared.
#include "host/applications/platform/MappedImage.h"

#include <array>
#include <charconv>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include <fcntl.h>
#include <sys/mman.h>
#include <unistd.h>

#include "host/applications/platform/ElfLinkMap.h"

namespace tessel
{
namespace
{
constexpr std::size_t kPage = 4096;
constexpr std::size_t kPiece = 1024; // some ten entries, of which each costs the system its time

// The first page of a file, in memory.
class MappedPage
{
public:
    // In front of the address if there is room, so that both stand side by side in the list.
    MappedPage(int descriptor, std::uintptr_t after)
        : mPage(mmap(reinterpret_cast<void*>(after - kPage), kPage, PROT_READ, MAP_PRIVATE, descriptor, 0))
    {
    }
    ~MappedPage()
    {
        if (mPage != MAP_FAILED)
            munmap(mPage, kPage);
    }
    MappedPage(const MappedPage&) = delete;
    MappedPage& operator=(const MappedPage&) = delete;

    std::uintptr_t address() const
    {
        return mPage == MAP_FAILED ? 0 : reinterpret_cast<std::uintptr_t>(mPage);
    }

private:
    void* mPage;
};

// The list, line by line, and read no farther than it is asked for: of thousands of libraries the one that
// was mapped last stands before the others.
class Mappings
{
public:
    Mappings() : mDescriptor(open("/proc/self/maps", O_RDONLY | O_CLOEXEC)) {}
    ~Mappings()
    {
        if (mDescriptor >= 0)
            close(mDescriptor);
    }
    Mappings(const Mappings&) = delete;
    Mappings& operator=(const Mappings&) = delete;

    std::optional<std::string> next()
    {
        std::size_t end = mText.find('\n');
        while (end == mText.npos && readOn())
            end = mText.find('\n');
        if (end == mText.npos)
            return std::nullopt;
        std::string line = mText.substr(0, end);
        mText.erase(0, end + 1);
        return line;
    }

private:
    bool readOn()
    {
        std::array<char, kPiece> buffer = {};
        const ssize_t length = mDescriptor < 0 ? 0 : read(mDescriptor, buffer.data(), buffer.size());
        if (length > 0)
            mText.append(buffer.data(), static_cast<std::size_t>(length));
        return length > 0;
    }

    int mDescriptor;
    std::string mText;
};

// "55d0c0-55d0c4 r--p 00000000 fd:01 1234 /a/file": whether the address lies in it.
bool holds(std::string_view line, std::uintptr_t address)
{
    constexpr int kHexadecimal = 16;
    const char* end = line.data() + line.size();
    std::uintptr_t first = 0;
    std::uintptr_t last = 0;
    const auto start = std::from_chars(line.data(), end, first, kHexadecimal);
    if (start.ptr == end)
        return false;
    std::from_chars(start.ptr + 1, end, last, kHexadecimal);
    return first <= address && address < last;
}

// Device and inode, as they stand in the line.
std::string fileIn(const std::string& line)
{
    constexpr int kFieldsBefore = 3;
    constexpr int kFieldsTaken = 2;
    std::size_t start = 0;
    for (int field = 0; field < kFieldsBefore; ++field)
        start = line.find(' ', start) + 1;
    std::size_t end = start;
    for (int field = 0; field < kFieldsTaken; ++field)
        end = line.find(' ', end) + 1;
    return line.substr(start, end - start);
}
} // namespace

bool isMappedFrom(void* library, int descriptor)
{
    const link_map* map = linkMapOf(library);
    if (!map)
        return true;
    const auto address = reinterpret_cast<std::uintptr_t>(map->l_ld);
    const MappedPage page(descriptor, map->l_addr);
    std::string ofLibrary;
    std::string ofPage;
    Mappings mappings;
    for (auto line = mappings.next(); line && (ofLibrary.empty() || ofPage.empty()); line = mappings.next())
    {
        if (holds(*line, address))
            ofLibrary = fileIn(*line);
        if (holds(*line, page.address()))
            ofPage = fileIn(*line);
    }
    return ofLibrary.empty() || ofPage.empty() || ofLibrary == ofPage;
}
} // namespace tessel
