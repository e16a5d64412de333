// Rows of cells in columns, for a person's screen or for who reads them line by line.
#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace tessel
{
class Table
{
public:
    using Row = std::vector<std::wstring>;

    // How wide the columns but the last are at least where nobody limits the lines.
    explicit Table(std::vector<std::size_t> leastWidths) : mLeastWidths(std::move(leastWidths)) {}

    // As many cells as there are columns. What a terminal would take for an order must be out of them.
    void add(Row row) { mRows.push_back({std::move(row), false}); }

    // A line across all columns.
    void addHeading(std::wstring text) { mRows.push_back({{std::move(text)}, true}); }

    // Without a limit a row is one line, whatever it holds. With one, no line is wider: the last cell goes on
    // below itself, and where too little room is left for it, every cell but the first stands on lines of its
    // own. No text is lost.
    std::vector<std::wstring> lines(std::optional<std::size_t> cells) const;

private:
    struct Entry
    {
        Row row;
        bool isHeading;
    };

    std::vector<std::size_t> widthsOfContent() const;

    std::vector<std::size_t> mLeastWidths;
    std::vector<Entry> mRows;
};
} // namespace tessel
