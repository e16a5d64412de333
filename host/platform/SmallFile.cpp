#include "host/platform/SmallFile.h"

#include <cerrno>
#include <thread>

#include <fcntl.h>
#include <unistd.h>

#include "host/platform/OrdinaryFile.h"
#include "host/platform/PartFile.h"
#include "host/platform/PrivateFolder.h"
#include "host/platform/SystemFailure.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
constexpr std::uintmax_t kLargest = std::uintmax_t{4} << 20;

bool isHeldByAnother()
{
    return errno == EAGAIN || errno == EACCES;
}

// The system would wait as long as the other program holds it; a lock that a server has forgotten is held for
// ever.
bool lockWithin(std::chrono::milliseconds patience, int descriptor)
{
    constexpr auto kBetweenTries = std::chrono::milliseconds(10);
    const auto end = std::chrono::steady_clock::now() + patience;
    while (!lockNow(descriptor))
    {
        if (!isHeldByAnother() || std::chrono::steady_clock::now() >= end)
            return false;
        std::this_thread::sleep_for(kBetweenTries);
    }
    return true;
}
} // namespace

FileLock::FileLock(const std::filesystem::path& file, std::chrono::milliseconds patience)
    : mFile(open(file.c_str(), O_RDWR | O_CREAT | O_CLOEXEC, kOwnersOnly))
{
    if (!mFile)
        mHeld = Failure{translated(L"the file {} cannot be opened: {}", file, systemFailure(errno).sentence)};
    else if (!lockWithin(patience, mFile.number()))
        mHeld = Failure{translated(L"the file {} cannot be locked: {}", file,
                                   isHeldByAnother() ? translated(L"another program holds it")
                                                     : systemFailure(errno).sentence)};
}

// Locks of this kind belong to the process: a child that an application has left behind does not hold them.
bool lockNow(int descriptor)
{
    int status = 0;
    do
    {
        struct flock whole = {};
        whole.l_type = F_WRLCK;
        whole.l_whence = SEEK_SET;
        status = fcntl(descriptor, F_SETLK, &whole);
    } while (status != 0 && errno == EINTR);
    return status == 0;
}

Result<std::optional<std::string>> readSmallFile(const std::filesystem::path& file)
{
    auto content = readOrdinaryFile(file, kLargest);
    if (content)
        return std::optional(*std::move(content));
    if (content.code() == kNothingThere)
        return std::optional<std::string>();
    return Failure{translated(L"The file {} cannot be read: {}.", file, content.sentence())};
}

std::string escaped(std::string_view text)
{
    std::string result;
    for (const char character : text)
        if (character == '\\')
            result += "\\\\";
        else if (character == '\t')
            result += "\\t";
        else if (character == '\n')
            result += "\\n";
        else
            result += character;
    return result;
}

std::string unescaped(std::string_view text)
{
    std::string result;
    for (std::size_t at = 0; at < text.size(); ++at)
        if (text[at] != '\\' || at + 1 == text.size())
            result += text[at];
        else if (const char code = text[++at]; code == 't' || code == 'n')
            result += code == 't' ? '\t' : '\n';
        else
            result += code;
    return result;
}

std::vector<std::string_view> linesOf(std::string_view text)
{
    std::vector<std::string_view> lines;
    for (std::size_t end = text.find('\n'); end != text.npos; end = text.find('\n'))
    {
        lines.push_back(text.substr(0, end));
        text.remove_prefix(end + 1);
    }
    return lines;
}

Result<> replaceSmallFile(const std::filesystem::path& file, std::string_view content)
{
    const auto replaced = replaceFile(file, content);
    return replaced ? replaced
                    : Failure{translated(L"The file {} cannot be written: {}.", file, replaced.sentence())};
}
} // namespace tessel
