#include "host/console/TypedHistory.h"

#include <cerrno>
#include <cstdint>
#include <optional>
#include <string_view>

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

#include "host/platform/Descriptor.h"
#include "host/platform/OrdinaryFile.h"
#include "host/platform/PartFile.h"
#include "host/platform/PrivateFolder.h"
#include "host/platform/SystemFailure.h"
#include "host/text/Credentials.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

// The file is that of the line editor's library: a first line that names the format, then a line each, in
// which what would break it up stands as a backslash and three octal digits.
namespace tessel
{
namespace
{
constexpr auto kNotUsed = Sentence<2>(L"The history of typed lines, {}, is not used: {}.");
constexpr auto kNotWritten = Sentence<2>(L"The history of typed lines, {}, cannot be written: {}.");
constexpr std::string_view kFormat = "_HiStOrY_V2_";
constexpr std::uintmax_t kLargestHistory = std::uintmax_t{16} << 20;
// Shortened not at each start, but when half of it is of no use.
constexpr std::size_t kMostStoredLines = 2 * kMostHistoryLines;

bool isPlain(unsigned char byte)
{
    return byte > ' ' && byte != '\\' && byte != 0x7F;
}

std::string encodedLine(std::string_view line)
{
    std::string result;
    for (const char character : line)
    {
        const auto byte = static_cast<unsigned char>(character);
        if (isPlain(byte))
            result += character;
        else
            result += {'\\', static_cast<char>('0' + (byte >> 6)), static_cast<char>('0' + (byte >> 3 & 7)),
                       static_cast<char>('0' + (byte & 7))};
    }
    return result;
}

bool isOctal(char character)
{
    return character >= '0' && character <= '7';
}

// The byte that is written at the beginning of the text, or nothing.
std::optional<char> octalByte(std::string_view text)
{
    if (text.size() < 4 || text[0] != '\\' || !isOctal(text[1]) || !isOctal(text[2]) || !isOctal(text[3]))
        return std::nullopt;
    return static_cast<char>((text[1] - '0') << 6 | (text[2] - '0') << 3 | (text[3] - '0'));
}

std::string decodedLine(std::string_view line)
{
    std::string result;
    while (!line.empty())
    {
        const auto byte = octalByte(line);
        const bool isBackslash = line.starts_with("\\\\");
        result += byte ? *byte : line.front();
        line.remove_prefix(byte ? 4 : isBackslash ? 2 : 1);
    }
    while (result.ends_with('\n')) // the library kept the line break
        result.pop_back();
    return result;
}

std::vector<std::string_view> typedLines(std::string_view content)
{
    std::vector<std::string_view> lines;
    if (content.substr(0, content.find('\n')) == kFormat) // once: such a line may have been typed, too
        content.remove_prefix(kFormat.size());
    while (!content.empty())
    {
        const std::size_t end = std::min(content.find('\n'), content.size());
        if (end > 0)
            lines.push_back(content.substr(0, end));
        content.remove_prefix(std::min(end + 1, content.size()));
    }
    return lines;
}

bool isSameFile(int descriptor, const std::filesystem::path& path)
{
    struct stat open = {};
    struct stat named = {};
    return fstat(descriptor, &open) == 0 && stat(path.c_str(), &named) == 0 && open.st_dev == named.st_dev &&
           open.st_ino == named.st_ino;
}

Result<> checkOpened(const Descriptor& file)
{
    struct stat status = {};
    return fstat(file.number(), &status) == 0 ? checkOrdinary(status) : systemFailure(errno);
}

// The file, for this session alone until it is closed. Another session may put a shorter one in its place
// while this one waits.
Descriptor openAlone(const std::filesystem::path& path)
{
    for (;;)
    {
        Descriptor file(
            open(path.c_str(), O_RDWR | O_APPEND | O_CREAT | O_CLOEXEC | O_NONBLOCK | O_NOCTTY, kOwnersOnly));
        if (!file || !checkOpened(file) || flock(file.number(), LOCK_EX) != 0 ||
            isSameFile(file.number(), path))
            return file;
    }
}

// What goes before a line that is added: a session that was killed may have left half of one.
std::string beginning(int file)
{
    const off_t size = lseek(file, 0, SEEK_END);
    if (size <= 0)
        return std::string(kFormat) + "\n";
    char last = '\n';
    return pread(file, &last, 1, size - 1) == 1 && last != '\n' ? "\n" : "";
}

// Puts a file with the last lines in place of a long one.
void shorten(const std::filesystem::path& path)
{
    const Descriptor lock = openAlone(path);
    const auto content = readOrdinaryFile(path, kLargestHistory);
    if (!lock || !content)
        return;
    const auto lines = typedLines(*content);
    if (lines.size() <= kMostStoredLines) // another session was faster
        return;
    std::string kept = std::string(kFormat) + "\n";
    for (std::size_t index = lines.size() - kMostHistoryLines; index < lines.size(); ++index)
        kept.append(lines[index]).append("\n");
    static_cast<void>(replaceFile(path, kept)); // when it fails the long file stays, and serves
}
} // namespace

Failure TypedHistory::giveUp(Sentence<2> whatFailed, const std::wstring& reason)
{
    mGivenUp = true;
    return {translated(whatFailed, mFile, reason)};
}

Result<std::vector<std::wstring>> TypedHistory::read()
{
    const auto content = readOrdinaryFile(mFile, kLargestHistory);
    if (!content && content.code() != kNothingThere)
        return giveUp(kNotUsed, content.sentence());
    std::vector<std::wstring> lines;
    if (!content)
        return lines;
    auto stored = typedLines(*content);
    if (stored.size() > kMostStoredLines)
        shorten(mFile);
    if (stored.size() > kMostHistoryLines)
        stored.erase(stored.begin(), stored.end() - kMostHistoryLines);
    for (const std::string_view line : stored)
        lines.push_back(toWide(decodedLine(line)));
    return lines;
}

Result<> TypedHistory::add(const std::wstring& line)
{
    const std::string kept = toUtf8(withoutCredentials(line));
    if (mGivenUp || kept.find_first_not_of(" \t") == kept.npos)
        return {};
    Descriptor file = openAlone(mFile);
    if (!file)
        return giveUp(kNotWritten, systemFailure(errno).sentence);
    if (const auto ordinary = checkOpened(file); !ordinary)
        return giveUp(kNotUsed, ordinary.sentence());
    auto written = file.write(beginning(file.number()) + encodedLine(kept) + "\n");
    if (written)
        written = file.close();
    return written ? written : giveUp(kNotWritten, written.sentence());
}
} // namespace tessel
