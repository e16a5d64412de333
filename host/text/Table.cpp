#include "host/text/Table.h"

#include <algorithm>
#include <numeric>
#include <utility>

#include "host/text/DisplayWidth.h"

namespace tessel
{
namespace
{
constexpr std::size_t kMargin = 2;
constexpr std::size_t kInnerMargin = 6; // of what stands below the first cell of its row
constexpr std::size_t kLeastForLast = 24;

using Lines = std::vector<std::wstring>;
using Widths = std::vector<std::size_t>;

void addWrapped(Lines& lines, const std::wstring& text, std::size_t margin, std::size_t cells)
{
    const std::size_t room = cells > margin ? cells - margin : 1;
    for (const auto& line : wrapped(text, room))
        lines.push_back(std::wstring(std::min(margin, cells - 1), L' ') + line);
}

std::wstring leadingCells(const Table::Row& row, const Widths& widths)
{
    std::wstring line(kMargin, L' ');
    for (std::size_t column = 0; column + 1 < row.size(); ++column)
        line += padded(row[column], widths[column]) + L" ";
    return line;
}

std::size_t startOfLast(const Widths& widths)
{
    return std::accumulate(widths.begin(), widths.end(), kMargin + widths.size());
}

void addInColumns(Lines& lines, const Table::Row& row, const Widths& widths, std::size_t cells)
{
    const std::size_t start = startOfLast(widths);
    std::wstring beginning = leadingCells(row, widths);
    for (const auto& part : wrapped(row.back(), cells - start))
        lines.push_back(std::exchange(beginning, std::wstring(start, L' ')) + part);
}

void addStacked(Lines& lines, const Table::Row& row, std::size_t cells)
{
    addWrapped(lines, row.front(), kMargin, cells);
    for (std::size_t column = 1; column < row.size(); ++column)
        if (!row[column].empty())
            addWrapped(lines, row[column], kInnerMargin, cells);
}
} // namespace

std::vector<std::size_t> Table::widthsOfContent() const
{
    Widths widths(mLeastWidths.size());
    for (const auto& [row, isHeading] : mRows)
        for (std::size_t column = 0; !isHeading && column < widths.size(); ++column)
            widths[column] = std::max(widths[column], displayWidth(row[column]) + 1);
    return widths;
}

std::vector<std::wstring> Table::lines(std::optional<std::size_t> cells) const
{
    const Widths widths = widthsOfContent();
    const bool fits = cells && startOfLast(widths) + kLeastForLast <= *cells;
    Lines lines;
    for (const auto& [row, isHeading] : mRows)
        if (!cells)
            lines.push_back(isHeading ? row.front() : leadingCells(row, mLeastWidths) + row.back());
        else if (isHeading)
            addWrapped(lines, row.front(), 0, *cells);
        else if (fits)
            addInColumns(lines, row, widths, *cells);
        else
            addStacked(lines, row, *cells);
    return lines;
}
} // namespace tessel
