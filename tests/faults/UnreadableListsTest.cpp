// SUITE and HISTORY where the registry cannot be read: a list of which nothing is known is not an empty one.
#include <gmock/gmock.h>

#include <sys/stat.h>

#include "tests/e2e/Applications.h"
#include "tests/support/Content.h"
#include "tests/support/Database.h"

namespace fs = std::filesystem;

using testing::AllOf;
using testing::HasSubstr;
using testing::Not;

namespace
{
constexpr char kOfTheSuite[] = "What is in the Startup Suite cannot be read. ";
constexpr char kOfTheHistory[] = "What is in the History list cannot be read. ";

class UnreadableLists : public testing::Test
{
protected:
    UnreadableLists()
    {
        session.alwaysWith({"--safe"});
        EXPECT_EQ(session.run({"SUITE ADD " + application, "HISTORY ADD " + application}).exitStatus, 0);
    }
    ~UnreadableLists() override { chmod(file().c_str(), 0600); }

    fs::path file() const { return session.profile() / "registry.db"; }
    fs::path copy() const { return file().string() + ".sound"; }

    void cutShort() const
    {
        fs::resize_file(file(), 5000);
        for (const char* ending : {"-wal", "-shm"})
            fs::remove(file().string() + ending);
    }

    void takeRightsAway()
    {
        ASSERT_EQ(chmod(file().c_str(), 0), 0);
        session.startBoundByRights();
    }

    // By a program that also changes it whenever it is copied.
    void hold()
    {
        useOldJournal(file());
        session.set("LD_PRELOAD", FAULTY_CALLS);
        session.set("MODRIG_FAULT_TOUCH", "1");
        mHolder.hold(file(), "BEGIN EXCLUSIVE");
    }

    std::string cannotBeUsed(const std::string& reason) const
    {
        return "The registry " + file().string() + " cannot be used: " + reason +
               ". It was left as it is, and nothing will be stored. ";
    }

    // Every command fails, tells the sentence as its own, and changes nothing.
    void expectToldByAll(const std::string& sentence, const std::vector<std::string>& actions) const
    {
        for (const std::string& action : actions)
        {
            expectTold("SUITE " + action, kOfTheSuite + sentence);
            expectTold("HISTORY " + action, kOfTheHistory + sentence);
        }
    }
    void expectTold(const std::string& command, const std::string& sentence) const
    {
        const auto result = session.run({command});
        EXPECT_EQ(result.exitStatus, 1) << command;
        EXPECT_THAT(result.output, AllOf(HasSubstr(sentence), Not(HasSubstr("\"files\""))));
        EXPECT_THAT(result.output, Not(HasSubstr("There is nothing in"))) << command;
    }

    HostSession session;
    const std::string application = sample("primes.zmb");
    const std::vector<std::string> allActions = {
        "LIST", "LIST --json", "ADD " + application, "REMOVE " + application, "CLEAR", "CLEAR --json"};

private:
    DatabaseHolder mHolder;
};
} // namespace

TEST_F(UnreadableLists, OfADamagedRegistryFailWithTheFileTheReasonAndTheWayOut)
{
    cutShort();
    const std::string damaged = contentOf(file());
    expectToldByAll(cannotBeUsed("database disk image is malformed") +
                        "REGISTRY RESTORE puts back the copy of ",
                    allActions);
    expectTold("SUITE MOVE " + application + " 1", kOfTheSuite);
    EXPECT_EQ(contentOf(file()), damaged);
    const auto restored = session.run({"REGISTRY RESTORE", "SUITE LIST", "HISTORY LIST"});
    EXPECT_EQ(restored.exitStatus, 0);
    EXPECT_THAT(restored.output,
                HasSubstr("SUITE LIST\n1  " + application + "\nCommand: HISTORY LIST\n1  " + application));
}

TEST_F(UnreadableLists, WithoutACopyNameTheOtherWayOut)
{
    cutShort();
    fs::remove(copy());
    expectToldByAll(cannotBeUsed("database disk image is malformed") +
                        "There is no copy of an earlier state. REGISTRY RESET sets it aside",
                    {"LIST"});
}

TEST_F(UnreadableLists, ThatMayNotBeReadNameTheRight)
{
    takeRightsAway();
    expectToldByAll(cannotBeUsed("Permission denied") +
                        "Give yourself the right to read and write the file and its folder",
                    allActions);
}

TEST_F(UnreadableLists, ThatAnotherProgramHoldsSaySo)
{
    hold();
    expectToldByAll(cannotBeUsed("another program holds it") + "Close that program, or let it finish",
                    {"LIST --json"});
}

// One entry of it: what stands before and after is read, and is not all that there is.
TEST_F(UnreadableLists, WithADamagedEntryAreNotToldAsIfItWereNotThere)
{
    session.run({"SUITE ADD " + sample("gears.omp")});
    useOldJournal(file());
    runSql(file(), "UPDATE value SET data='/other' WHERE name='1Startup'");
    expectTold("SUITE LIST", kOfTheSuite + ("The registry " + file().string() + " is damaged: the value"));
    expectTold("SUITE ADD " + application, kOfTheSuite);
    const auto history = session.run({"HISTORY LIST"});
    EXPECT_EQ(history.exitStatus, 0);
    EXPECT_THAT(history.output, HasSubstr("1  " + application));
}

TEST_F(UnreadableLists, OnStandardErrorLeaveNothingForProgramsToRead)
{
    cutShort();
    session.startBy("exec \"$0\" \"$@\" 2> '" + (session.folder() / "errors").string() + "'");
    EXPECT_EQ(session.run({"SUITE LIST --json"}).output, "");
    EXPECT_THAT(contentOf(session.folder() / "errors"), HasSubstr(kOfTheSuite));
}

TEST_F(UnreadableLists, ThatAnAdministratorHasLaidDownAreStillTold)
{
    session.folder().write("layout/policy/all.reg",
                           suiteInFile({application}) +
                               "[HKEY_CURRENT_USER\\Software\\Tessel\\R21\\Profiles]\n@=\"Default\"\n");
    session.alwaysWith({"--safe", "--layout-dir", (session.folder() / "layout").string()});
    cutShort();
    const auto result = session.run({"SUITE LIST"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_THAT(result.output, HasSubstr("1  " + application + "  (laid down by the administrator)"));
    expectTold("HISTORY LIST", kOfTheHistory);
}

TEST_F(UnreadableLists, OfWhichOnlyTheDefaultsAreKnownAreNotTakenForThose)
{
    layOutSuite(session, "all.reg", "/default.lsp");
    session.alwaysWith({"--safe", "--layout-dir", (session.folder() / "layout").string()});
    cutShort();
    expectTold("SUITE LIST", kOfTheSuite);
}

TEST_F(UnreadableLists, AreToldOfInGerman)
{
    cutShort();
    session.set("LC_ALL", "de_DE.UTF-8");
    expectTold("SUITE LIST", "Was in der Startgruppe steht, kann nicht gelesen werden. Die Registrierung ");
}
