// Registries that come from elsewhere: of an older Tessel, with a stranger's triggers, with another file's
// log.
#include <gmock/gmock.h>

#include <csignal>

#include <sys/resource.h>

#include "host/text/Unicode.h"
#include "tests/host/registry/StoredList.h"
#include "tests/host/support/RegistryHost.h"
#include "tests/support/ChildProcess.h"
#include "tests/support/Database.h"

namespace fs = std::filesystem;

using tessel::Registry;
using testing::AllOf;
using testing::ElementsAre;
using testing::HasSubstr;

namespace
{
// What Tessel made before rows had checksums, with values and keys that were removed again.
constexpr const char* kOldRegistry =
    "BEGIN IMMEDIATE;"
    "CREATE TABLE IF NOT EXISTS key(id INTEGER PRIMARY KEY AUTOINCREMENT,"
    " parent INTEGER NOT NULL REFERENCES key(id) ON DELETE CASCADE, name TEXT NOT NULL, fold TEXT NOT NULL,"
    " UNIQUE(parent, fold));"
    "CREATE TABLE IF NOT EXISTS value(seq INTEGER PRIMARY KEY AUTOINCREMENT,"
    " key INTEGER NOT NULL REFERENCES key(id) ON DELETE CASCADE, name TEXT NOT NULL, fold TEXT NOT NULL,"
    " data TEXT NOT NULL, UNIQUE(key, fold));"
    "CREATE INDEX IF NOT EXISTS value_order ON value(key, seq);"
    "CREATE INDEX IF NOT EXISTS key_order ON key(parent, id);"
    "INSERT OR IGNORE INTO key(id, parent, name, fold)"
    " VALUES(1, 1, 'HKEY_CURRENT_USER', 'hkey_current_user');"
    "PRAGMA user_version=1;"
    "COMMIT;"
    "PRAGMA journal_mode=WAL;"
    "INSERT INTO key(parent,name,fold) VALUES(1,'Software','software'),(2,'Größe','größe'),(2,'Gone','gone');"
    "INSERT INTO value(key,name,fold,data) VALUES(3,'zwei','zwei','2'),(3,'Eins','eins','Ä /x'),(2,'','',''),"
    "(3,'gone','gone','x');"
    "DELETE FROM value WHERE name='gone';"
    "DELETE FROM key WHERE name='Gone';";

class TakenOver : public testing::Test
{
protected:
    fs::path file() const { return folder / "registry.db"; }
    std::string said(Registry& registry) const { return tessel::toUtf8(registry.canStore().sentence()); }

    // As a session leaves them that is killed: without its good-bye.
    void copyAsKilled(const fs::path& from, const fs::path& to) const
    {
        fs::copy_file(from, to, fs::copy_options::overwrite_existing);
        fs::copy_file(from.string() + "-wal", to.string() + "-wal", fs::copy_options::overwrite_existing);
    }

    static void expectOldContent(Registry& registry)
    {
        EXPECT_THAT(registry.subKeys(Registry::kRoot), ElementsAre(L"Software"));
        EXPECT_EQ(registry.read(L"software", L""), L"");
        const auto values = registry.values(registry.find(L"SOFTWARE\\GRÖSSE"));
        EXPECT_TRUE(values.empty()) << "ß is not ss";
        const auto stored = registry.values(registry.find(L"SOFTWARE\\GRÖßE"));
        ASSERT_EQ(stored.size(), 2u);
        EXPECT_EQ(stored[0].name + L"=" + stored[0].data, L"zwei=2");
        EXPECT_EQ(stored[1].name + L"=" + stored[1].data, L"Eins=Ä /x");
        EXPECT_TRUE(registry.endOfCommand());
    }

    TemporaryFolder folder;
};
} // namespace

TEST_F(TakenOver, FromAnOlderTesselWithEverything)
{
    ASSERT_EQ(runSql(file(), kOldRegistry), "wal");
    {
        Registry registry(file());
        EXPECT_EQ(said(registry), "");
        expectOldContent(registry);
        const auto key = registry.create(L"New", Registry::kRoot);
        EXPECT_EQ(*key, 5) << "the number of the key that is gone is not given away again";
        EXPECT_TRUE(registry.write(L"New", L"name", L"1"));
        EXPECT_TRUE(registry.removeKey(*key));
        EXPECT_TRUE(registry.endOfCommand());
    }
    EXPECT_EQ(runSql(file(), "SELECT seq FROM sqlite_sequence WHERE name='value'"), "5");
    EXPECT_EQ(runSql(file(), "SELECT group_concat(name) FROM (SELECT name FROM sqlite_master"
                             " WHERE name NOT LIKE 'sqlite%' ORDER BY name)"),
              "key,key_order,value,value_order");
    EXPECT_EQ(runSql(file(), "PRAGMA integrity_check"), "ok");
    EXPECT_EQ(runSql(file(), "PRAGMA foreign_key_check"), "");
    EXPECT_TRUE(fs::exists(file().string() + ".sound"));
    Registry again(file());
    EXPECT_EQ(said(again), "");
    expectOldContent(again);
}

TEST_F(TakenOver, FromAnOlderTesselThatWasKilled)
{
    const auto old = folder / "old.db";
    sqlite3* database = nullptr;
    sqlite3_open(old.c_str(), &database);
    ASSERT_EQ(sqlite3_exec(database, kOldRegistry, nullptr, nullptr, nullptr), SQLITE_OK);
    copyAsKilled(old, file());
    sqlite3_close(database);
    Registry registry(file());
    EXPECT_EQ(said(registry), "");
    EXPECT_EQ(registry.notice(), std::nullopt);
    expectOldContent(registry);
    EXPECT_TRUE(registry.write(L"New", L"name", L"1"));
}

TEST_F(TakenOver, FromAnOlderTesselForReadingWhereNothingMayBeWritten)
{
    ASSERT_EQ(runSql(file(), kOldRegistry), "wal");
    const std::string before = contentOf(file());
    fs::permissions(file(), fs::perms::owner_read);
    {
        Registry registry(file());
        EXPECT_THAT(said(registry), HasSubstr("may only be read"));
        expectOldContent(registry);
        EXPECT_FALSE(registry.write(L"New", L"name", L"1"));
    }
    EXPECT_TRUE(contentOf(file()) == before);
}

TEST_F(TakenOver, FromAnOlderTesselForReadingWhereTheDiskIsFull)
{
    ASSERT_EQ(runSql(file(), kOldRegistry), "wal");
    const std::string before = contentOf(file());
    for (const rlim_t bytes : {rlim_t{0}, rlim_t{40'000}})
    {
        const std::string answer = askChild(
            [bytes, this]
            {
                std::signal(SIGXFSZ, SIG_IGN);
                const rlimit limit = {bytes, RLIM_INFINITY};
                setrlimit(RLIMIT_FSIZE, &limit);
                Registry registry(file());
                expectOldContent(registry);
                return (HasFailure() ? "read wrong" : "read right, ") + said(registry);
            });
        EXPECT_THAT(answer,
                    AllOf(HasSubstr("read right, Nothing can be stored in the registry " + file().string()),
                          HasSubstr("What is stored there is used.")));
        EXPECT_TRUE(contentOf(file()) == before);
    }
}

TEST_F(TakenOver, NotFromAnOlderTesselWhereItIsDamaged)
{
    ASSERT_EQ(runSql(file(), kOldRegistry), "wal");
    std::string damaged = contentOf(file());
    damaged[4096 + 8] = static_cast<char>(damaged[4096 + 8] ^ 0x40);
    folder.write("registry.db", damaged);
    Registry registry(file());
    EXPECT_THAT(said(registry), HasSubstr("damaged"));
    EXPECT_FALSE(registry.write(L"New", L"name", L"1"));
    EXPECT_TRUE(contentOf(file()) == damaged);
}

TEST_F(TakenOver, NotWithWhatAStrangerPutThere)
{
    constexpr const char* kReservedName =
        "PRAGMA writable_schema=1; INSERT INTO sqlite_master VALUES('trigger','sqlite_t','value',0,"
        "'CREATE TRIGGER sqlite_t AFTER INSERT ON value BEGIN DELETE FROM key; END')";
    for (const char* hostile :
         {"CREATE TRIGGER t AFTER INSERT ON value BEGIN DELETE FROM key; END",
          "CREATE TRIGGER t AFTER UPDATE ON value BEGIN DELETE FROM key; END",
          "CREATE TEMP TABLE x(y); CREATE VIEW v AS SELECT * FROM key",
          "ALTER TABLE value RENAME TO v; CREATE VIEW value AS SELECT * FROM v",
          "CREATE INDEX i ON value(length(data))", "CREATE TABLE other(x)",
          "DROP INDEX value_order; CREATE INDEX value_order ON value(key)", kReservedName})
    {
        fs::remove(file());
        {
            Registry made(file());
            ASSERT_TRUE(rewriteList(made, 1, 5));
        }
        ASSERT_EQ(runSql(file(), hostile), "") << hostile;
        const std::string before = contentOf(file());
        {
            Registry registry(file());
            EXPECT_THAT(said(registry),
                        AllOf(HasSubstr(file().string()), HasSubstr("not as Tessel makes it")))
                << hostile;
            EXPECT_FALSE(registry.write(L"A", L"name", L"1")) << hostile;
        }
        EXPECT_TRUE(contentOf(file()) == before) << hostile;
    }
}

TEST_F(TakenOver, WithTheLogOfASessionThatWasKilled)
{
    const auto killed = folder / "killed.db";
    {
        Registry registry(file());
        ASSERT_TRUE(rewriteList(registry, 1, 20));
        ASSERT_TRUE(registry.endOfCommand());
        ASSERT_TRUE(rewriteList(registry, 2, 30));
        ASSERT_TRUE(registry.endOfCommand());
        ASSERT_TRUE(rewriteList(registry, 3, 30)) << "written to the log, and never ended";
        copyAsKilled(file(), killed);
    }
    Registry registry(killed);
    EXPECT_EQ(registry.notice(), std::nullopt);
    EXPECT_EQ(generationOf(registry), 2);
}

// The log is carried over to the file and begun again many times.
TEST_F(TakenOver, WithEachOfTheLogsOfALongSession)
{
    const auto killed = folder / "killed.db";
    Registry registry(file());
    for (int generation = 1; generation <= 12; ++generation)
    {
        ASSERT_TRUE(rewriteList(registry, generation, 1500));
        ASSERT_TRUE(registry.endOfCommand());
        copyAsKilled(file(), killed);
        Registry next(killed);
        EXPECT_EQ(next.notice(), std::nullopt);
        EXPECT_EQ(generationOf(next), generation);
        Registry meanwhile(file());
        EXPECT_EQ(meanwhile.notice(), std::nullopt);
        EXPECT_TRUE(meanwhile.write(L"Other", L"name", L"1"));
        EXPECT_TRUE(meanwhile.endOfCommand());
    }
}

TEST_F(TakenOver, WithoutTheLogOfAnotherRegistry)
{
    {
        Registry mine(file());
        ASSERT_TRUE(rewriteList(mine, 1, 20));
    }
    const std::string before = contentOf(file());
    const auto other = folder / "other.db";
    {
        Registry another(other);
        ASSERT_TRUE(rewriteList(another, 7, 20));
        ASSERT_TRUE(another.endOfCommand());
        fs::copy_file(other.string() + "-wal", file().string() + "-wal");
    }
    const std::string log = contentOf(file().string() + "-wal");
    folder.write("registry.db-wal.foreign", "an earlier one");
    {
        Registry registry(file());
        EXPECT_EQ(said(registry), "");
        const std::string notice = tessel::toUtf8(registry.notice().value_or(L""));
        EXPECT_THAT(notice, AllOf(HasSubstr("The registry " + file().string() + " is read without its log"),
                                  HasSubstr("does not belong to it"),
                                  HasSubstr("set aside as " + file().string() + "-wal.foreign-2")));
        EXPECT_EQ(generationOf(registry), 1);
    }
    EXPECT_TRUE(contentOf(file()) == before);
    EXPECT_TRUE(contentOf(file().string() + "-wal.foreign-2") == log);
    EXPECT_EQ(contentOf(file().string() + "-wal.foreign"), "an earlier one");
    Registry again(file());
    EXPECT_EQ(again.notice(), std::nullopt);
}

TEST_F(TakenOver, WithoutTheLogOfALaterStateOfTheSameRegistry)
{
    const auto backup = folder / "backup.db";
    {
        Registry registry(file());
        ASSERT_TRUE(rewriteList(registry, 1, 20));
    }
    fs::copy_file(file(), backup);
    for (int generation = 2; generation <= 4; ++generation)
    {
        Registry registry(file());
        ASSERT_TRUE(rewriteList(registry, generation, 20));
    }
    {
        Registry registry(file());
        ASSERT_TRUE(rewriteList(registry, 5, 20));
        ASSERT_TRUE(registry.endOfCommand());
        fs::copy_file(file().string() + "-wal", backup.string() + "-wal");
    }
    Registry registry(backup);
    EXPECT_THAT(tessel::toUtf8(registry.notice().value_or(L"")), HasSubstr("another state of it"));
    EXPECT_EQ(generationOf(registry), 1);
}
