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
    // A row was found by a search: of the key, and with that place among all rows.
    void noteFound(std::int64_t key, std::int64_t place);

    // Steps to the next row where one of the key can be expected there. Answers SQLITE_ROW when it is the one
    // of that name and whole, SQLITE_DONE when the row has to be searched, and else what failed. `rows` lists
    // the rows of a key after a place: place, whether it is whole, folded name, ...
    int step(Statement& rows, std::int64_t key, std::string_view fold);

    // What was found lasts as long as the transaction, and until something is written.
    void forget(Statement& rows);

private:
    int letGo(Statement& rows);

    std::int64_t mKey = 0;
    std::int64_t mPlace = 0;
    bool mInOrder = false; // the last two were neighbours
};
} // namespace tessel
