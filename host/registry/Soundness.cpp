#include "host/registry/Soundness.h"

#include "host/registry/Schema.h"
#include "host/registry/Statement.h"
#include "host/registry/StoreFailure.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
constexpr int kDeepestKey = 100; // of a path that is told

// A start takes a thirtieth of a second where it is quick, and a look at so many pages of 4096 bytes a tenth
// of it.
constexpr std::int64_t kPagesInATenthOfAStart = 150;

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

// `sql` lists the rows whose checksum is wrong: a key, and a name in it. The sentence takes
// the name, and the path of the key.
Result<> checkRows(sqlite3* database, Sentence<2> isWrong, const char* sql)
{
    Statement wrong;
    int status = wrong.prepare(database, sql);
    if (status == SQLITE_OK)
        status = wrong.step();
    if (status == SQLITE_DONE)
        return {};
    if (status != SQLITE_ROW)
        return storeFailure(database, status);
    return Failure{translated(isWrong, wrong.text(1), pathOf(database, wrong.number(0))), SQLITE_CORRUPT};
}
} // namespace

Result<> checkSoundness(sqlite3* database, int version)
{
    auto sound = checkPages(database);
    if (!sound || version != kSchemaVersion)
        return sound;
    sound = checkRows(database, Sentence<2>(L"the key \"{}\" in \"{}\" is not what was stored there"),
                      "SELECT parent, name FROM key WHERE sum IS NOT row_sum(parent, name, fold) LIMIT 1");
    if (!sound)
        return sound;
    return checkRows(database, Sentence<2>(L"the value \"{}\" in \"{}\" is not what was stored there"),
                     "SELECT key, name FROM value WHERE sum IS NOT row_sum(key, name, fold, data) LIMIT 1");
}

unsigned startsBetweenLooks(sqlite3* database)
{
    const auto pages = firstNumber(database, "PRAGMA page_count");
    return pages ? static_cast<unsigned>(1 + *pages / kPagesInATenthOfAStart) : 1;
}
} // namespace tessel
