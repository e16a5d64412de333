#include "modrig/base/CStdStr.h"

#include <wincompat/winres.h>

#include <cwchar>
#include <iterator>
#include <vector>

#include "modrig/base/CaseFolding.h"

namespace
{
constexpr std::uintptr_t kLargestResourceId = 65535;
constexpr std::size_t kRoomForUsualText = 4096;
constexpr std::size_t kFormattingRoom = 1023;
constexpr std::wstring_view kWhiteSpace = L" \t\n\r\f\v";

// The host cuts a text to the room it is given and does not say so: one that fills the room is fetched again
// with more.
std::wstring ResourceText(unsigned id, HMODULE module)
{
    for (std::size_t room = kRoomForUsualText;; room *= 2)
    {
        std::vector<wchar_t> buffer(room);
        const int copied = loadStringFromWin32ResourceDLL(module, id, buffer.data(), static_cast<int>(room));
        const std::size_t length = copied > 0 ? static_cast<std::size_t>(copied) : 0;
        if (length + 1 < room)
            return std::wstring(buffer.data(), length);
    }
}
} // namespace

CStdStr::CStdStr(const wchar_t* text)
{
    const auto value = reinterpret_cast<std::uintptr_t>(text);
    if (value == 0)
        return;
    if (value <= kLargestResourceId)
        *this = OfId(static_cast<unsigned>(value));
    else
        mText = text;
}

int CStdStr::CompareNoCase(const CStdStr& other) const
{
    return CompareIgnoringCase(mText, other.mText);
}

bool CStdStr::EqualsNoCase(const CStdStr& other) const
{
    return EqualIgnoringCase(mText, other.mText);
}

CStdStr CStdStr::Left(std::size_t count) const
{
    return mText.substr(0, count);
}

CStdStr CStdStr::Mid(std::size_t first) const
{
    return Mid(first, std::wstring::npos);
}

CStdStr CStdStr::Mid(std::size_t first, std::size_t count) const
{
    return first < mText.size() ? CStdStr(mText.substr(first, count)) : CStdStr();
}

CStdStr& CStdStr::TrimLeft()
{
    mText.erase(0, mText.find_first_not_of(kWhiteSpace));
    return *this;
}

CStdStr& CStdStr::TrimRight()
{
    mText.erase(mText.find_last_not_of(kWhiteSpace) + 1);
    return *this;
}

CStdStr& CStdStr::TrimLeft(wchar_t character)
{
    mText.erase(0, mText.find_first_not_of(character));
    return *this;
}

CStdStr& CStdStr::TrimRight(wchar_t character)
{
    mText.erase(mText.find_last_not_of(character) + 1);
    return *this;
}

CStdStr CStdStr::AfterLastDot() const
{
    const auto dot = mText.rfind(L'.');
    return dot == std::wstring::npos ? CStdStr() : Mid(dot + 1);
}

bool CStdStr::HasDot() const
{
    return mText.find(L'.') != std::wstring::npos;
}

bool CStdStr::Load(unsigned id, HMODULE module)
{
    const std::wstring text = ResourceText(id, module);
    if (text.empty())
        return false;
    mText = text;
    return true;
}

void CStdStr::FormatArguments(const wchar_t* format, const TsFormatArgument* arguments, std::size_t count)
{
    const std::size_t room = std::wcslen(format) + kFormattingRoom + 1;
    // Names of entries are made by the hundred thousand.
    wchar_t usual[2 * kFormattingRoom];
    std::vector<wchar_t> unusual(room > std::size(usual) ? room : 0);
    wchar_t* const buffer = unusual.empty() ? usual : unusual.data();
    tsutFormatArguments(buffer, room, format, arguments, count);
    mText = buffer;
}
