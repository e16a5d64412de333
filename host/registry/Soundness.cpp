#include "host/registry/Soundness.h"

#include "host/registry/Schema.h"
#include "host/registry/Statement.h"
#include "host/registry/StoreFailure.h"

namespace tessel
{
namespace
{
constexpr int kDeepestKey = 100; // of a path that is told

// A start takes a fifth of a second where it is quick, and a look at so many pages of 4096 bytes a tenth of
// it.
constexpr std::int64_t kPagesInATenthOfAStart = 500;

// Above it stands which of the store's databases is meant.
std::wstring lastLineOf(const std::wstring& text)
{
    return text.substr(text.find_last_of(L'\n') + 1);
}

Result<> checkPages(sqlite3* database)
{
    const auto said = firstText(database, "PRAGMA integrity_check(1)");
    if (!said)
        return said.failure();
    if (*said == L"ok")
        return {};
    // Pages that the disk does not give fail the check too.
    const Failure reason = storeFailure(database, SQLITE_CORRUPT);
    return isDamage(reason.code) ? Failure{lastLineOf(*said), SQLITE_CORRUPT} : reason;
}

// The names of the key and of those above it. Parents may go round in a file that is damaged.
std::wstring pathOf(sqlite3* database, std::int64_t key)
{
    Statement find;
    if (find.prepare(database, "SELECT parent, name FROM key WHERE id=? AND id<>1") != SQLITE_OK)
        return L"?";
    std::wstring path;
    for (int depth = 0; depth < kDeepestKey && find.bind(key).step() == SQLITE_ROW; ++depth)
    {
        path.insert(0, path.empty() ? find.text(1) : find.text(1).append(1, L'\\'));
        key = find.number(0);
        find.reset();
    }
    return path;
}

// `sql` lists the rows whose checksum is wrong: a key, and a name in it.
Result<> checkRows(sqlite3* database, const wchar_t* kind, const char* sql)
{
    Statement wrong;
    int status = wrong.prepare(database, sql);
    if (status == SQLITE_OK)
        status = wrong.step();
    if (status == SQLITE_DONE)
        return {};
    if (status != SQLITE_ROW)
        return storeFailure(database, status);
    return Failure{std::wstring(kind) + L" \"" + wrong.text(1) + L"\" in \"" +
                       pathOf(database, wrong.number(0)) + L"\" is not what was stored there",
                   SQLITE_CORRUPT};
}
} // namespace

Result<> checkSoundness(sqlite3* database, int version)
{
    auto sound = checkPages(database);
    if (!sound || version != kSchemaVersion)
        return sound;
    sound = checkRows(database, L"the key",
                      "SELECT parent, name FROM key WHERE sum IS NOT row_sum(parent, name, fold) LIMIT 1");
    if (!sound)
        return sound;
    return checkRows(database, L"the value",
                     "SELECT key, name FROM value WHERE sum IS NOT row_sum(key, name, fold, data) LIMIT 1");
}

unsigned startsBetweenLooks(sqlite3* database)
{
    const auto pages = firstNumber(database, "PRAGMA page_count");
    return pages ? static_cast<unsigned>(1 + *pages / kPagesInATenthOfAStart) : 1;
}
} // namespace tessel
