// A registry where nothing can be written, or that may not even be read: the real program says once what is
// the matter and what helps, and loads the Startup Suite from what is sound.
#include <gmock/gmock.h>

#include <cerrno>
#include <csignal>

#include <sys/stat.h>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostTerminal.h"
#include "tests/support/Database.h"

namespace fs = std::filesystem;

using testing::AllOf;
using testing::HasSubstr;
using testing::Not;

namespace
{
constexpr char kGrantRights[] =
    " Give yourself the right to read and write the file and its folder, and start Tessel again.\n";

constexpr char kSuiteIsThere[] = "Good.zmb: message 1\ngood.lsp: loaded\n";

std::size_t timesIn(const std::string& words, const std::string& text)
{
    std::size_t count = 0;
    for (std::size_t at = text.find(words); at != text.npos; at = text.find(words, at + 1))
        ++count;
    return count;
}

class UnwritableStore : public testing::Test
{
protected:
    UnwritableStore() { storeSuite(session, {fixtureModule("Good.zmb"), lispFixture("good.lsp")}); }
    ~UnwritableStore() override { giveRights(session.profile(), 0700); }

    fs::path file() const { return session.profile() / "registry.db"; }
    fs::path beside(const std::string& ending) const { return file().string() + ending; }

    void giveRights(const fs::path& path, mode_t rights)
    {
        EXPECT_EQ(chmod(path.c_str(), rights), 0) << path;
        session.startBoundByRights();
    }

    void failWith(const std::string& fault)
    {
        session.set("LD_PRELOAD", FAULTY_CALLS);
        session.set("MODRIG_FAULT", fault);
    }

    // That the Suite has two entries stands in nothing but the log of a session that was killed.
    void leaveLog()
    {
        storeSuite(session, {fixtureModule("Good.zmb")});
        HostTerminal terminal(session, {"--safe"});
        ASSERT_TRUE(terminal.awaitPrompt());
        terminal.type(setInSuite("2Startup", lispFixture("good.lsp")) + "\r");
        terminal.type(setInSuite("NumStartup", "2") + "\rVERSION\r");
        ASSERT_TRUE(terminal.shows("\nTessel R21")) << terminal.screen();
        ASSERT_EQ(kill(terminal.process(), SIGKILL), 0);
        EXPECT_EQ(terminal.waitForEnd(), -SIGKILL);
        fs::remove(beside("-shm"));
    }

    // As a session leaves it that is killed when it has written a part of this.
    void leaveHalfWritten(const char* sql)
    {
        sqlite3* database = nullptr;
        ASSERT_EQ(sqlite3_open(file().c_str(), &database), SQLITE_OK);
        ASSERT_EQ(sqlite3_exec(database, sql, nullptr, nullptr, nullptr), SQLITE_OK);
        ASSERT_EQ(sqlite3_db_cacheflush(database), SQLITE_OK);
        fs::copy_file(file(), beside(".killed"));
        fs::copy_file(beside("-journal"), beside(".killed-journal"));
        sqlite3_close(database);
        fs::rename(beside(".killed"), file());
        fs::rename(beside(".killed-journal"), beside("-journal"));
    }

    // Nothing else is said of the registry, and the Suite is there.
    void expectReadAndTold(const std::string& reason, const std::string& help)
    {
        const auto result = session.run({"VERSION"});
        EXPECT_EQ(result.exitStatus, 0);
        EXPECT_THAT(result.output,
                    AllOf(HasSubstr("Nothing can be stored in the registry " + file().string() + ": " +
                                    reason + ". What is stored there is used. " + help + "\n"),
                          HasSubstr(kSuiteIsThere)));
        EXPECT_EQ(
            timesIn(file().string() + " ", result.output) + timesIn(file().string() + ":", result.output), 1u)
            << result.output;
    }

    void expectRefused(const std::string& reason)
    {
        const auto result = session.run({"VERSION"});
        EXPECT_EQ(result.exitStatus, 0);
        EXPECT_THAT(result.output,
                    HasSubstr("The registry " + file().string() + " cannot be used: " + reason));
    }

    HostSession session;
};

constexpr char kFolder[] = "its folder may not be written";
constexpr char kGrant[] =
    "Give yourself the right to read and write the file and its folder, and start Tessel again.";
constexpr char kMakeRoom[] = "Make room on the disk, and start Tessel again.";
constexpr char kLiftLimit[] = "Lift the limit on the size of files, and start Tessel again.";
} // namespace

TEST_F(UnwritableStore, OnAFullDiskNamesThatReason)
{
    failWith("pwrite 1 ever " + std::to_string(ENOSPC));
    expectReadAndTold("No space left on device", kMakeRoom);
    useOldJournal(file());
    expectReadAndTold("No space left on device", kMakeRoom);
}

TEST_F(UnwritableStore, WhereFilesMayNotGrowNamesThatReason)
{
    session.startBy("ulimit -f 0; exec \"$0\" \"$@\"");
    expectReadAndTold("File too large", kLiftLimit);
    useOldJournal(file());
    expectReadAndTold("File too large", kLiftLimit);
}

TEST_F(UnwritableStore, InAFolderThatMayNotBeWrittenNamesThatReason)
{
    giveRights(session.profile(), 0555);
    expectReadAndTold(kFolder, kGrant);
    giveRights(session.profile(), 0700);
    useOldJournal(file());
    giveRights(session.profile(), 0555);
    expectReadAndTold(kFolder, kGrant);
}

TEST_F(UnwritableStore, WithAFolderInTheWayOfAJournalNamesIt)
{
    for (const char* ending : {"-wal", "-shm", "-journal"})
    {
        fs::create_directory(beside(ending));
        for (const bool isEmpty : {true, false})
        {
            if (!isEmpty)
                session.folder().write("profile/registry.db" + std::string(ending) + "/in the way", "");
            expectReadAndTold("what stands at " + beside(ending).string() +
                                  " is in its way: it is a folder, not a file",
                              "Remove that, and start Tessel again.");
        }
        fs::remove_all(beside(ending));
    }
    EXPECT_THAT(session.run({"VERSION"}).output, Not(HasSubstr("egistry")));
}

TEST_F(UnwritableStore, ThatMayNotBeReadNamesTheRights)
{
    giveRights(file(), 0);
    expectRefused(std::string("Permission denied. It was left as it is, and nothing will be stored.") +
                  kGrantRights);
}

TEST_F(UnwritableStore, InAFolderThatMayNotBeEnteredNamesTheRights)
{
    giveRights(session.profile(), 0);
    expectRefused(std::string("Permission denied. Nothing will be stored.") + kGrantRights);
}

TEST_F(UnwritableStore, ThatCannotBeMadeIsNotCalledLeftAsItIs)
{
    fs::remove(file());
    fs::remove(beside(".sound"));
    giveRights(session.profile(), 0555);
    expectRefused(
        "it cannot be made: Permission denied. Nothing will be stored. Make sure that files can be made "
        "and opened there, and start Tessel again.\n");
}

TEST_F(UnwritableStore, TellsAFailedWriteOnceInWords)
{
    session.alwaysWith({"--safe"});
    session.startBy("ulimit -f 80; exec \"$0\" \"$@\"");
    const std::string tooBig = "REGISTRY SET Software\\Trial big " + std::string(100'000, 'x');
    const auto result = session.run({tooBig});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(
        result.output,
        testing::EndsWith("xx\nThe registry key \"Software\\Trial\" cannot be written. The registry " +
                          file().string() +
                          " could not be written: File too large. What was stored before is unchanged. "
                          "Lift the limit on the size of files, and try again.\n"));
}

TEST_F(UnwritableStore, TellsThatNoRoomIsLeftForAWrite)
{
    session.alwaysWith({"--safe"});
    const char* const sql = "REGISTRY SET Software\\Trial name 1";
    failWith("write 1 ever " + std::to_string(ENOSPC));
    for (const char* fault : {"pwrite 6 ever ", "pwrite 8 ever ", "pwrite 10 ever "})
    {
        failWith(fault + std::to_string(ENOSPC));
        const auto result = session.run({sql});
        EXPECT_THAT(result.output, AllOf(HasSubstr("No space left on device. "), Not(HasSubstr("error")),
                                         Not(HasSubstr("database"))))
            << fault;
    }
}

// As a system makes it that has met an error of the disk.
TEST_F(UnwritableStore, OfAFileSystemThatMayOnlyBeReadSaysThatRightsDoNotHelp)
{
    failWith("pwrite 1 ever " + std::to_string(EROFS));
    expectReadAndTold("Read-only file system", "Have the file system made writable, and start Tessel again.");
    session.alwaysWith({"--safe"});
    failWith("pwrite 12 ever " + std::to_string(EROFS));
    const auto result = session.run({"REGISTRY SET Software\\Trial name 1"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output,
                HasSubstr(" could not be written: Read-only file system. What was stored before is "
                          "unchanged. Have the file system made writable, and try again.\n"));
}

TEST_F(UnwritableStore, ReadsALogThatAKilledSessionHasLeft)
{
    leaveLog();
    giveRights(session.profile(), 0555);
    expectReadAndTold(kFolder, kGrant);
}

TEST_F(UnwritableStore, ReadsALogThatAKilledSessionHasLeftWhereTheFileMayNotBeWrittenEither)
{
    leaveLog();
    const std::string log = contentOf(beside("-wal"));
    giveRights(file(), 0400);
    giveRights(session.profile(), 0555);
    const auto result = session.run({"VERSION"});
    EXPECT_THAT(result.output, AllOf(HasSubstr("registry.db may only be read: what is stored there is used"),
                                     HasSubstr(kSuiteIsThere)));
    EXPECT_EQ(contentOf(beside("-wal")), log);
}

// What it had not finished is undone, also where that cannot be written down.
TEST_F(UnwritableStore, ReadsWhatWasStoredBeforeASessionWasKilledInTheMidstOfWriting)
{
    useOldJournal(file());
    leaveHalfWritten("BEGIN; UPDATE value SET data='/half of it'");
    ASSERT_NE(contentOf(file()).find("/half of it"), std::string::npos);
    giveRights(session.profile(), 0555);
    expectReadAndTold(kFolder, kGrant);
}
