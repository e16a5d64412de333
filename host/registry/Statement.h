// One prepared statement of the store, run and reset. For the files of this room alone.
#pragma once

#include <sqlite3.h>

#include <array>
#include <cstdint>
#include <string>
#include <string_view>
#include <utility>

#include "host/text/Unicode.h"

namespace tessel
{
class Statement
{
public:
    Statement() = default;
    ~Statement() { sqlite3_finalize(mStatement); }
    Statement(const Statement&) = delete;
    Statement& operator=(const Statement&) = delete;

    int prepare(sqlite3* database, const char* sql)
    {
        return sqlite3_prepare_v3(database, sql, -1, SQLITE_PREPARE_PERSISTENT, &mStatement, nullptr);
    }

    Statement& bind(std::int64_t number)
    {
        sqlite3_bind_int64(mStatement, ++mBound, number);
        return *this;
    }
    Statement& bind(std::wstring_view text) { return bindUtf8(toUtf8(text)); }
    Statement& bindUtf8(std::string utf8)
    {
        std::string& kept = mTexts[static_cast<std::size_t>(mBound)];
        kept = std::move(utf8);
        sqlite3_bind_text(mStatement, ++mBound, kept.data(), static_cast<int>(kept.size()), SQLITE_STATIC);
        return *this;
    }

    // The caller keeps the text until the statement has been run or reset.
    Statement& bindKept(std::string_view utf8)
    {
        sqlite3_bind_text(mStatement, ++mBound, utf8.data(), static_cast<int>(utf8.size()), SQLITE_STATIC);
        return *this;
    }

    // SQLITE_ROW: a row stands ready. After anything else, or `reset`, the statement can be bound again.
    int step()
    {
        const int status = sqlite3_step(mStatement);
        if (status != SQLITE_ROW)
            reset();
        return status;
    }
    // Runs a statement whose rows do not matter; SQLITE_DONE on success.
    int run()
    {
        const int status = step();
        reset();
        return status;
    }
    void reset()
    {
        sqlite3_reset(mStatement);
        mBound = 0;
    }
    // Whether a row stands ready.
    bool isStanding() const { return sqlite3_stmt_busy(mStatement) != 0; }

    std::int64_t number(int column) const { return sqlite3_column_int64(mStatement, column); }
    std::wstring text(int column) const { return toWide(utf8(column)); }
    // The same as it is stored; it lasts until the next step or reset.
    std::string_view utf8(int column) const
    {
        const auto* bytes = reinterpret_cast<const char*>(sqlite3_column_text(mStatement, column));
        const auto size = static_cast<std::size_t>(sqlite3_column_bytes(mStatement, column));
        return bytes ? std::string_view(bytes, size) : std::string_view();
    }

private:
    static constexpr std::size_t kMostBound = 4; // of texts that are kept here

    sqlite3_stmt* mStatement = nullptr;
    int mBound = 0;
    std::array<std::string, kMostBound> mTexts; // what is bound, for as long as it is
};
} // namespace tessel
