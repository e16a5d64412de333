#include "host/messages/Answers.h"

#include <array>
#include <charconv>
#include <cmath>
#include <cstdlib>

#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr std::wstring_view kYes = L"Yes";
constexpr std::wstring_view kNo = L"No";
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

std::optional<double> numberIn(std::wstring_view answer)
{
    std::string text = toUtf8(trimmed(answer));
    if (text.starts_with('+') && !text.starts_with("+-"))
        text.erase(0, 1);
    double number = 0;
    const char* end = text.data() + text.size();
    const auto read = std::from_chars(text.data(), end, number);
    const bool isWhole = read.ec == std::errc() && read.ptr == end && std::isfinite(number);
    return isWhole ? std::optional(number) : std::nullopt;
}

std::wstring asText(double number)
{
    std::array<char, 32> text; // the shortest form of any number has at most 24 characters
    const auto written = std::to_chars(text.data(), text.data() + text.size(), number);
    return toWide(std::string_view(text.data(), written.ptr));
}

std::optional<bool> yesOrNoIn(std::wstring_view answer)
{
    const std::wstring word = trimmed(answer);
    if (begins(kYes, word))
        return true;
    return begins(kNo, word) ? std::optional(false) : std::nullopt;
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
