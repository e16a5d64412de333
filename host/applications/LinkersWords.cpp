#include "host/applications/LinkersWords.h"

#include <algorithm>
#include <cstdlib>
#include <memory>

#include <cxxabi.h>

namespace tessel
{
namespace
{
constexpr std::string_view kSymbolStart = "_Z";
constexpr std::string_view kFurtherStart = "__Z"; // some systems put an underscore before every symbol
constexpr std::string_view kNoSymbol = "./:";     // in a word of which a name of a file is a part

std::string readable(std::string_view word)
{
    const bool isFurther = word.starts_with(kFurtherStart);
    const std::string symbol(isFurther ? word.substr(1) : word);
    if (!symbol.starts_with(kSymbolStart) || symbol.find_first_of(kNoSymbol) != symbol.npos)
        return std::string(word);
    const std::unique_ptr<char, decltype(&std::free)> name(
        abi::__cxa_demangle(symbol.c_str(), nullptr, nullptr, nullptr), &std::free);
    return name ? name.get() : std::string(word);
}
} // namespace

std::string withReadableSymbols(std::string_view words)
{
    std::string result;
    while (!words.empty())
    {
        const std::size_t end = std::min(words.find(' '), words.size());
        const std::string_view word = words.substr(0, end);
        const std::size_t wordEnd = std::min(word.find_first_of(",\n"), word.size());
        result += readable(word.substr(0, wordEnd));
        result += word.substr(wordEnd);
        result += words.substr(end, 1);
        words.remove_prefix(std::min(end + 1, words.size()));
    }
    return result;
}
} // namespace tessel
