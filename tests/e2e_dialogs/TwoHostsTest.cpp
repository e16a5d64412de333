// Two hosts on one profile, each with its dialog, in front of two persons.
#include <sstream>
#include <thread>

#include "tests/e2e_dialogs/DialogTest.h"

using testing::HasSubstr;
using testing::Not;

namespace
{
// Another host of the same session, on a display of its own.
class OtherHost
{
public:
    explicit OtherHost(const HostSession& session)
    {
        auto environment = session.environment();
        std::erase_if(environment, [](const auto& variable) { return variable.starts_with("DISPLAY="); });
        environment.push_back("DISPLAY=" + mScreen.display());
        mHost = std::make_unique<Program>(session.commandLine({}), environment,
                                          session.folder() / "other output.txt");
    }

    void open()
    {
        mHost->type("MODRIG");
        mDialog = mScreen.waitForActive(kDialog);
        ASSERT_FALSE(mDialog.empty()) << mHost->output();
    }
    void click(Place place) const { mScreen.click(mDialog, place); }
    void pressEscape() const { mScreen.key("Escape"); }
    bool isClosed() const { return mScreen.waitUntilGone(kDialog); }
    bool prints(const std::string& text) const
    {
        return comesTrue([&] { return mHost->output().find(text) != std::string::npos; });
    }
    std::string end()
    {
        mHost->type("QUIT");
        EXPECT_TRUE(mHost->endsByItself());
        return mHost->output();
    }

private:
    Screen mScreen;
    std::unique_ptr<Program> mHost;
    std::string mDialog;
};

class TwoHosts : public DialogTest
{
protected:
    // The list as REGISTRY LIST shows it is whole: a count, and as many entries, numbered from 1.
    static void expectWhole(const std::string& list)
    {
        std::istringstream lines(list);
        std::string line;
        std::getline(lines, line);
        ASSERT_THAT(line, testing::StartsWith("NumHistory = ")) << list;
        const int count = std::stoi(line.substr(line.rfind(' ')));
        for (int number = 1; number <= count; ++number)
        {
            ASSERT_TRUE(std::getline(lines, line)) << number << " of " << count;
            ASSERT_THAT(line, testing::StartsWith(std::to_string(number) + "History = "));
        }
        EXPECT_FALSE(std::getline(lines, line)) << line;
    }
};
} // namespace

TEST_F(TwoHosts, AnOpenDialogStoresAtOnceAndKeepsNoLock)
{
    writeLisp("a.lsp");
    open();
    setSetting("InitialPath", "/elsewhere");
    loadFile(0, "a.lsp");
    EXPECT_TRUE(comesTrue([&] { return storedSetting("InitialPath") == files().string() + "\n"; }));
    EXPECT_THAT(runQuietly({"REGISTRY SET Software\\Trial name data", "REGISTRY GET Software\\Trial name"}),
                HasSubstr("\ndata\n"));
    EXPECT_THAT(closeAndEnd(), Not(HasSubstr("registry")));
}

TEST_F(TwoHosts, AMessageBoxKeepsNoLock)
{
    writeLisp("a.lsp");
    writeBroken();
    open();
    loadBroken(1);
    EXPECT_THAT(runQuietly({"REGISTRY SET Software\\Trial name data", "REGISTRY GET Software\\Trial name"}),
                HasSubstr("\ndata\n"));
    dismissMessageBox();
    EXPECT_THAT(closeAndEnd(), Not(HasSubstr("registry")));
}

TEST_F(TwoHosts, TheLastToCloseWins)
{
    const std::string first = writeLisp("a.lsp");
    const std::string second = writeLisp("b.lsp");
    setSetting("SaveHistory", "1");
    open();
    loadFile(0, "a.lsp");
    OtherHost other(mSession);
    other.open();
    other.click(places::file(1));
    other.click(places::kLoad);
    EXPECT_TRUE(other.prints(wasLoaded("b.lsp")));
    EXPECT_THAT(closeAndEnd(), Not(HasSubstr("registry")));
    EXPECT_EQ(stored("History"), "NumHistory = 1\n1History = " + first + "\n");
    other.pressEscape();
    EXPECT_TRUE(other.isClosed());
    EXPECT_THAT(other.end(), Not(HasSubstr("registry")));
    EXPECT_EQ(stored("History"), "NumHistory = 1\n1History = " + second + "\n");
}

// Another program has the file, and does not let go in time.
TEST_F(TwoHosts, ListsThatCannotBeStoredFailAsAWholeAndAreTold)
{
    const std::string path = writeLisp("a.lsp");
    storeHistory({"/before.lsp"});
    setSetting("SaveHistory", "1");
    open();
    loadFile(0, "a.lsp");
    {
        const std::string file = (mSession.profile() / "registry.db").string();
        const std::string lock = "import sqlite3, time\n"
                                 "registry = sqlite3.connect('" +
                                 file +
                                 "', isolation_level=None)\n"
                                 "registry.execute('BEGIN IMMEDIATE')\n"
                                 "print('locked', flush=True)\n"
                                 "time.sleep(100)\n";
        const Program other({"/usr/bin/python3", "-c", lock}, mScreen.environment(),
                            mSession.folder() / "lock.txt");
        ASSERT_TRUE(comesTrue([&] { return other.output() == "locked\n"; })) << other.output();
        press("Escape");
        EXPECT_TRUE(
            prints("The registry " + file +
                   " could not be written: another program holds it. What was stored before is unchanged. "
                   "Close that program, or let it finish, and try again.\n"))
            << mHost->output();
        EXPECT_THAT(mHost->output(), HasSubstr("Message: A list of applications could not be stored"));
    }
    EXPECT_EQ(stored("History"), "NumHistory = 1\n1History = /before.lsp\n");
    openAgain();
    closeAndEnd();
    EXPECT_EQ(stored("History"), "NumHistory = 2\n1History = /before.lsp\n2History = " + path + "\n");
}

TEST_F(TwoHosts, NeverLeaveAListHalfDeletedWhenTheyCloseTogether)
{
    constexpr int kRounds = 4;
    std::vector<std::string> many;
    for (int number = 1; number <= 400; ++number)
        many.push_back("/a/file " + std::to_string(number) + ".lsp");
    storeHistory(many);
    writeLisp("a.lsp");
    writeLisp("b.lsp");
    setSetting("SaveHistory", "1");
    OtherHost other(mSession);
    open();
    other.open();
    loadFile(0, "a.lsp"); // the lists that they store are of different lengths from now on
    for (int round = 1; round <= kRounds; ++round)
    {
        std::thread closing([&] { other.pressEscape(); });
        press("Escape");
        expectWhole(stored("History"));
        closing.join();
        EXPECT_TRUE(mScreen.waitUntilGone(kDialog));
        EXPECT_TRUE(other.isClosed());
        expectWhole(stored("History"));
        openAgain();
        other.open();
    }
    other.pressEscape();
    EXPECT_TRUE(other.isClosed());
    EXPECT_THAT(other.end(), Not(HasSubstr("registry")));
    EXPECT_THAT(closeAndEnd(), Not(HasSubstr("registry")));
    EXPECT_THAT(stored("History"), testing::StartsWith("NumHistory = 401\n"));
}
