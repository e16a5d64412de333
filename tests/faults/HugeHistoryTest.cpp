// A History that takes long to read: a person sees that it goes on, and can stop it without losing any of it.
#include <gtest/gtest.h>

#include "tests/e2e/HostTerminal.h"
#include "tests/support/Database.h"

namespace
{
// Few enough to be made quickly; the disk is slow enough for them to take long.
// As an older Tessel stored it: the host makes it its own when it opens it.
constexpr const char* kHugeHistory =
    "CREATE TABLE key(id INTEGER PRIMARY KEY AUTOINCREMENT,"
    " parent INTEGER NOT NULL REFERENCES key(id) ON DELETE CASCADE, name TEXT NOT NULL, fold TEXT NOT NULL,"
    " UNIQUE(parent, fold));"
    "CREATE TABLE value(seq INTEGER PRIMARY KEY AUTOINCREMENT,"
    " key INTEGER NOT NULL REFERENCES key(id) ON DELETE CASCADE, name TEXT NOT NULL, fold TEXT NOT NULL,"
    " data TEXT NOT NULL, UNIQUE(key, fold));"
    "CREATE INDEX value_order ON value(key, seq);"
    "CREATE INDEX key_order ON key(parent, id);"
    "BEGIN;"
    "INSERT INTO key(id, parent, name, fold) VALUES(1, 1, 'HKEY_CURRENT_USER', 'hkey_current_user'),"
    " (2, 1, 'Software', 'software'), (3, 2, 'Tessel', 'tessel'), (4, 3, 'R21', 'r21'),"
    " (5, 4, 'Profiles', 'profiles'), (6, 5, 'Default', 'default'), (7, 6, 'Dialogs', 'dialogs'),"
    " (8, 7, 'Modrig', 'modrig'), (9, 8, 'History', 'history');"
    "INSERT INTO value(key, name, fold, data) VALUES(5, '', '', 'Default'),"
    " (9, 'NumHistory', 'numhistory', '200000');"
    "WITH RECURSIVE n(i) AS (SELECT 1 UNION ALL SELECT i + 1 FROM n WHERE i < 200000)"
    " INSERT INTO value(key, name, fold, data)"
    " SELECT 9, i || 'History', i || 'history', '/nowhere/tool' || i || '.lsp' FROM n;"
    "PRAGMA user_version=1;"
    "COMMIT;";

class HugeHistory : public testing::Test
{
protected:
    void SetUp() override
    {
        std::filesystem::create_directories(session.profile());
        ASSERT_EQ(runSql(file, kHugeHistory), "");
    }
    void delayReads(const std::string& microseconds)
    {
        session.set("LD_PRELOAD", FAULTY_CALLS);
        session.set("MODRIG_FAULT_DELAY", microseconds);
    }

    HostSession session;
    const std::filesystem::path file = session.profile() / "registry.db";
};
} // namespace

TEST_F(HugeHistory, IsToldAboutWhileItsRegistryIsLookedThrough)
{
    delayReads("100");
    const auto result = session.start({"--safe", "-c", "VERSION"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_NE(result.output.find("Tessel looks through the registry " + file.string() +
                                 ", which takes its time. Ctrl-C ends that.\n"),
              std::string::npos)
        << result.output;
}

TEST_F(HugeHistory, IsOpenedWithoutALookWhenThePersonStopsThat)
{
    delayReads("500");
    session.alwaysWith({"--safe"});
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.shows("takes its time. Ctrl-C ends that.")) << terminal.screen();
    terminal.type(kControlC);
    EXPECT_TRUE(terminal.shows("The registry " + file.string() + " was not looked through to its end."))
        << terminal.screen();
    EXPECT_TRUE(terminal.shows("Command: ")) << terminal.screen();
    terminal.type("REGISTRY GET Software\\Tessel\\R21\\Profiles\r");
    EXPECT_TRUE(terminal.shows("\nDefault\r\n")) << terminal.screen();
    terminal.type("QUIT\r");
    EXPECT_EQ(terminal.waitForEnd(), 0);
    EXPECT_EQ(runSql(file, "SELECT count(*) FROM value WHERE key=9"), "200001");
}

TEST_F(HugeHistory, IsToldAboutWhileItIsReadAndKeptWhenThePersonStopsThat)
{
    ASSERT_EQ(session.start({"--safe", "-c", "VERSION"}).exitStatus, 0); // reads none of it
    delayReads("500");
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.shows("values so far. Ctrl-C stops it.")) << terminal.screen();
    terminal.type(kControlC);
    EXPECT_TRUE(terminal.shows(file.string() +
                               " could not be read: interrupted. Nothing more is stored in this "
                               "session"))
        << terminal.screen();
    EXPECT_TRUE(terminal.shows("Command: ")) << terminal.screen();
    terminal.type("REGISTRY GET Software\\Tessel\\R21\\Profiles\r");
    EXPECT_TRUE(terminal.shows("\nDefault\r\n"))
        << "what is read after it is not stopped" << terminal.screen();
    terminal.type("QUIT\r");
    EXPECT_EQ(terminal.waitForEnd(), 0);
    EXPECT_EQ(runSql(file, "SELECT count(*) FROM value WHERE key=9"), "200001");
}
