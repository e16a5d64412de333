#include "host/registry/ReadAhead.h"

#include "host/registry/Statement.h"

namespace tessel
{
namespace
{
constexpr int kPlace = 0;
constexpr int kIsWhole = 1;
constexpr int kFold = 2;
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
    const int status = rows.isStanding() ? rows.step() : rows.bind(key).bind(mPlace).step();
    if (status != SQLITE_ROW)
    {
        mInOrder = false;
        return status;
    }
    // Another row, or one that is damaged, may well not be the one that was asked for: the search tells.
    if (rows.number(kPlace) > mPlace && rows.number(kIsWhole) == 1 && rows.utf8(kFold) == fold)
    {
        mPlace = rows.number(kPlace);
        return SQLITE_ROW;
    }
    return letGo(rows);
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
