#include "host/registry/ReadAhead.h"

#include "host/registry/RowChecksum.h"
#include "host/registry/Statement.h"

namespace tessel
{
namespace
{
constexpr int kPlace = 0;
constexpr int kSum = 1;
constexpr int kName = 2;
constexpr int kFold = 3;
constexpr int kData = 4;
} // namespace

void ReadAhead::noteFound(std::int64_t key, std::int64_t place)
{
    mInOrder = key == mKey && place == mPlace + 1;
    mKey = key;
    mPlace = place;
}

int ReadAhead::step(Statement& rows, std::int64_t key, std::string_view fold)
{
    if (!mInOrder || key != mKey)
        return letGo(rows);
    const int status = rows.isStanding() ? rows.step() : rows.bind(mPlace).step();
    if (status != SQLITE_ROW)
    {
        mInOrder = false;
        return status;
    }
    const std::int64_t place = rows.number(kPlace);
    if (place <= mPlace || !isAskedFor(rows, fold))
        return letGo(rows);
    mPlace = place;
    return SQLITE_ROW;
}

// Another row, or one that is damaged, may well not be the one that was asked for: the search tells. No sum
// is right for two keys, whose numbers differ within the 32 bits in which it notices every change.
bool ReadAhead::isAskedFor(const Statement& row, std::string_view fold)
{
    if (row.utf8(kFold) != fold)
        return false;
    mData = row.utf8(kData);
    return row.number(kSum) == checksumOfValue(mKey, row.utf8(kName), fold, mData);
}

void ReadAhead::forget(Statement& rows)
{
    static_cast<void>(letGo(rows)); // nothing is asked for
    mKey = 0;
}

int ReadAhead::letGo(Statement& rows)
{
    if (rows.isStanding())
        rows.reset();
    mInOrder = false;
    return SQLITE_DONE;
}
} // namespace tessel
