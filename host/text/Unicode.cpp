#include "host/text/Unicode.h"

#include <unicode/uchar.h>

#include <algorithm>

namespace tessel
{
namespace
{
constexpr char32_t kReplacement = 0xFFFD;
constexpr char32_t kLastCodePoint = 0x10FFFF;
// A byte that is no text stands as this and the byte: a private character at the very end of Unicode.
constexpr char32_t kByte = 0x10FE00;
constexpr char32_t kFirstByte = kByte | 0x80;
constexpr char32_t kLastByte = kByte | 0xFF;

bool isScalar(char32_t code)
{
    return code <= kLastCodePoint && (code < 0xD800 || code > 0xDFFF);
}

bool isByte(char32_t code)
{
    return code >= kFirstByte && code <= kLastByte;
}

wchar_t foldOne(wchar_t character)
{
    return static_cast<wchar_t>(u_foldCase(static_cast<UChar32>(character), U_FOLD_CASE_DEFAULT));
}

// The length of a sequence by its first byte; 0 for a byte that starts none.
std::size_t sequenceLength(unsigned char first)
{
    if (first < 0x80)
        return 1;
    if (first >= 0xC2 && first < 0xE0)
        return 2;
    if ((first & 0xF0) == 0xE0)
        return 3;
    return first >= 0xF0 && first < 0xF5 ? 4 : 0;
}

// The code point at the head of the text, which is shortened by what was read; one byte of it when it is not
// UTF-8.
char32_t takeCodePoint(std::string_view& text)
{
    constexpr unsigned kFirstByteMask[] = {0, 0x7F, 0x1F, 0x0F, 0x07};
    constexpr char32_t kSmallest[] = {0, 0, 0x80, 0x800, 0x10000};
    const auto first = static_cast<unsigned char>(text.front());
    const std::size_t length = sequenceLength(first);
    char32_t code = length ? first & kFirstByteMask[length] : 0;
    bool sound = length != 0 && length <= text.size();
    for (std::size_t i = 1; sound && i < length; ++i)
    {
        const auto next = static_cast<unsigned char>(text[i]);
        sound = (next & 0xC0) == 0x80;
        code = code << 6 | (next & 0x3Fu);
    }
    sound = sound && code >= kSmallest[length] && isScalar(code) && !isByte(code);
    text.remove_prefix(sound ? length : 1);
    return sound ? code : kByte | first;
}

void appendUtf8(std::string& utf8, char32_t code)
{
    const auto put = [&utf8](char32_t byte)
    {
        utf8 += static_cast<char>(byte);
    };
    if (code < 0x80)
        return put(code);
    if (code < 0x800)
        put(0xC0 | code >> 6);
    else if (code < 0x10000)
    {
        put(0xE0 | code >> 12);
        put(0x80 | (code >> 6 & 0x3F));
    }
    else
    {
        put(0xF0 | code >> 18);
        put(0x80 | (code >> 12 & 0x3F));
        put(0x80 | (code >> 6 & 0x3F));
    }
    put(0x80 | (code & 0x3F));
}
} // namespace

std::wstring toWide(std::string_view utf8)
{
    std::wstring text;
    text.reserve(utf8.size());
    while (!utf8.empty())
        text += static_cast<wchar_t>(takeCodePoint(utf8));
    return text;
}

std::string toUtf8(std::wstring_view text)
{
    std::string utf8;
    utf8.reserve(text.size());
    for (const wchar_t character : text)
    {
        const auto code = static_cast<char32_t>(character);
        if (isByte(code))
            utf8 += static_cast<char>(code & 0xFF);
        else
            appendUtf8(utf8, isScalar(code) ? code : kReplacement);
    }
    return utf8;
}

std::wstring withReadableBytes(std::wstring_view text)
{
    constexpr wchar_t kDigits[] = L"0123456789ABCDEF";
    std::wstring readable;
    readable.reserve(text.size());
    for (const wchar_t character : text)
        if (const auto code = static_cast<char32_t>(character); isByte(code))
            readable += {L'\\', L'x', kDigits[code >> 4 & 0xF], kDigits[code & 0xF]};
        else
            readable += character;
    return readable;
}

std::wstring foldCase(std::wstring_view text)
{
    std::wstring folded(text);
    std::transform(folded.begin(), folded.end(), folded.begin(), foldOne);
    return folded;
}

bool equalIgnoringCase(std::wstring_view left, std::wstring_view right)
{
    return std::equal(left.begin(), left.end(), right.begin(), right.end(),
                      [](wchar_t a, wchar_t b) { return a == b || foldOne(a) == foldOne(b); });
}
} // namespace tessel
