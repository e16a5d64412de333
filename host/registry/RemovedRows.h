// Who replaces a list removes all of its values, one by one, and writes them one by one, most of them under
// the names of before. Rows that are removed first to last stay where they are until the next is written:
// where that is the one that was removed first, the row is changed in its place, or not touched when it says
// the same. Removing and storing it would cost three times as much.
//
// What is to be seen of the file is the same as if every row had been removed and stored again at once. So
// before anything else is asked of the key, `settle` removes what has not come back. Used by the Registry's
// own files alone.
#pragma once

#include <sqlite3.h>

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "host/registry/Statement.h"

namespace tessel
{
class RemovedRows
{
public:
    int prepare(sqlite3* database);

    // Rows of the key wait to come back.
    bool areOf(std::int64_t key) const { return mKey == key; }
    bool areThere() const { return mKey != kNone; }

    // Whether it was the key's first row, or the one after the row that was removed last, and now waits. When
    // it was not, it has to be removed from the file, after `settle`.
    bool remove(std::int64_t key, std::string_view fold);

    // SQLITE_DONE: the row is in the place of the first of those that wait. SQLITE_NOTFOUND: it has to be
    // stored after `settle`. Otherwise what failed.
    int write(std::int64_t key, std::string_view name, std::string_view fold, std::string_view data);

    // SQLITE_DONE, or what failed.
    int settle();

    // The transaction is over.
    void forget();

private:
    struct Row
    {
        std::int64_t place = 0;
        std::int64_t sum = 0;
        std::string name;
        std::string fold;
        std::string data;
    };

    static constexpr std::int64_t kNone = 0; // the number of no key
    static constexpr std::size_t kRowsAtOnce = 64;

    bool begin(std::int64_t key);
    bool beginWriting();
    const Row* next();
    bool readAfter(std::int64_t place);
    int change(const Row& row, std::string_view name, std::string_view data);

    Statement mRowsAfter;
    Statement mChange;
    Statement mRemove;
    std::int64_t mKey = kNone;
    std::int64_t mRefused = kNone; // a key whose rows are not removed first to last
    std::int64_t mRemovedUpTo = 0; // the place of the last row that was removed
    std::int64_t mBackUpTo = 0;    // and of the last one that has come back
    bool mWriting = false;
    bool mFailed = false;
    std::vector<Row> mRows; // in memory; their texts keep the room that they once had
    std::size_t mCount = 0; // of them
    std::size_t mNext = 0;
};
} // namespace tessel
