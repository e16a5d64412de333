#include "host/text/Nearest.h"

#include <algorithm>
#include <cstddef>
#include <numeric>
#include <utility>

#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr std::size_t kShortestBeginning = 3;
constexpr std::size_t kLongName = 6;
constexpr std::size_t kLongestTyped = 64; // nobody means a name by more

using Row = std::vector<std::size_t>;

bool isSwap(std::wstring_view left, std::wstring_view right, std::size_t i, std::size_t j)
{
    return i > 1 && j > 1 && left[i - 1] == right[j - 2] && left[i - 2] == right[j - 1];
}

// How many slips lead from one to the other: the usual table, of which three rows are kept.
std::size_t slips(std::wstring_view left, std::wstring_view right)
{
    Row beforeLast(right.size() + 1);
    Row last(right.size() + 1);
    Row row(right.size() + 1);
    std::iota(last.begin(), last.end(), std::size_t{0});
    for (std::size_t i = 1; i <= left.size(); ++i)
    {
        row[0] = i;
        for (std::size_t j = 1; j <= right.size(); ++j)
        {
            row[j] = std::min({last[j] + 1, row[j - 1] + 1, last[j - 1] + (left[i - 1] != right[j - 1])});
            if (isSwap(left, right, i, j))
                row[j] = std::min(row[j], beforeLast[j - 2] + 1);
        }
        std::swap(beforeLast, last);
        std::swap(last, row);
    }
    return last.back();
}

std::optional<std::wstring> onlyOneThatBegins(std::wstring_view folded,
                                              const std::vector<std::wstring>& names)
{
    std::optional<std::wstring> only;
    for (const std::wstring& name : names)
        if (foldCase(name).starts_with(folded))
        {
            if (only)
                return std::nullopt;
            only = name;
        }
    return only;
}
} // namespace

std::optional<std::wstring> nearest(std::wstring_view typed, const std::vector<std::wstring>& names)
{
    if (typed.size() < 2 || typed.size() > kLongestTyped)
        return std::nullopt;
    const std::wstring folded = foldCase(typed);
    // Of those that are as near the one that begins so: QUIT is not what SUIT was to be.
    std::pair best{std::size_t{typed.size() < kLongName ? 2u : 3u}, false};
    std::optional<std::wstring> result;
    for (const std::wstring& name : names)
    {
        const std::wstring candidate = foldCase(name);
        const std::pair distance{slips(folded, candidate), !candidate.starts_with(folded)};
        if (distance < best && name.size() > distance.first)
        {
            best = distance;
            result = name;
        }
    }
    if (!result && typed.size() >= kShortestBeginning)
        result = onlyOneThatBegins(folded, names);
    return result;
}
} // namespace tessel
