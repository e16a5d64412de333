#include "host/registry/NewRows.h"

#include <utility>

#include "host/registry/RowChecksum.h"

namespace tessel
{
namespace
{
std::string storing(std::size_t rows)
{
    std::string sql = "INSERT INTO value(key, name, fold, data, sum) VALUES";
    for (std::size_t row = 0; row < rows; ++row)
        sql += row == 0 ? "(?,?,?,?,?)" : ",(?,?,?,?,?)";
    return sql + " ON CONFLICT(key, fold) DO UPDATE"
                 " SET data=excluded.data, sum=row_sum(key, name, fold, excluded.data)";
}
} // namespace

int NewRows::prepare(sqlite3* database)
{
    mDatabase = database;
    mRows.reserve(kAtOnce);
    return mOne.prepare(database, storing(1).c_str());
}

void NewRows::add(std::int64_t key, std::string name, std::string fold, std::string data)
{
    mRows.push_back({key, std::move(name), std::move(fold), std::move(data)});
}

int NewRows::store()
{
    if (isFull() && !mHasMany)
    {
        if (const int status = mMany.prepare(mDatabase, storing(kAtOnce).c_str()); status != SQLITE_OK)
            return status;
        mHasMany = true;
    }
    int status = SQLITE_DONE;
    if (isFull())
        status = storeBy(mMany, 0, kAtOnce);
    else
        for (std::size_t row = 0; row < mRows.size() && status == SQLITE_DONE; ++row)
            status = storeBy(mOne, row, 1);
    mRows.clear();
    return status;
}

int NewRows::storeBy(Statement& statement, std::size_t first, std::size_t count)
{
    for (std::size_t at = first; at < first + count; ++at)
    {
        const Row& row = mRows[at];
        statement.bind(row.key).bindKept(row.name).bindKept(row.fold).bindKept(row.data).bind(
            checksumOfValue(row.key, row.name, row.fold, row.data));
    }
    return statement.run();
}
} // namespace tessel
