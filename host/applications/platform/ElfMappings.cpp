#include "host/applications/platform/ElfMappings.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cstdint>
#include <string>
#include <string_view>

#include <fcntl.h>
#include <sys/ioctl.h>
#include <sys/sysmacros.h>
#include <unistd.h>

#include "host/platform/Descriptor.h"

namespace tessel
{
namespace
{
constexpr char kList[] = "/proc/self/maps";
constexpr std::size_t kPiece = 1024; // some ten entries, of which each costs the system its time

// A question about one address, and its answer, as the system lays them out.
struct Question
{
    std::uint64_t size = sizeof(Question);
    std::uint64_t flags = 0;
    std::uint64_t address = 0;
    std::uint64_t first = 0;
    std::uint64_t end = 0;
    std::uint64_t protection = 0;
    std::uint64_t pageSize = 0;
    std::uint64_t offset = 0;
    std::uint64_t inode = 0;
    std::uint32_t deviceMajor = 0;
    std::uint32_t deviceMinor = 0;
    std::uint32_t nameSize = 0;
    std::uint32_t buildSize = 0;
    std::uint64_t name = 0;
    std::uint64_t build = 0;
};
static_assert(sizeof(Question) == 104);
constexpr unsigned long kAsk = _IOWR('f', 17, Question);

// The list, for asking. It stays open, since opening it costs ten times as much as a question, and it goes on
// telling of the process that opened it: a fork opens its own.
int listToAsk()
{
    static Descriptor list(-1);
    static pid_t opener = 0;
    const pid_t process = getpid();
    if (!list || opener != process)
        list = Descriptor(open(kList, O_RDONLY | O_CLOEXEC));
    opener = process;
    return list.number();
}

// The list, line by line, and read no farther than it is asked for: of thousands of libraries the one that
// was mapped last mostly stands before the others.
class Mappings
{
public:
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
        const ssize_t length = read(mList.number(), buffer.data(), buffer.size());
        if (length > 0)
            mText.append(buffer.data(), static_cast<std::size_t>(length));
        return length > 0;
    }

    Descriptor mList{open(kList, O_RDONLY | O_CLOEXEC)};
    std::string mText;
};

// Takes the number in front, and the one character after it.
template <class Number>
Number take(std::string_view& text, int base)
{
    Number number = 0;
    const char* end = std::from_chars(text.data(), text.data() + text.size(), number, base).ptr;
    text.remove_prefix(std::min(text.size(), static_cast<std::size_t>(end - text.data()) + 1));
    return number;
}

// "55d0c0-55d0c4 r--p 00000000 fd:01 1234 /a/file": the file, if the address lies in there.
std::optional<FileIdentity> fileIn(std::string_view line, std::uintptr_t address)
{
    constexpr int kHexadecimal = 16;
    constexpr int kDecimal = 10;
    constexpr std::size_t kProtection = sizeof "r--p";
    const auto first = take<std::uintptr_t>(line, kHexadecimal);
    const auto end = take<std::uintptr_t>(line, kHexadecimal);
    if (address < first || address >= end || line.size() < kProtection)
        return std::nullopt;
    line.remove_prefix(kProtection);
    take<std::uint64_t>(line, kHexadecimal); // where in the file
    const auto deviceMajor = take<unsigned>(line, kHexadecimal);
    const auto deviceMinor = take<unsigned>(line, kHexadecimal);
    return FileIdentity{makedev(deviceMajor, deviceMinor), take<ino_t>(line, kDecimal)};
}
} // namespace

std::optional<FileIdentity> fileMappedAt(const void* address)
{
    const auto asked = fileAskedFor(address);
    return asked ? asked : fileListedFor(address);
}

std::optional<FileIdentity> fileAskedFor(const void* address)
{
    Question question;
    question.address = reinterpret_cast<std::uintptr_t>(address);
    if (ioctl(listToAsk(), kAsk, &question) != 0)
        return std::nullopt;
    return FileIdentity{makedev(question.deviceMajor, question.deviceMinor), question.inode};
}

std::optional<FileIdentity> fileListedFor(const void* address)
{
    Mappings mappings;
    while (const auto line = mappings.next())
        if (const auto file = fileIn(*line, reinterpret_cast<std::uintptr_t>(address)))
            return file;
    return std::nullopt;
}
} // namespace tessel
