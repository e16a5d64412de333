// A registry that cannot be written, many sessions that begin at once, a folder of the network: in the real
// program, with Modrig and its Startup Suite.
#include <gmock/gmock.h>

#include <cerrno>
#include <csignal>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostTerminal.h"
#include "tests/support/Database.h"

namespace fs = std::filesystem;

using testing::AnyOf;
using testing::HasSubstr;
using testing::Not;

namespace
{
std::size_t countOf(const std::string& words, const std::string& text)
{
    std::size_t count = 0;
    for (std::size_t at = text.find(words); at != text.npos; at = text.find(words, at + 1))
        ++count;
    return count;
}

class TroubledStore : public testing::Test
{
protected:
    TroubledStore() { storeSuite(session, {fixtureModule("Good.zmb"), lispFixture("good.lsp")}); }

    fs::path file() const { return session.profile() / "registry.db"; }

    void failWith(const std::string& fault)
    {
        session.set("LD_PRELOAD", FAULTY_CALLS);
        session.set("MODRIG_FAULT", fault);
    }
    void failNoMore()
    {
        session.set("LD_PRELOAD", "");
        session.startBy("exec \"$0\" \"$@\"");
    }

    // The Suite is loaded, and one line names the registry.
    void expectSuiteAndOneSentence(const std::string& trouble)
    {
        SCOPED_TRACE(trouble);
        const auto result = session.run({"VERSION", "APPS"});
        EXPECT_EQ(result.exitStatus, 0);
        EXPECT_THAT(result.output, HasSubstr("Good.zmb: message 1\ngood.lsp: loaded\n"));
        EXPECT_EQ(countOf(file().string(), result.output), 1u) << result.output;
    }

    HostSession session;
};
} // namespace

TEST_F(TroubledStore, IsReadWhereFilesMayNotGrow)
{
    for (const char* blocks : {"0", "1", "16"})
    {
        session.startBy(std::string("ulimit -f ") + blocks + "; exec \"$0\" \"$@\"");
        expectSuiteAndOneSentence(blocks);
    }
    failNoMore();
    EXPECT_THAT(session.run({"VERSION"}).output, Not(HasSubstr("egistry")));
}

TEST_F(TroubledStore, IsReadWhereTheFolderMayNotBeWritten)
{
    failWith("create 1 ever " + std::to_string(EROFS));
    expectSuiteAndOneSentence("EROFS");
    failWith("create 1 ever " + std::to_string(EACCES));
    expectSuiteAndOneSentence("EACCES");
}

TEST_F(TroubledStore, IsReadWithTheLogOfAKilledSessionWhereNothingMayBeWritten)
{
    storeSuite(session, {fixtureModule("Good.zmb")});
    {
        HostTerminal terminal(session, {"--safe"});
        ASSERT_TRUE(terminal.shows("Command: ")) << terminal.screen();
        terminal.type(setInSuite("NumStartup", "2") + "\rVERSION\r");
        ASSERT_TRUE(terminal.shows("\nTessel R21")) << terminal.screen();
        ASSERT_EQ(kill(terminal.process(), SIGKILL), 0);
        EXPECT_EQ(terminal.waitForEnd(), -SIGKILL);
    }
    ASSERT_GT(fs::file_size(file().string() + "-wal"), 0u);
    failWith("ftruncate 1 ever " + std::to_string(ENOSPC));
    expectSuiteAndOneSentence("no room for the log");
}

TEST_F(TroubledStore, IsMadeByTwentyFirstSessionsAtOnce)
{
    fs::remove_all(session.profile());
    session.startBy("for i in 1 2 3 4 5 6 7 8 9 10 11 12 13 14 15 16 17 18 19 20; do"
                    " \"$0\" \"$@\" -c \"REGISTRY SET Software\\\\Trial name$i $i\" & done; wait");
    const auto result = session.run({"VERSION"});
    failNoMore();
    EXPECT_THAT(result.output, Not(HasSubstr("egistry " + file().string()))) << result.output;
    EXPECT_THAT(result.output, Not(HasSubstr("locked")));
    EXPECT_EQ(runSql(file(), "SELECT count(*) FROM value WHERE name LIKE 'name%'"), "20");
    EXPECT_EQ(runSql(file(), "PRAGMA journal_mode"), "wal");
    for (const auto& entry : fs::directory_iterator(session.profile()))
        EXPECT_THAT(
            entry.path().filename().string(),
            AnyOf("registry.db", "registry.db.sound", Not(AnyOf(HasSubstr("registry"), HasSubstr(".part")))))
            << "left over";
}

TEST_F(TroubledStore, IsMadeAndUsedWithoutSharedMemoryInAFolderOfTheNetwork)
{
    session.set("LD_PRELOAD", FAULTY_CALLS);
    session.set("MODRIG_FAULT_NETWORK", "1");
    const auto moved = session.run({"APPS"});
    EXPECT_EQ(moved.exitStatus, 0);
    EXPECT_THAT(moved.output, HasSubstr("Good.zmb: message 1\ngood.lsp: loaded\n"));
    EXPECT_THAT(moved.output, Not(HasSubstr("egistry")));
    EXPECT_EQ(runSql(file(), "PRAGMA journal_mode"), "delete") << "a profile that was moved there";
    fs::remove_all(session.profile());
    const auto counts = session.folder() / "counts";
    session.set("MODRIG_FAULT_COUNTS", counts.string());
    storeSuite(session, {lispFixture("good.lsp")});
    EXPECT_EQ(runSql(file(), "PRAGMA journal_mode"), "delete") << "one that was made there";
    EXPECT_THAT(contentOf(counts), HasSubstr("\nmmap 0\n"));
}

TEST_F(TroubledStore, IsSharedInAFolderOfTheNetwork)
{
    session.set("LD_PRELOAD", FAULTY_CALLS);
    session.set("MODRIG_FAULT_NETWORK", "1");
    session.startBy("for i in 1 2 3 4 5 6 7 8; do"
                    " \"$0\" \"$@\" -c \"REGISTRY SET Software\\\\Trial name$i $i\" & done; wait");
    const auto result = session.run({"VERSION"});
    EXPECT_THAT(result.output, Not(HasSubstr("egistry " + file().string()))) << result.output;
    EXPECT_EQ(runSql(file(), "SELECT count(*) FROM value WHERE name LIKE 'name%'"), "8");
}

TEST_F(TroubledStore, IsRestoredByTheCommand)
{
    const std::string whole = contentOf(file());
    std::ofstream(file(), std::ios::binary) << whole.substr(0, whole.size() / 2);
    const auto damaged = session.run({"REGISTRY RESTORE", "REGISTRY SET Software\\Trial name 1"});
    EXPECT_EQ(damaged.exitStatus, 1);
    EXPECT_THAT(damaged.output,
                HasSubstr("nothing will be stored. REGISTRY RESTORE puts back the copy of 2"));
    EXPECT_THAT(damaged.output, HasSubstr("was restored from the copy of 2"));
    EXPECT_THAT(damaged.output, HasSubstr("Start Tessel again: this session stores nothing more.\n"));
    EXPECT_THAT(damaged.output, HasSubstr("cannot be written. "));
    const auto next = session.run({"VERSION", "REGISTRY RESTORE"});
    EXPECT_THAT(next.output, HasSubstr("Good.zmb: message 1\ngood.lsp: loaded\n"));
    EXPECT_THAT(next.output, HasSubstr("is not known to be damaged; it was left as it is."));
}
