#include "modrig/commands/JsonText.h"

namespace ModrigUtils
{
namespace
{
constexpr wchar_t kFirstPrivateByte = 0x10FE00;
constexpr wchar_t kDeleteCharacter = 0x7F;
constexpr wchar_t kLastControlCharacter = 0x9F;
constexpr unsigned kBeyondFirstPlane = 0x10000;
constexpr unsigned kHighHalf = 0xD800;
constexpr unsigned kLowHalf = 0xDC00;
constexpr unsigned kBitsOfHalf = 10;
constexpr unsigned kMaskOfHalf = 0x3FF;

std::wstring Escape(unsigned unit)
{
    constexpr wchar_t kDigits[] = L"0123456789abcdef";
    std::wstring text = L"\\u";
    for (int shift = 12; shift >= 0; shift -= 4)
        text += kDigits[(unit >> shift) & 0xF];
    return text;
}

std::wstring EscapeCharacter(unsigned character)
{
    if (character < kBeyondFirstPlane)
        return Escape(character);
    const unsigned rest = character - kBeyondFirstPlane;
    return Escape(kHighHalf + (rest >> kBitsOfHalf)) + Escape(kLowHalf + (rest & kMaskOfHalf));
}

bool StandsForItself(wchar_t character)
{
    return character >= L' ' && (character < kDeleteCharacter || character > kLastControlCharacter) &&
           character < kFirstPrivateByte;
}
} // namespace

std::wstring InJson(std::wstring_view text)
{
    std::wstring quoted = L"\"";
    for (const wchar_t character : text)
        if (character == L'"' || character == L'\\')
            quoted += {L'\\', character};
        else if (StandsForItself(character))
            quoted += character;
        else
            quoted += EscapeCharacter(static_cast<unsigned>(character));
    return quoted + L"\"";
}
} // namespace ModrigUtils
