#include "host/messages/Answers.h"

#include <cstdlib>
#include <limits>
#include <locale>
#include <sstream>

#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr std::wstring_view kBlanks = L" \t\r\n";

bool begins(std::wstring_view word, std::wstring_view beginning)
{
    return !beginning.empty() && equalIgnoringCase(word.substr(0, beginning.size()), beginning);
}
} // namespace

std::wstring trimmed(std::wstring_view text)
{
    const std::size_t first = text.find_first_not_of(kBlanks);
    if (first == text.npos)
        return {};
    return std::wstring(text.substr(first, text.find_last_not_of(kBlanks) - first + 1));
}

// By streams: not every C++ library that this is built with has the newer functions for numbers with a point.
std::optional<double> numberIn(std::wstring_view answer)
{
    const std::string text = toUtf8(trimmed(answer));
    if (text.find_first_not_of("0123456789.eE+-") != text.npos) // neither "inf" nor hexadecimal digits
        return std::nullopt;
    std::istringstream stream(text);
    stream.imbue(std::locale::classic());
    double number = 0;
    stream >> number;
    const bool isWhole = !stream.fail() && stream.peek() == std::istringstream::traits_type::eof();
    return isWhole ? std::optional(number) : std::nullopt;
}

std::wstring asText(double number)
{
    std::ostringstream stream;
    // The fewest digits that stand for this number and no other.
    for (int digits = 6; digits <= std::numeric_limits<double>::max_digits10; ++digits)
    {
        stream = std::ostringstream();
        stream.imbue(std::locale::classic());
        stream.precision(digits);
        stream << number;
        if (numberIn(toWide(stream.str())) == number)
            break;
    }
    return toWide(stream.str());
}

std::optional<bool> yesOrNoIn(std::wstring_view answer, std::wstring_view yes, std::wstring_view no)
{
    const std::wstring word = trimmed(answer);
    if (begins(yes, word))
        return true;
    return begins(no, word) ? std::optional(false) : std::nullopt;
}

std::wstring asText(bool yes)
{
    return std::wstring(yes ? kYes : kNo);
}

std::wstring pathIn(std::wstring_view answer)
{
    std::wstring path = trimmed(answer);
    if (path.size() > 1 && path.front() == L'"' && path.back() == L'"')
        return path.substr(1, path.size() - 2);
    const char* home = std::getenv("HOME");
    if (home && path.starts_with(L"~/"))
        path.replace(0, 1, toWide(home));
    return path;
}
} // namespace tessel
