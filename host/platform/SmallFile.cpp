#include "host/platform/SmallFile.h"

#include <cerrno>
#include <cstdio>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr mode_t kOwnersOnly = 0600;
constexpr off_t kLargest = off_t{4} << 20;

class Descriptor
{
public:
    Descriptor(const std::filesystem::path& file, int flags)
        : mNumber(open(file.c_str(), flags | O_CLOEXEC | O_NOFOLLOW | O_NONBLOCK, kOwnersOnly))
    {
    }
    ~Descriptor()
    {
        if (mNumber >= 0)
            close(mNumber);
    }
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;

    int number() const { return mNumber; }

private:
    int mNumber;
};

Failure failed(const std::filesystem::path& file, const wchar_t* what, int error)
{
    return {L"The file " + toWide(file.string()) + what + toWide(std::generic_category().message(error)) +
            L"."};
}

// Locks of this kind belong to the process: a child that an application has left behind does not hold them.
bool lock(int descriptor, int command)
{
    struct flock whole = {};
    whole.l_type = F_WRLCK;
    whole.l_whence = SEEK_SET;
    int status = 0;
    do
        status = fcntl(descriptor, command, &whole);
    while (status != 0 && errno == EINTR);
    return status == 0;
}

bool writeAll(int descriptor, std::string_view content)
{
    while (!content.empty())
    {
        const ssize_t count = write(descriptor, content.data(), content.size());
        if (count < 0 && errno != EINTR)
            return false;
        content.remove_prefix(count < 0 ? 0 : static_cast<std::size_t>(count));
    }
    return fsync(descriptor) == 0;
}
} // namespace

FileLock::FileLock(const std::filesystem::path& file)
    : mDescriptor(open(file.c_str(), O_RDWR | O_CREAT | O_CLOEXEC, kOwnersOnly))
{
    mHeld = mDescriptor >= 0 && lock(mDescriptor, F_SETLKW);
}

FileLock::~FileLock()
{
    if (mDescriptor >= 0)
        close(mDescriptor);
}

bool lockNow(int descriptor)
{
    return lock(descriptor, F_SETLK);
}

Result<std::optional<std::string>> readSmallFile(const std::filesystem::path& file)
{
    constexpr wchar_t kNotRead[] = L" cannot be read: ";
    const Descriptor descriptor(file, O_RDONLY);
    if (descriptor.number() < 0 && errno == ENOENT)
        return std::optional<std::string>();
    struct stat status = {};
    if (descriptor.number() < 0 || fstat(descriptor.number(), &status) != 0)
        return failed(file, kNotRead, errno);
    if (!S_ISREG(status.st_mode) || status.st_size > kLargest)
        return failed(file, kNotRead, EINVAL);
    std::string content(static_cast<std::size_t>(status.st_size), '\0');
    const ssize_t count = pread(descriptor.number(), content.data(), content.size(), 0);
    if (count < 0)
        return failed(file, kNotRead, errno);
    content.resize(static_cast<std::size_t>(count));
    return std::optional(content);
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
    constexpr wchar_t kNotWritten[] = L" cannot be written: ";
    const std::filesystem::path next = file.string() + ".new";
    unlink(next.c_str()); // of a session that came to its end in the middle of this
    const Descriptor descriptor(next, O_WRONLY | O_CREAT | O_EXCL);
    if (descriptor.number() < 0 || !writeAll(descriptor.number(), content) ||
        std::rename(next.c_str(), file.c_str()) != 0)
    {
        const int error = errno;
        unlink(next.c_str());
        return failed(file, kNotWritten, error);
    }
    return {};
}
} // namespace tessel
