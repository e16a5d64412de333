#include "host/text/Unicode.h"

#include <unicode/uchar.h>
#include <unicode/utf16.h>
#include <unicode/utf8.h>

#include <algorithm>
#include <iterator>
#include <type_traits>

#include "host/text/Hexadecimal.h"

namespace tessel
{
namespace
{
constexpr char32_t kReplacement = 0xFFFD;
// A byte that is no text stands as this and the byte: a private character at the very end of Unicode.
constexpr char32_t kByte = 0x10FE00;
constexpr char32_t kFirstByte = kByte | 0x80;
constexpr char32_t kLastByte = kByte | 0xFF;

bool isByte(char32_t code)
{
    return code >= kFirstByte && code <= kLastByte;
}

// Nearly all text is ASCII, which is the same in every encoding and goes by without a look at each
// character's properties.
constexpr char32_t kFirstBeyondAscii = 0x80;

// Several at once, which processors do in one step.
template <class Text>
auto endOfAscii(const Text& text)
{
    constexpr std::size_t kAtOnce = 16;
    std::size_t end = 0;
    for (; end + kAtOnce <= text.size(); end += kAtOnce)
    {
        char32_t all = 0;
        for (std::size_t i = 0; i < kAtOnce; ++i)
            all |= std::make_unsigned_t<typename Text::value_type>(text[end + i]);
        if (all >= kFirstBeyondAscii)
            break;
    }
    return std::find_if(text.begin() + static_cast<std::ptrdiff_t>(end), text.end(),
                        [](auto unit)
                        { return std::make_unsigned_t<decltype(unit)>(unit) >= kFirstBeyondAscii; });
}

wchar_t foldOne(wchar_t character)
{
    if (character < static_cast<wchar_t>(kFirstBeyondAscii))
        return character >= L'A' && character <= L'Z' ? character + (L'a' - L'A') : character;
    return static_cast<wchar_t>(u_foldCase(static_cast<UChar32>(character), U_FOLD_CASE_DEFAULT));
}

void append(std::string& utf8, char32_t code)
{
    if (isByte(code))
    {
        utf8 += static_cast<char>(code & 0xFF);
        return;
    }
    char bytes[U8_MAX_LENGTH];
    std::size_t length = 0;
    UBool isNoCharacter = false;
    U8_APPEND(bytes, length, std::size(bytes), static_cast<UChar32>(code), isNoCharacter);
    if (isNoCharacter)
        append(utf8, kReplacement);
    else
        utf8.append(bytes, length);
}

void append(std::u16string& utf16, char32_t code)
{
    char16_t units[U16_MAX_LENGTH];
    std::size_t length = 0;
    UBool isNoCharacter = false;
    U16_APPEND(units, length, std::size(units), static_cast<UChar32>(code), isNoCharacter);
    if (isNoCharacter || U_IS_SURROGATE(code))
        append(utf16, kReplacement);
    else
        utf16.append(units, length);
}

// The text's characters, one by one, in another encoding.
template <class Encoded>
Encoded encoded(std::wstring_view text)
{
    const auto rest = endOfAscii(text);
    Encoded result(text.begin(), rest);
    for (auto character = rest; character != text.end(); ++character)
        append(result, static_cast<char32_t>(*character));
    return result;
}
} // namespace

std::optional<char32_t> takeUtf8(std::string_view utf8, std::size_t& position) noexcept
{
    std::size_t next = position;
    UChar32 code = 0;
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wconversion" // the macro keeps a difference of bytes in a byte
    U8_NEXT(utf8, next, utf8.size(), code);
#pragma GCC diagnostic pop
    const bool isText = code >= 0 && !isByte(static_cast<char32_t>(code));
    position = isText ? next : position + 1;
    return isText ? std::optional(static_cast<char32_t>(code)) : std::nullopt;
}

std::wstring toWide(std::string_view utf8)
{
    const auto rest = endOfAscii(utf8);
    std::wstring text(utf8.begin(), rest);
    for (std::size_t position = text.size(); position < utf8.size();)
    {
        const auto first = static_cast<unsigned char>(utf8[position]);
        text += static_cast<wchar_t>(takeUtf8(utf8, position).value_or(kByte | first));
    }
    return text;
}

std::wstring toWide(std::u16string_view utf16)
{
    std::wstring text;
    text.reserve(utf16.size());
    for (std::size_t position = 0; position < utf16.size();)
    {
        UChar32 code = 0;
        U16_NEXT_OR_FFFD(utf16, position, utf16.size(), code);
        text += static_cast<wchar_t>(code);
    }
    return text;
}

std::string toUtf8(std::wstring_view text)
{
    return encoded<std::string>(text);
}

std::u16string toUtf16(std::wstring_view text)
{
    return encoded<std::u16string>(text);
}

std::wstring withReadableBytes(std::wstring_view text)
{
    std::wstring readable;
    readable.reserve(text.size());
    for (const wchar_t character : text)
        if (const auto code = static_cast<char32_t>(character); isByte(code))
            readable += shownByte<wchar_t>(static_cast<unsigned char>(code));
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

std::string foldedUtf8(std::wstring_view text)
{
    std::string folded(text.size(), '\0');
    for (std::size_t at = 0; at < text.size(); ++at)
    {
        const auto character = static_cast<char32_t>(text[at]);
        if (character >= kFirstBeyondAscii)
            return toUtf8(foldCase(text));
        const bool isCapital = character >= U'A' && character <= U'Z';
        folded[at] = static_cast<char>(isCapital ? character + (U'a' - U'A') : character);
    }
    return folded;
}

bool equalIgnoringCase(std::wstring_view left, std::wstring_view right)
{
    return std::equal(left.begin(), left.end(), right.begin(), right.end(),
                      [](wchar_t a, wchar_t b) { return a == b || foldOne(a) == foldOne(b); });
}
} // namespace tessel
