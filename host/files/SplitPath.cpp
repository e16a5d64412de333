#include <wincompat/winfile.h>

#include <algorithm>
#include <cerrno>
#include <cwchar>
#include <string_view>

namespace
{
constexpr std::size_t kDriveLength = 2; // a letter and a colon

struct Part
{
    wchar_t* buffer;
    std::size_t size;

    bool isConsistent() const { return (buffer == nullptr) == (size == 0); }
    bool holds(std::wstring_view text) const { return !buffer || text.size() < size; }
    void put(std::wstring_view text) const
    {
        if (!buffer)
            return;
        std::wmemcpy(buffer, text.data(), text.size());
        buffer[text.size()] = L'\0';
    }
};

std::wstring_view takeFront(std::wstring_view& text, std::size_t length)
{
    const std::wstring_view front = text.substr(0, length);
    text.remove_prefix(length);
    return front;
}

// The length up to and with the last separator. In a list every path comes by here, and `find_last_of` makes
// a call for each character.
std::size_t folderLength(std::wstring_view path)
{
    std::size_t length = path.size();
    while (length > 0 && path[length - 1] != L'/' && path[length - 1] != L'\\')
        --length;
    return length;
}

void emptyAll(const Part (&parts)[4])
{
    for (const Part& part : parts)
        if (part.buffer && part.size > 0)
            part.put(L"");
}
} // namespace

int _wsplitpath_s(const wchar_t* path, wchar_t* drive, std::size_t driveSize, wchar_t* folder,
                  std::size_t folderSize, wchar_t* name, std::size_t nameSize, wchar_t* extension,
                  std::size_t extensionSize)
{
    const Part parts[4] = {
        {drive, driveSize}, {folder, folderSize}, {name, nameSize}, {extension, extensionSize}};
    if (!path || !std::all_of(std::begin(parts), std::end(parts),
                              [](const Part& part) { return part.isConsistent(); }))
    {
        emptyAll(parts);
        return EINVAL;
    }
    std::wstring_view rest = path;
    const bool hasDrive = rest.size() >= kDriveLength && rest[1] == L':';
    const std::wstring_view driveText = takeFront(rest, hasDrive ? kDriveLength : 0);
    const std::wstring_view folderText = takeFront(rest, folderLength(rest));
    const std::wstring_view nameText = takeFront(rest, std::min(rest.rfind(L'.'), rest.size()));
    const std::wstring_view texts[4] = {driveText, folderText, nameText, rest};
    for (std::size_t i = 0; i < std::size(parts); ++i)
        if (!parts[i].holds(texts[i]))
        {
            emptyAll(parts);
            return ERANGE;
        }
    for (std::size_t i = 0; i < std::size(parts); ++i)
        parts[i].put(texts[i]);
    return 0;
}
