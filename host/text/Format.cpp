#include <tessel/tsformat.h>

#include <algorithm>
#include <cstdio>
#include <cwchar>
#include <string>
#include <string_view>

#include "host/text/CallersBuffer.h"

namespace
{
// Numbers are padded no wider than this: a format may come from a file's name, and must not fill the memory.
constexpr int kWidest = 1000;
constexpr std::size_t kNumberRoom = 2 * kWidest + 400; // a double may have 309 digits before its point
constexpr std::size_t kUsualRoom = 64;                 // names of entries are made by the hundred thousand
// A text is never longer than this many characters, so that a precision beyond it cuts nothing.
constexpr int kLargestNumber = 100'000'000;

constexpr std::wstring_view kFlags = L"-+ #0";
constexpr std::wstring_view kLengthModifiers = L"hljztLq";
constexpr std::wstring_view kSignedConversions = L"di";
constexpr std::wstring_view kUnsignedConversions = L"uxXo";
constexpr std::wstring_view kRealConversions = L"fFeEgG";

bool isOneOf(std::wstring_view set, wchar_t character)
{
    return character != L'\0' && set.find(character) != std::wstring_view::npos;
}

// One conversion as it stands in the format.
struct Conversion
{
    std::string flags;
    int width = 0;
    int precision = -1; // none
    wchar_t letter = L'\0';
    const wchar_t* end = nullptr; // after it
};

int takeNumber(const wchar_t*& at)
{
    int number = 0;
    for (; *at >= L'0' && *at <= L'9'; ++at)
        number = std::min(kLargestNumber, number * 10 + static_cast<int>(*at - L'0'));
    return number;
}

// Reads what stands after a per cent sign.
Conversion parse(const wchar_t* at)
{
    Conversion conversion;
    for (; isOneOf(kFlags, *at); ++at)
        if (conversion.flags.find(static_cast<char>(*at)) == std::string::npos)
            conversion.flags += static_cast<char>(*at);
    conversion.width = std::min(kWidest, takeNumber(at));
    if (*at == L'.')
        conversion.precision = takeNumber(++at);
    while (isOneOf(kLengthModifiers, *at))
        ++at;
    conversion.letter = *at;
    conversion.end = *at ? at + 1 : at;
    return conversion;
}

bool fits(const Conversion& conversion, const TsFormatArgument& argument)
{
    switch (argument.kind())
    {
    case TsFormatArgument::Kind::kInteger:
        return conversion.letter == L'c' || isOneOf(kSignedConversions, conversion.letter) ||
               isOneOf(kUnsignedConversions, conversion.letter);
    case TsFormatArgument::Kind::kReal:
        return isOneOf(kRealConversions, conversion.letter);
    case TsFormatArgument::Kind::kText:
        return conversion.letter == L's';
    }
    return false;
}

// The same conversion for the C library, with the size that the argument is passed in.
std::string cFormat(const Conversion& conversion, const char* size)
{
    std::string format(1, '%');
    format += conversion.flags;
    if (conversion.width > 0)
        format += std::to_string(conversion.width);
    if (conversion.precision >= 0)
    {
        format += '.';
        format += std::to_string(std::min(kWidest, conversion.precision));
    }
    format += size;
    format += static_cast<char>(conversion.letter);
    return format;
}

bool isPlainDecimal(const Conversion& conversion)
{
    const bool isDecimal = isOneOf(kSignedConversions, conversion.letter) || conversion.letter == L'u';
    return isDecimal && conversion.flags.empty() && conversion.width == 0 && conversion.precision < 0;
}

template <class Number>
std::wstring formatNumber(const Conversion& conversion, const char* size, Number number)
{
    if (isPlainDecimal(conversion))
    {
        const std::string digits = std::to_string(number);
        return std::wstring(digits.begin(), digits.end());
    }
    char buffer[kNumberRoom];
    const int length = std::snprintf(buffer, sizeof buffer, cFormat(conversion, size).c_str(), number);
    return std::wstring(buffer, buffer + std::clamp(length, 0, static_cast<int>(sizeof buffer) - 1));
}

std::wstring pad(const Conversion& conversion, std::wstring text)
{
    const auto width = static_cast<std::size_t>(conversion.width);
    if (text.size() >= width)
        return text;
    const bool left = conversion.flags.find('-') != std::string::npos;
    text.insert(left ? text.size() : 0, width - text.size(), L' ');
    return text;
}

unsigned long long unsignedValue(const TsFormatArgument& argument)
{
    const auto value = static_cast<unsigned long long>(argument.integer());
    const std::size_t bits = argument.integerBytes() * 8;
    return bits < 64 ? value & ((1ull << bits) - 1) : value;
}

std::wstring formatInteger(const Conversion& conversion, const TsFormatArgument& argument)
{
    if (conversion.letter == L'c')
    {
        const auto character = static_cast<wchar_t>(argument.integer());
        return pad(conversion, character ? std::wstring(1, character) : std::wstring());
    }
    // A number that %d would show as negative although it is not is shown as what it is.
    if (isOneOf(kSignedConversions, conversion.letter) && (argument.isSigned() || argument.integer() >= 0))
        return formatNumber(conversion, "ll", argument.integer());
    Conversion asUnsigned = conversion;
    if (isOneOf(kSignedConversions, conversion.letter))
        asUnsigned.letter = L'u';
    return formatNumber(asUnsigned, "ll", unsignedValue(argument));
}

std::wstring formatText(const Conversion& conversion, const TsFormatArgument& argument)
{
    std::wstring_view text = argument.text() ? argument.text() : L"(null)";
    if (conversion.precision >= 0)
        text = text.substr(0, static_cast<std::size_t>(conversion.precision));
    return pad(conversion, std::wstring(text));
}

std::wstring formatOne(const Conversion& conversion, const TsFormatArgument& argument)
{
    switch (argument.kind())
    {
    case TsFormatArgument::Kind::kInteger:
        return formatInteger(conversion, argument);
    case TsFormatArgument::Kind::kReal:
        return formatNumber(conversion, "", argument.real());
    case TsFormatArgument::Kind::kText:
        return formatText(conversion, argument);
    }
    return {};
}

std::wstring formatAll(const wchar_t* format, const TsFormatArgument* arguments, std::size_t count)
{
    std::wstring text;
    text.reserve(kUsualRoom);
    std::size_t next = 0;
    while (*format)
    {
        if (*format != L'%')
        {
            const std::size_t plain = std::wcscspn(format, L"%");
            text.append(format, plain);
            format += plain;
            continue;
        }
        if (format[1] == L'%')
        {
            text += L'%';
            format += 2;
            continue;
        }
        const Conversion conversion = parse(format + 1);
        if (next < count && fits(conversion, arguments[next]))
        {
            text += formatOne(conversion, arguments[next++]);
            format = conversion.end;
        }
        else // as it stands; what follows the sign may begin a conversion of its own
            text += *format++;
    }
    return text;
}
} // namespace

std::size_t tsutFormatArguments(wchar_t* buffer, std::size_t capacity, const wchar_t* format,
                                const TsFormatArgument* arguments, std::size_t count)
{
    const std::wstring text = formatAll(format ? format : L"", arguments, count);
    tessel::copyCut(text, buffer, capacity);
    return text.size();
}
