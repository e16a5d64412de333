#include "host/registry/RemovedRows.h"

#include "host/registry/RowChecksum.h"

namespace tessel
{
namespace
{
constexpr int kPlaceOfRow = 0;
constexpr int kSumOfRow = 1;
constexpr int kNameOfRow = 2;
constexpr int kFoldOfRow = 3;
constexpr int kDataOfRow = 4;
} // namespace

int RemovedRows::prepare(sqlite3* database)
{
    int status = mRowsAfter.prepare(database, "SELECT seq, sum, name, fold, data FROM value"
                                              " WHERE key=?1 AND seq>?2 ORDER BY seq");
    if (status == SQLITE_OK)
        status = mChange.prepare(database, "UPDATE value SET name=?2, data=?3, sum=?4 WHERE seq=?1");
    if (status == SQLITE_OK)
        status = mRemove.prepare(database, "DELETE FROM value WHERE key=?1 AND seq>?2 AND seq<=?3");
    mRows.resize(kRowsAtOnce);
    return status;
}

bool RemovedRows::remove(std::int64_t key, std::string_view fold)
{
    if (!areThere() && !begin(key))
        return false;
    if (mKey != key || mWriting)
        return false;
    const Row* row = next();
    if (row && row->fold == fold)
    {
        mRemovedUpTo = row->place;
        ++mNext;
        return true;
    }
    mRefused = key;
    return false;
}

bool RemovedRows::begin(std::int64_t key)
{
    if (key == mRefused)
        return false;
    mKey = key;
    mRemovedUpTo = 0;
    mBackUpTo = 0;
    mWriting = false;
    return readAfter(0);
}

// Rows are read again from the first on, and only if all of them were removed: one that stays is before those
// that are written now.
bool RemovedRows::beginWriting()
{
    if (next() || mFailed)
    {
        mRefused = mKey;
        return false;
    }
    mWriting = true;
    return readAfter(0);
}

int RemovedRows::write(std::int64_t key, std::string_view name, std::string_view fold, std::string_view data)
{
    if (mKey != key)
        return SQLITE_NOTFOUND;
    if (!mWriting && !beginWriting())
        return SQLITE_NOTFOUND;
    const Row* row = next();
    if (!row || row->place > mRemovedUpTo || row->fold != fold)
        return SQLITE_NOTFOUND;
    const int status = change(*row, name, data);
    mBackUpTo = row->place;
    ++mNext;
    return status;
}

int RemovedRows::change(const Row& row, std::string_view name, std::string_view data)
{
    const std::int64_t sum = checksumOfValue(mKey, name, row.fold, data);
    if (row.sum == sum && row.name == name && row.data == data)
        return SQLITE_DONE;
    return mChange.bind(row.place).bindKept(name).bindKept(data).bind(sum).run();
}

int RemovedRows::settle()
{
    const bool wait = areThere() && mBackUpTo < mRemovedUpTo;
    const int status = wait ? mRemove.bind(mKey).bind(mBackUpTo).bind(mRemovedUpTo).run() : SQLITE_DONE;
    mKey = kNone;
    return status;
}

void RemovedRows::forget()
{
    mKey = kNone;
    mRefused = kNone;
}

// The row that is first of those after the last one that was removed, or that came back; null at the end.
const RemovedRows::Row* RemovedRows::next()
{
    if (mNext == mCount && mCount == kRowsAtOnce && !readAfter(mRows.back().place))
        return nullptr;
    return mNext < mCount ? &mRows[mNext] : nullptr;
}

// Whether they could be read. No statement stands between two calls: rows are changed meanwhile.
bool RemovedRows::readAfter(std::int64_t place)
{
    mCount = 0;
    mNext = 0;
    mFailed = false;
    mRowsAfter.bind(mKey).bind(place);
    int status = SQLITE_ROW;
    while (mCount < kRowsAtOnce && (status = mRowsAfter.step()) == SQLITE_ROW)
    {
        Row& row = mRows[mCount++];
        row.place = mRowsAfter.number(kPlaceOfRow);
        row.sum = mRowsAfter.number(kSumOfRow);
        row.name = mRowsAfter.utf8(kNameOfRow);
        row.fold = mRowsAfter.utf8(kFoldOfRow);
        row.data = mRowsAfter.utf8(kDataOfRow);
        mFailed = mFailed || row.place <= place; // only an index that is damaged leads round and round
        place = row.place;
    }
    mRowsAfter.reset();
    mFailed = mFailed || (status != SQLITE_ROW && status != SQLITE_DONE);
    if (mFailed)
        mCount = 0;
    return !mFailed;
}
} // namespace tessel
