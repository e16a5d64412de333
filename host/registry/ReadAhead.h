// A list is read value by value, in the order in which it was stored: the row that is asked for next lies
// beside the one that was read last, and is reached by a step instead of a search from the root of an index.
// Used by the Registry alone.
#pragma once

#include <cstdint>
#include <string_view>

namespace tessel
{
class Statement;

class ReadAhead
{
public:
    // Asked of the table alone, which is quicker than an index, and may be another key's: their sums tell.
    static constexpr const char* kRowsAfter =
        "SELECT seq, sum, name, fold, data FROM value WHERE seq>?1 ORDER BY seq";

    // A row was found by a search: of the key, and with that place among all rows.
    void noteFound(std::int64_t key, std::int64_t place);

    // Steps to the next row where one of the key can be expected there. Answers SQLITE_ROW when it is the one
    // of that name and whole, SQLITE_DONE when the row has to be searched, and else what failed. `rows` is
    // prepared from `kRowsAfter`.
    int step(Statement& rows, std::int64_t key, std::string_view fold);

    // The text of that row in UTF-8, until the next step.
    std::string_view data() const { return mData; }

    // What was found lasts as long as the transaction, and until something is written.
    void forget(Statement& rows);

private:
    int letGo(Statement& rows);
    bool isAskedFor(const Statement& row, std::string_view fold);

    std::int64_t mKey = 0;
    std::int64_t mPlace = 0;
    std::string_view mData;
    bool mInOrder = false; // the last two were neighbours
};
} // namespace tessel
