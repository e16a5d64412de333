// Applications that ended the host: named at the next start and kept out, tried once more at the one after
// that, and kept out for good when they end it again.
#include <algorithm>
#include <chrono>
#include <csignal>
#include <fstream>

#include <gmock/gmock.h>

#include <sys/inotify.h>
#include <sys/stat.h>
#include <unistd.h>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostTerminal.h"
#include "tests/support/Content.h"

namespace fs = std::filesystem;

using testing::AllOf;
using testing::ContainsRegex;
using testing::HasSubstr;
using testing::Not;

namespace
{
constexpr char kThisTime[] = "It is not loaded by itself at this start; the next one lets it in once more.\n";
constexpr char kForGood[] =
    "It is not loaded by itself any more, until you load it by hand or let it in (ENABLE), "
    "or its file changes.\n";
constexpr char kIsDamaged[] = " is damaged; without it Tessel does not know which applications to keep out. "
                              "Remove it to begin with none.\n";
constexpr char kDay[] = "on [0-9]{4}-[0-9]{2}-[0-9]{2} [0-9]{2}:[0-9]{2}";

// Whether anybody opens the file while this object lives.
class OpeningWatch
{
public:
    explicit OpeningWatch(const std::string& file) : mWatch(inotify_init1(IN_NONBLOCK | IN_CLOEXEC))
    {
        EXPECT_GE(inotify_add_watch(mWatch, file.c_str(), IN_OPEN), 0);
    }
    ~OpeningWatch() { close(mWatch); }
    OpeningWatch(const OpeningWatch&) = delete;
    OpeningWatch& operator=(const OpeningWatch&) = delete;

    bool wasOpened() const
    {
        char events[4096];
        return read(mWatch, events, sizeof events) > 0;
    }

private:
    int mWatch;
};

class KeptOut : public testing::Test
{
protected:
    std::string startSays() const { return session.run({"VERSION"}).output; }

    // What is said at the start about one that ended the host.
    static std::string named(const std::string& path, const std::string& what)
    {
        return "The application \"" + path + "\" ended Tessel " + kDay + " " + what;
    }

    HostSession session;
    std::string good = fixtureModule("Good.zmb");
};

constexpr char kInSuite[] = R"(while its entry point ran \(loaded from the Startup Suite\): memory fault)";
} // namespace

TEST_F(KeptOut, IsWhatEndedTheHostFromTheStartupSuiteAndEverythingElseIsLoaded)
{
    const std::string bad = deadly(session, "segv");
    storeSuite(session, {good, bad, lispFixture("good.lsp")});
    EXPECT_EQ(session.run({"VERSION"}).exitStatus, -SIGSEGV);
    const OpeningWatch watch(bad);
    const auto next = session.run({"VERSION"});
    EXPECT_EQ(next.exitStatus, 0) << next.output;
    EXPECT_THAT(next.output, ContainsRegex(named(bad, kInSuite)));
    EXPECT_THAT(next.output, HasSubstr(kThisTime));
    EXPECT_EQ(next.output.find(bad), next.output.rfind(bad)) << "said once: " << next.output;
    EXPECT_THAT(next.output, Not(HasSubstr("could not be loaded")));
    EXPECT_THAT(next.output, HasSubstr("Good.zmb: message 1\n"));
    EXPECT_THAT(next.output, HasSubstr("good.lsp: loaded\n"));
    EXPECT_THAT(next.output, Not(HasSubstr("segv.zmb: message 1")));
    EXPECT_FALSE(watch.wasOpened());
}

TEST_F(KeptOut, IsTriedOnceMoreAndThenKeptOutForGood)
{
    const std::string bad = deadly(session, "abort");
    storeSuite(session, {bad});
    EXPECT_EQ(session.run({}).exitStatus, -SIGABRT);
    EXPECT_EQ(session.run({"VERSION"}).exitStatus, 0);
    const auto third = session.run({"VERSION"});
    EXPECT_EQ(third.exitStatus, -SIGABRT);
    EXPECT_THAT(third.output,
                HasSubstr("The application \"" + bad + "\" is tried once more: it ended Tessel "));
    EXPECT_THAT(startSays(), HasSubstr(kForGood));
    for (int start = 0; start < 3; ++start)
    {
        const auto result = session.run({"VERSION"});
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        EXPECT_THAT(result.output,
                    AllOf(HasSubstr("\"" + bad + "\" is not loaded: it is kept out because it ended "),
                          Not(HasSubstr(kForGood)), Not(HasSubstr("could not be loaded"))));
    }
}

TEST_F(KeptOut, StaysInTheStartupSuiteAndIsShownWithTheReasonAndTheDay)
{
    const std::string bad = deadly(session, "segv");
    storeSuite(session, {bad});
    session.run({});
    const auto result = session.run({"APPS", std::string("REGISTRY GET ") + kSuiteKey + " 1Startup"});
    EXPECT_THAT(result.output, HasSubstr("\n" + bad + "\n"));
    EXPECT_THAT(result.output, ContainsRegex("  segv\\.zmb .* kept out because it ended Tessel " +
                                             std::string(kDay) + " " + kInSuite));
}

TEST_F(KeptOut, IsNotForGoodWhatWasAtWorkWhenThePowerWent)
{
    const auto flag = session.folder().write("flag", "");
    const auto file =
        session.folder().write("slow.lsp", "(write-line \"slow.lsp: begun\")\n(when (probe-file \"" +
                                               flag.string() + "\") (loop))\n");
    storeSuite(session, {file.string()});
    {
        HostTerminal terminal(session);
        ASSERT_TRUE(terminal.shows("slow.lsp: begun")) << terminal.screen();
        kill(terminal.process(), SIGKILL);
        EXPECT_EQ(terminal.waitForEnd(), -SIGKILL);
    }
    fs::remove(flag);
    const std::string second = startSays();
    EXPECT_THAT(
        second,
        ContainsRegex(named(
            file,
            R"(while its Lisp ran \(loaded from the Startup Suite\): it ended without a signal that can be caught, by "_exit", a kill or a power cut\.)")));
    EXPECT_EQ(second.find(file.string()), second.rfind(file.string())) << "said once: " << second;
    EXPECT_THAT(second, Not(HasSubstr("could not be loaded")));
    EXPECT_THAT(second, Not(HasSubstr("slow.lsp: begun")));
    EXPECT_THAT(startSays(), AllOf(HasSubstr("is tried once more"), HasSubstr("slow.lsp: begun")));
    const std::string fourth = startSays();
    EXPECT_THAT(fourth, AllOf(HasSubstr("slow.lsp: begun"), Not(HasSubstr("ended Tessel"))));
    EXPECT_THAT(session.run({"APPS"}).output, Not(HasSubstr("kept out")));
}

TEST_F(KeptOut, IsLetInByLoadingItByHandWithSuccess)
{
    const std::string bad = deadly(session, "segv-command");
    storeSuite(session, {bad});
    EXPECT_EQ(session.run({"PERISH"}).exitStatus, -SIGSEGV);
    const auto byHand = session.run({"LOAD " + bad, "APPS"});
    EXPECT_EQ(byHand.exitStatus, 0) << byHand.output;
    EXPECT_THAT(byHand.output, ContainsRegex(named(bad, "while its command \"PERISH\" ran")));
    EXPECT_THAT(byHand.output, HasSubstr(bad + " is loaded.\n"));
    EXPECT_THAT(byHand.output.substr(byHand.output.find("Command: APPS")), Not(HasSubstr("kept out")));
    EXPECT_THAT(startSays(), AllOf(HasSubstr("segv-command.zmb: message 1"), Not(HasSubstr("ended Tessel"))));
}

TEST_F(KeptOut, IsNotLetInByLoadingItByHandInVain)
{
    const std::string bad = deadly(session, "abort");
    EXPECT_EQ(session.run({"LOAD " + bad}).exitStatus, -SIGABRT);
    EXPECT_EQ(session.run({"LOAD " + bad}).exitStatus, -SIGABRT);
    EXPECT_THAT(startSays(), HasSubstr("(asked for by hand)"));
}

TEST_F(KeptOut, IsNotForGoodWhatEndedTheHostTwiceButWasNeverTried)
{
    const std::string bad = deadly(session, "abort");
    EXPECT_EQ(session.run({"LOAD " + bad}).exitStatus, -SIGABRT);
    EXPECT_EQ(session.run({"LOAD " + bad}).exitStatus, -SIGABRT);
    EXPECT_THAT(startSays(),
                AllOf(HasSubstr(kThisTime), Not(HasSubstr("is tried once more:")), Not(HasSubstr(kForGood))));
    const std::string third = startSays();
    EXPECT_THAT(third, Not(HasSubstr("tried"))) << "nothing loads it";
    EXPECT_THAT(third, Not(HasSubstr("ended Tessel")));
}

// Years may lie between two crashes of what is only ever loaded by hand.
TEST_F(KeptOut, IsForgottenWhenASessionEndsWellInWhichNothingLoadedIt)
{
    const std::string bad = deadly(session, "abort");
    EXPECT_EQ(session.run({"LOAD " + bad}).exitStatus, -SIGABRT);
    EXPECT_THAT(startSays(), HasSubstr(kThisTime));
    EXPECT_THAT(startSays(), Not(HasSubstr("is tried once more"))) << "nothing loads it";
    EXPECT_EQ(session.run({"LOAD " + bad}).exitStatus, -SIGABRT);
    EXPECT_THAT(startSays(), AllOf(HasSubstr(kThisTime), Not(HasSubstr(kForGood))));
}

// Nothing was tried in it.
TEST_F(KeptOut, IsNotForgottenWhenASafeSessionEndsWell)
{
    const std::string bad = deadly(session, "abort");
    storeSuite(session, {bad});
    EXPECT_EQ(session.run({}).exitStatus, -SIGABRT);
    EXPECT_EQ(session.run({}).exitStatus, 0);
    EXPECT_EQ(session.run({}).exitStatus, -SIGABRT);
    session.start({"--safe", "-c", "VERSION"});
    EXPECT_THAT(startSays(), HasSubstr("\"" + bad + "\" is not loaded: it is kept out because "));
}

namespace
{
// Kept out for good.
class KeptOutForGood : public KeptOut
{
protected:
    void SetUp() override
    {
        storeSuite(session, {bad});
        for (const int status : {-SIGABRT, 0, -SIGABRT, 0})
            EXPECT_EQ(session.run({"VERSION"}).exitStatus, status);
    }

    // Writes other content of the same length and gives the file its time again.
    void replaceSecretly() const
    {
        const auto time = fs::last_write_time(bad);
        std::string content = contentOf(bad);
        const auto at = content.find("-constructor");
        ASSERT_NE(at, std::string::npos);
        content[at] = 'X';
        std::ofstream(bad, std::ios::binary) << content;
        fs::last_write_time(bad, time);
    }

    std::string bad = deadly(session, "abort");
};
} // namespace

TEST_F(KeptOutForGood, IsTriedAgainWhenItsFileIsAnotherOne)
{
    fs::remove(bad);
    fs::copy_file(good, bad);
    EXPECT_THAT(startSays(), AllOf(HasSubstr("abort.zmb: message 1"), Not(HasSubstr("kept out"))));
    EXPECT_THAT(session.run({"APPS"}).output, Not(HasSubstr("kept out")));
}

TEST_F(KeptOutForGood, IsTriedAgainWhenItsTimeIsAnotherOne)
{
    fs::last_write_time(bad, fs::last_write_time(bad) + std::chrono::seconds(1));
    EXPECT_EQ(session.run({"VERSION"}).exitStatus, -SIGABRT);
}

TEST_F(KeptOutForGood, IsTriedAgainWhenOnlyItsContentIsAnotherOne)
{
    replaceSecretly();
    EXPECT_EQ(session.run({"VERSION"}).exitStatus, -SIGABRT);
}

TEST_F(KeptOutForGood, StaysOutWhenTheSameFileWasPutThereAgain)
{
    const auto time = fs::last_write_time(bad);
    const std::string content = contentOf(bad);
    fs::remove(bad);
    std::ofstream(bad, std::ios::binary) << content;
    fs::last_write_time(bad, time);
    EXPECT_THAT(startSays(), HasSubstr("\"" + bad + "\" is not loaded: it is kept out because "));
    const OpeningWatch watch(bad);
    EXPECT_EQ(session.run({"VERSION"}).exitStatus, 0);
    EXPECT_FALSE(watch.wasOpened()) << "compared once, it is known again";
}

TEST_F(KeptOutForGood, StaysOutByWhateverPathItIsAskedFor)
{
    const auto link = session.folder() / "link.zmb";
    fs::create_symlink(bad, link);
    storeSuite(session, {link.string()});
    EXPECT_THAT(startSays(), HasSubstr("\"" + link.string() + "\" is not loaded: it is kept out because "));
}

TEST_F(KeptOutForGood, StaysOutWhileItsFileIsGone)
{
    const auto elsewhere = session.folder() / "elsewhere";
    fs::rename(bad, elsewhere);
    EXPECT_THAT(startSays(), HasSubstr("\"" + bad + "\" is not loaded: it is kept out because "));
    fs::rename(elsewhere, bad);
    EXPECT_EQ(session.run({"VERSION"}).exitStatus, 0) << "it is the same file";
}

TEST_F(KeptOut, AreBothOfTwoThatEndTheHostInTurn)
{
    const std::string first = deadly(session, "segv");
    const std::string second = deadly(session, "abort");
    storeSuite(session, {first, second, good});
    std::vector<int> statuses;
    for (int start = 0; start < 6; ++start)
        statuses.push_back(session.run({"VERSION"}).exitStatus);
    EXPECT_THAT(statuses, testing::ElementsAre(-SIGSEGV, -SIGABRT, -SIGSEGV, -SIGABRT, 0, 0));
    EXPECT_THAT(startSays(), AllOf(HasSubstr("\"" + first + "\" is not loaded: it is kept out"),
                                   HasSubstr("\"" + second + "\" is not loaded: it is kept out"),
                                   HasSubstr("Good.zmb: message 1")));
}

TEST_F(KeptOut, IsWhatWasInnermost)
{
    const std::string outer = deadly(session, "abort-nested");
    storeSuite(session, {outer});
    EXPECT_EQ(session.run({}).exitStatus, -SIGABRT);
    const std::string said = startSays();
    EXPECT_THAT(said, ContainsRegex(named(outer, "while its entry point ran")));
    EXPECT_THAT(said, Not(HasSubstr("Good.zmb\" ended")));
}

TEST_F(KeptOut, AreThoseOfAllSessionsThatAreOver)
{
    const std::string first = deadly(session, "hang");
    const auto enough = (session.folder() / "enough").string();
    const auto second =
        session.folder()
            .write("loop.lsp", "(write-line \"looping\")\n(unless (probe-file \"" + enough + "\") (loop))\n")
            .string();
    {
        HostTerminal one(session, {"-c", "LOAD " + first});
        ASSERT_TRUE(one.shows("hanging")) << one.screen();
        HostTerminal other(session, {"-c", "LOAD " + second});
        ASSERT_TRUE(other.shows("looping")) << other.screen();
        EXPECT_THAT(startSays(), Not(HasSubstr("ended Tessel"))) << "both are running";
        kill(one.process(), SIGKILL);
        kill(other.process(), SIGKILL);
        EXPECT_EQ(one.waitForEnd(), -SIGKILL);
        EXPECT_EQ(other.waitForEnd(), -SIGKILL);
    }
    EXPECT_THAT(startSays(), AllOf(HasSubstr("\"" + first + "\" ended Tessel"),
                                   HasSubstr("\"" + second + "\" ended Tessel")));
    storeSuite(session, {second});
    session.folder().write("enough", "");
    EXPECT_THAT(startSays(), AllOf(HasSubstr("\"" + second + "\" is tried once more: it ended Tessel "),
                                   Not(HasSubstr(first))))
        << "nothing loads the first";
}

TEST_F(KeptOut, IsNamedOnceHoweverManySessionsItHasEnded)
{
    const std::string looping = lispFixture("endless_loop.lsp");
    {
        HostTerminal one(session, {"--safe", "-c", "LOAD " + looping});
        HostTerminal other(session, {"--safe", "-c", "LOAD " + looping});
        for (HostTerminal* terminal : {&one, &other})
        {
            ASSERT_TRUE(terminal->shows("endless_loop.lsp: begun")) << terminal->screen();
            kill(terminal->process(), SIGKILL);
            EXPECT_EQ(terminal->waitForEnd(), -SIGKILL);
        }
    }
    const std::string start = startSays();
    EXPECT_EQ(start.find(looping), start.rfind(looping)) << start;
    EXPECT_THAT(start, HasSubstr(" a power cut. It has ended 2 sessions. " + std::string(kThisTime)));
}

TEST_F(KeptOut, IsNoneWhereAFolderStandsInThePlaceOfTheList)
{
    const auto list = session.profile() / "applications" / "kept-out";
    fs::create_directories(list);
    const std::string start = startSays();
    EXPECT_THAT(start, HasSubstr("The file " + list.string() +
                                 " cannot be read: it is a folder, not a file. Nothing is kept out in this "
                                 "session.\n"));
    EXPECT_EQ(start.find(list), start.rfind(list)) << start;
}

TEST_F(KeptOut, IsFromItsCommandToo)
{
    const std::string bad = deadly(session, "segv-command");
    const std::string key = R"(REGISTRY SET Software\Tessel\R21\Applications\Deadly)";
    session.start({"--safe", "-c", key + " Module " + bad, "-c", key + " LoadReasons 4", "-c",
                   key + R"(\Commands PERISH PERISH)"});
    EXPECT_EQ(session.run({"PERISH"}).exitStatus, -SIGSEGV);
    const auto result = session.run({"PERISH"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("\"" + bad + "\" is not loaded: it is kept out because "));
    EXPECT_THAT(result.output, HasSubstr("Unknown command \"PERISH\"."));
}

TEST_F(KeptOut, IsWhatEndedTheHostLastWhereTheFileOfThemIsDamaged)
{
    const std::string bad = deadly(session, "abort");
    storeSuite(session, {bad});
    EXPECT_EQ(session.run({}).exitStatus, -SIGABRT);
    const auto file = session.profile() / "applications" / "kept-out";
    std::ofstream(file) << "gibberish";
    const auto result = session.run({"VERSION"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_THAT(result.output, HasSubstr("The file " + file.string() + kIsDamaged));
    EXPECT_THAT(result.output, AllOf(HasSubstr(kThisTime), Not(HasSubstr("abort.zmb: message 1"))));
    EXPECT_EQ(contentOf(file), "gibberish") << "nothing is overwritten";
}

TEST_F(KeptOut, AreAllLeftInTheirFileWhenOneOfItsLinesIsDamaged)
{
    session.run({"DISABLE " + good});
    const auto file = session.profile() / "applications" / "kept-out";
    const std::string damaged = contentOf(file) + "/opt/other.zmb\t/opt/other.zmb\t4\n";
    std::ofstream(file) << damaged;
    const auto result = session.run({"DISABLE " + lispFixture("good.lsp")});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("The file " + file.string() + kIsDamaged));
    EXPECT_EQ(contentOf(file), damaged);
    fs::remove(file);
    EXPECT_EQ(session.run({"DISABLE " + good}).exitStatus, 0) << "that is the way out";
}
