#include "host/ui/platform/gnustep/filepanel/Listing.h"

#include <algorithm>
#include <cctype>
#include <cwchar>
#include <cwctype>
#include <memory>
#include <string_view>
#include <unordered_map>

#include <dirent.h>
#include <sys/stat.h>

#include "host/text/Hexadecimal.h"
#include "host/text/Unicode.h"

namespace tessel::filepanel
{
namespace
{
constexpr wchar_t kMostDigits = 0x4000;
constexpr std::string_view kExtensionPlace = "%@";

// Bytes that are no text in the encoding of the locale count as characters of their own.
std::wstring wideText(const std::string& text)
{
    std::wstring result;
    std::mbstate_t state{};
    for (std::size_t place = 0; place < text.size();)
    {
        wchar_t character = 0;
        const std::size_t length = std::mbrtowc(&character, &text[place], text.size() - place, &state);
        const bool isText = length > 0 && length <= text.size() - place;
        if (!isText)
            state = std::mbstate_t{};
        result += isText ? character : static_cast<wchar_t>(static_cast<unsigned char>(text[place]));
        place += isText ? length : 1;
    }
    return result;
}

std::wstring folded(const std::string& text)
{
    std::wstring result = wideText(text);
    std::ranges::transform(result, result.begin(),
                           [](wchar_t character)
                           { return static_cast<wchar_t>(std::towlower(static_cast<wint_t>(character))); });
    return result;
}

bool isDigit(wchar_t character)
{
    return character >= L'0' && character <= L'9';
}

bool leadsToFolder(const std::string& path)
{
    struct stat status;
    return stat(path.c_str(), &status) == 0 && S_ISDIR(status.st_mode);
}

// The kind of file system knows it without another question; what a link leads to has to be asked.
bool isFolder(const dirent& file, const std::string& folder)
{
    if (file.d_type == DT_LNK || file.d_type == DT_UNKNOWN)
        return leadsToFolder(folder + "/" + file.d_name);
    return file.d_type == DT_DIR;
}

bool isListed(const std::string& name, bool withHiddenFiles)
{
    return name != "." && name != ".." && (withHiddenFiles || !name.starts_with('.'));
}

// Negative, zero or positive.
int compare(const Entry& left, const Entry& right, Column column)
{
    if (column == Column::kKind)
        return left.kind.compare(right.kind);
    if (column == Column::kDate)
        return left.changed == right.changed ? 0 : (left.changed < right.changed ? -1 : 1);
    return left.key.compare(right.key);
}

bool comesBefore(const Entry& left, const Entry& right, Order order)
{
    if (left.isWalkedThrough() != right.isWalkedThrough())
        return left.isWalkedThrough();
    if (const int compared = compare(left, right, order.column))
        return order.descending ? compared > 0 : compared < 0;
    return left.key != right.key ? left.key < right.key : left.name < right.name;
}
} // namespace

Order afterClickOn(Column column, Order order)
{
    return {column, order.column == column && !order.descending};
}

std::vector<Entry> readFolder(const std::string& folder, bool withHiddenFiles)
{
    std::vector<Entry> entries;
    const std::unique_ptr<DIR, int (*)(DIR*)> open(opendir(folder.c_str()), closedir);
    while (const dirent* file = open ? readdir(open.get()) : nullptr)
        if (isListed(file->d_name, withHiddenFiles))
            entries.push_back({file->d_name, sortKey(file->d_name), {}, isFolder(*file, folder), false, {}});
    return entries;
}

void sortEntries(std::vector<Entry>& entries, Order order)
{
    std::ranges::sort(entries, [order](const Entry& left, const Entry& right)
                      { return comesBefore(left, right, order); });
}

// A number is led by how many digits it has, so that comparing character by character compares the numbers.
std::wstring sortKey(const std::string& name)
{
    const std::wstring text = folded(name);
    std::wstring key;
    for (std::size_t place = 0; place < text.size();)
    {
        std::size_t end = place;
        while (end < text.size() && isDigit(text[end]))
            ++end;
        if (end == place)
        {
            key += text[place++];
            continue;
        }
        while (place + 1 < end && text[place] == L'0')
            ++place;
        key += L'0';
        key += static_cast<wchar_t>(std::min<std::size_t>(end - place, kMostDigits));
        key += text.substr(place, end - place);
        place = end;
    }
    return key;
}

std::string shownName(const std::string& name)
{
    std::string shown;
    for (const char character : name)
        if (character == '\n')
            shown += "\\n";
        else if (std::iscntrl(static_cast<unsigned char>(character)))
            shown += shownByte<char>(static_cast<unsigned char>(character));
        else
            shown += character;
    return readableName(shown);
}

std::string readableName(const std::string& name)
{
    return toUtf8(withReadableBytes(toWide(name)));
}

std::string kindOf(const Entry& entry, const KindWords& words)
{
    if (entry.isFolder)
        return entry.isPackage ? words.package : words.folder;
    const std::size_t dot = entry.name.rfind('.');
    if (dot == std::string::npos || dot == 0 || dot + 1 == entry.name.size())
        return words.file;
    std::string extension = entry.name.substr(dot + 1);
    std::ranges::transform(extension, extension.begin(),
                           [](unsigned char character)
                           { return static_cast<char>(std::toupper(character)); });
    std::string kind = words.fileWithExtension;
    const std::size_t place = kind.find(kExtensionPlace);
    return place == std::string::npos ? kind
                                      : kind.replace(place, kExtensionPlace.size(), readableName(extension));
}

std::optional<std::time_t> dateOf(const std::string& path)
{
    struct stat status;
    if (stat(path.c_str(), &status) != 0)
        return std::nullopt;
    return status.st_mtime;
}

bool beginsLike(const std::string& name, const std::string& beginning)
{
    return folded(name).starts_with(folded(beginning));
}

std::optional<std::size_t> rowBeginningLike(const std::vector<Entry>& entries, const std::string& beginning,
                                            std::size_t from)
{
    for (std::size_t step = 0; step < entries.size(); ++step)
    {
        const std::size_t row = (from + step) % entries.size();
        if (beginsLike(entries[row].name, beginning))
            return row;
    }
    return std::nullopt;
}

std::optional<std::size_t> rowOf(const std::vector<Entry>& entries, const std::string& name)
{
    const auto found = std::ranges::find(entries, name, &Entry::name);
    if (found == entries.end())
        return std::nullopt;
    return static_cast<std::size_t>(found - entries.begin());
}

std::size_t rowInPlaceOf(const std::vector<Entry>& before, std::size_t row, const std::vector<Entry>& now)
{
    std::unordered_map<std::string, std::size_t> rows;
    for (std::size_t index = 0; index < now.size(); ++index)
        rows.emplace(now[index].name, index);
    for (; row < before.size(); ++row)
        if (const auto found = rows.find(before[row].name); found != rows.end())
            return found->second;
    return now.empty() ? 0 : now.size() - 1;
}

std::optional<std::string> stateOf(const std::string& folder)
{
    struct stat status;
    if (stat(folder.c_str(), &status) != 0 || !S_ISDIR(status.st_mode))
        return std::nullopt;
    return std::to_string(status.st_dev) + "/" + std::to_string(status.st_ino) + "/" +
           std::to_string(status.st_mtim.tv_sec) + "." + std::to_string(status.st_mtim.tv_nsec);
}
} // namespace tessel::filepanel
