#include "modrig/dialogs/model/ShownText.h"

#include <algorithm>
#include <string>

namespace ModrigUtils
{
namespace
{
constexpr wchar_t kFirstVisible = L' ';
constexpr wchar_t kDelete = 0x7F;
// The host's characters for bytes of names that are no text.
constexpr wchar_t kFirstByte = 0x10FE80;
constexpr wchar_t kLastByte = 0x10FEFF;

bool IsVisible(wchar_t character)
{
    return character >= kFirstVisible && character != kDelete &&
           (character < kFirstByte || character > kLastByte);
}

std::wstring EscapeFor(wchar_t character)
{
    constexpr wchar_t kDigits[] = L"0123456789ABCDEF";
    switch (character)
    {
    case L'\n':
        return L"\\n";
    case L'\r':
        return L"\\r";
    case L'\t':
        return L"\\t";
    default:
        return {L'\\', L'x', kDigits[character >> 4 & 0xF], kDigits[character & 0xF]};
    }
}
} // namespace

CStdStr ShownText(const CStdStr& text)
{
    const std::wstring& all = text.Text();
    if (std::all_of(all.begin(), all.end(), IsVisible))
        return text;
    std::wstring shown;
    for (const wchar_t character : all)
        shown += IsVisible(character) ? std::wstring(1, character) : EscapeFor(character);
    return CStdStr(shown);
}
} // namespace ModrigUtils
