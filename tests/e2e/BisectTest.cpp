// The search for an application that makes trouble without ending the host.
#include <gmock/gmock.h>

#include <algorithm>
#include <csignal>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostTerminal.h"

using testing::AllOf;
using testing::ContainsRegex;
using testing::HasSubstr;
using testing::Not;

namespace
{
constexpr char kTrouble[] = "TROUBLE\n";
constexpr char kAgain[] = "Start Tessel again.\n";

class Bisect : public testing::Test
{
protected:
    // Lisp files that each say their name, and what else they are told to.
    std::string write(const std::string& name, const std::string& lisp = {}) const
    {
        return session.folder()
            .write(name + ".lsp", "(write-line \"" + name + " runs\")\n" + lisp + "\n")
            .string();
    }
    std::string makesTrouble() const { return write("culprit", "(write-line \"TROUBLE\")"); }

    void begin(const Paths& suite)
    {
        storeSuite(session, suite);
        const auto result = session.run({"BISECT START"});
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        EXPECT_THAT(result.output,
                    HasSubstr("BISECT searches among " + std::to_string(suite.size()) + " application"));
        EXPECT_THAT(result.output, HasSubstr(kAgain));
    }

    // Starts, looks and answers until there is no more to ask; the last words, and how many answers it took.
    std::string search(std::size_t& starts)
    {
        std::string said;
        for (starts = 1; starts <= 10; ++starts)
        {
            const bool isBad = session.run({"VERSION"}).output.find(kTrouble) != std::string::npos;
            said = session.run({isBad ? "BISECT BAD" : "BISECT GOOD"}).output;
            if (said.find(kAgain) == std::string::npos)
                break;
        }
        return said.substr(std::min(said.size(), said.find("Command: BISECT")));
    }

    HostSession session;
};
} // namespace

TEST_F(Bisect, NamesTheCulpritAndLeavesEverythingAsItWas)
{
    const std::string culprit = makesTrouble();
    const Paths suite = {write("a"), fixtureModule("Good.zmb"), culprit, write("b"), write("c"), write("d"),
                         write("e")};
    begin(suite);
    std::size_t starts = 0;
    EXPECT_THAT(search(starts), HasSubstr("BISECT has found it: \"" + culprit + "\" makes the trouble."));
    EXPECT_LE(starts, 4U);
    const std::string after = session.run({"APPS"}).output;
    EXPECT_THAT(after, AllOf(HasSubstr("a runs"), HasSubstr("e runs"), HasSubstr("Good.zmb: message 1"),
                             HasSubstr(kTrouble), Not(HasSubstr("kept out"))));
}

TEST_F(Bisect, SaysHowToStopItToWhoeverLetsInWhatItKeepsOut)
{
    const std::string one = write("one");
    const std::string two = write("two");
    begin({one, two});
    const std::string start = session.run({"VERSION"}).output;
    const std::string out = start.find("one runs") == start.npos ? one : two;
    const std::string way = "BISECT keeps it out at this start; BISECT STOP ends the search.\n";
    for (const std::string& typed : {out, std::filesystem::path(out).filename().string()})
    {
        const auto result = session.run({"ENABLE " + typed});
        EXPECT_EQ(result.exitStatus, 1);
        EXPECT_THAT(result.output, HasSubstr("\n\"" + out + "\" is not let in by ENABLE: " + way));
    }
    session.run({"DISABLE " + out});
    EXPECT_THAT(session.run({"ENABLE " + out}).output,
                HasSubstr("\n" + out + " is not kept out at starts any more. But " + way));
}

TEST_F(Bisect, SaysWhichItKeepsOutAtEachStart)
{
    const Paths suite = {write("a"), write("b"), write("c"), write("d")};
    begin(suite);
    for (int start = 0; start < 2; ++start) // nothing was answered in between
    {
        const auto result = session.run({"BISECT"});
        EXPECT_THAT(result.output, HasSubstr("BISECT keeps 2 of 4 suspects out at this start:\n  " +
                                             suite[2] + "\n  " + suite[3] +
                                             "\nType BISECT GOOD when the trouble is gone, BISECT BAD when "
                                             "it is there; at most 3 starts are left.\n"));
        EXPECT_THAT(result.output, AllOf(HasSubstr("a runs"), HasSubstr("b runs"), Not(HasSubstr("c runs")),
                                         Not(HasSubstr("d runs"))));
        EXPECT_EQ(result.output.find(suite[2]), result.output.rfind(suite[2])) << "said once";
        EXPECT_THAT(result.output,
                    HasSubstr("4 applications are still suspected; at most 3 starts are left.\n"));
    }
    EXPECT_THAT(
        session.run({"BISECT bad"}).output,
        HasSubstr("2 applications are still suspected; at most 2 starts are left. Start Tessel again.\n"));
    EXPECT_THAT(session.run({"VERSION"}).output, AllOf(HasSubstr("a runs"), Not(HasSubstr("b runs"))));
}

TEST_F(Bisect, TellsNoneOfThemAsAFailure)
{
    const Paths suite = {write("a"), fixtureModule("Good.zmb")};
    begin(suite);
    const std::string said = session.run({"APPS"}).output;
    EXPECT_THAT(said, AllOf(Not(HasSubstr("could not be loaded")), Not(HasSubstr("Message: "))));
    EXPECT_THAT(said, ContainsRegex("  Good\\.zmb .* it is kept out at this start by BISECT\n"));
}

TEST_F(Bisect, SaysThatItIsNotTheOnlyOne)
{
    begin({write("a")});
    EXPECT_THAT(session.run({"BISECT BAD"}).output,
                HasSubstr("BISECT says that it is none of them: the trouble is there when the only suspect "
                          "is kept out.\n"));
}

TEST_F(Bisect, SaysThatItIsNone)
{
    begin({write("a"), write("b"), write("c")});
    EXPECT_THAT(session.run({"BISECT BAD"}).output,
                HasSubstr("1 application is still suspected; at most 1 start is left. "));
    EXPECT_THAT(session.run({"VERSION"}).output,
                AllOf(HasSubstr("BISECT keeps 3 of 3 suspects out"), Not(HasSubstr("runs"))));
    EXPECT_THAT(
        session.run({"BISECT BAD"}).output,
        HasSubstr("BISECT says that it is none of them: the trouble is there when all of the 3 suspects "
                  "are kept out.\n"));
    EXPECT_THAT(session.run({"BISECT"}).output,
                HasSubstr("No search is going on; BISECT START begins one.\n"));
}

TEST_F(Bisect, SaysThatSeveralAreNeededTogether)
{
    const std::string one = write("one", "(defvar *one* t)");
    const std::string other = write("other", "(when (boundp '*one*) (write-line \"TROUBLE\"))");
    begin({one, write("a"), write("b"), other});
    std::size_t starts = 0;
    EXPECT_THAT(search(starts), HasSubstr("several are needed together."));
    EXPECT_LE(starts, 3U);
}

TEST_F(Bisect, DoesNotTouchTheStartupSuite)
{
    const Paths suite = {write("a"), makesTrouble(), write("b")};
    const std::string list = std::string("REGISTRY LIST ") + kSuiteKey;
    begin(suite);
    const std::string before = session.start({"--safe", "-c", list}).output;
    std::size_t starts = 0;
    search(starts);
    EXPECT_EQ(session.start({"--safe", "-c", list}).output, before);
}

TEST_F(Bisect, SuspectsNoneThatOthersCameWithAndNoneThatIsOutAlready)
{
    const std::string out = write("out");
    storeSuite(session, {write("a"), out});
    session.run({"DISABLE " + out});
    EXPECT_THAT(session.run({"BISECT START"}).output, HasSubstr("BISECT searches among 1 application; "));
}

TEST_F(Bisect, JudgesOnlySessionsThatWereStartedForIt)
{
    storeSuite(session, {write("a"), write("b")});
    EXPECT_THAT(
        session.run({"BISECT START", "BISECT GOOD"}).output,
        HasSubstr("This session cannot be judged: the search has begun in it, and nothing was kept out "
                  "of its start. Start Tessel again"));
    EXPECT_THAT(
        session.start({"--safe", "-c", "BISECT GOOD"}).output,
        HasSubstr("This session cannot be judged: it was started with --safe, and no suspect is tried "
                  "then. Start Tessel again"));
    const auto result = session.run({"BISECT GOOD", "BISECT GOOD"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output,
                HasSubstr("This session cannot be judged: the search has gone on since it was started. "));
}

TEST_F(Bisect, JudgesNoSessionInWhichThePersonLoadedWhatItKeepsOut)
{
    const Paths suite = {write("a"), write("b")};
    begin(suite);
    for (const std::string& path : suite)
        EXPECT_EQ(session.run({"LOAD " + path}).exitStatus, 0);
    const std::string kept =
        session.run({"VERSION"}).output.find("a runs") == std::string::npos ? suite[0] : suite[1];
    const auto result = session.run({"LOAD " + kept, "BISECT GOOD"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output,
                HasSubstr("This session cannot be judged: \"" + kept +
                          "\", which was to stay out, was loaded all the same. Start Tessel again; "
                          "BISECT STOP ends the search."));
    EXPECT_EQ(session.run({"BISECT GOOD"}).exitStatus, 0);
}

TEST_F(Bisect, EndsWhenItIsStopped)
{
    begin({write("a"), write("b")});
    EXPECT_EQ(session.run({"BISECT STOP"}).exitStatus, 0);
    EXPECT_THAT(session.run({"VERSION"}).output,
                AllOf(HasSubstr("a runs"), HasSubstr("b runs"), Not(HasSubstr("BISECT"))));
}

TEST_F(Bisect, TellsWhyItDoesNotBegin)
{
    EXPECT_THAT(
        session.start({"--safe", "-c", "BISECT START"}).output,
        HasSubstr(
            "There is nothing to search among: no application was loaded by itself in this session.\n"));
    EXPECT_THAT(session.run({"BISECT GOOD"}).output,
                HasSubstr("No search is going on; BISECT START begins one.\n"));
    EXPECT_THAT(session.run({"BISECT SIDEWAYS"}).output, HasSubstr("Usage: BISECT [START|GOOD|BAD|STOP]\n"));
}

TEST_F(Bisect, TellsThatItsFileIsDamaged)
{
    begin({write("a"), write("b")});
    const auto file = session.folder().write(session.profile() / "applications" / "bisection", "gibberish");
    const auto result = session.run({"BISECT GOOD", "BISECT STOP", "BISECT"});
    EXPECT_THAT(result.output,
                AllOf(HasSubstr("The file " + file.string() + " is damaged; "), HasSubstr("a runs"),
                      HasSubstr("b runs"), HasSubstr("No search is going on")));
}

namespace
{
constexpr char kTriedOnceMore[] = "\" is tried once more: ";

// A search and an application that ends the host, in one start.
class BisectAndCrash : public Bisect
{
protected:
    // Lisp that ends the host while the flag is there.
    std::string writeDeadly() const
    {
        return write("deadly", "(when (probe-file \"" + flag.string() + "\") " + kLispThatFaults + ")");
    }
    void raiseFlag() const { session.folder().write("flag", ""); }
    void lowerFlag() const { std::filesystem::remove(flag); }

    // Brings the deadly one among these two to its trial, in a session that begins a search and is killed.
    void killASearchOnTrial(const Paths& suite)
    {
        raiseFlag();
        storeSuite(session, suite);
        EXPECT_EQ(session.run({}).exitStatus, -SIGSEGV);
        EXPECT_EQ(session.run({}).exitStatus, 0);
        lowerFlag();
        HostTerminal terminal(session);
        ASSERT_TRUE(terminal.shows(kTriedOnceMore)) << terminal.screen();
        terminal.type("BISECT START\r");
        ASSERT_TRUE(terminal.shows("BISECT searches among 2 applications; ")) << terminal.screen();
        kill(terminal.process(), SIGKILL);
        EXPECT_EQ(terminal.waitForEnd(), -SIGKILL);
    }

    void expectNotJudged(const std::string& suspect, const std::string& why)
    {
        const auto result = session.run({"BISECT GOOD"});
        EXPECT_EQ(result.exitStatus, 1);
        EXPECT_THAT(result.output, HasSubstr("This session cannot be judged: \"" + suspect +
                                             "\", which was to be loaded, " + why));
        EXPECT_THAT(result.output, Not(HasSubstr("Type BISECT GOOD")));
        EXPECT_THAT(session.run({"BISECT"}).output, HasSubstr("2 applications are still suspected; "))
            << "nothing was answered";
    }

    std::filesystem::path flag = session.folder() / "flag";
};
} // namespace

TEST_F(BisectAndCrash, LetsATrialWaitUntilTheSearchIsOver)
{
    const std::string bad = writeDeadly();
    raiseFlag();
    storeSuite(session, {write("a"), write("b"), bad});
    const auto first = session.run({});
    EXPECT_EQ(first.exitStatus, -SIGSEGV);
    EXPECT_THAT(session.run({"BISECT START"}).output, HasSubstr("BISECT searches among 2 applications; "))
        << first.output;
    for (const char* command : {"VERSION", "BISECT STOP"})
    {
        const auto result = session.run({command});
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        EXPECT_THAT(result.output,
                    AllOf(HasSubstr("BISECT keeps 1 of 2 suspects out"),
                          HasSubstr("Cannot load \"" + bad + "\": it is kept out because it ended "),
                          Not(HasSubstr(kTriedOnceMore))));
    }
    const auto trial = session.run({"VERSION"});
    EXPECT_EQ(trial.exitStatus, -SIGSEGV);
    EXPECT_THAT(trial.output, HasSubstr(bad + kTriedOnceMore));
}

// It was on trial in a session that was killed, and is one of the suspects since.
TEST_F(BisectAndCrash, DoesNotEndTheTrialOfASuspectThatItKeepsOut)
{
    killASearchOnTrial({write("a"), writeDeadly()});
    EXPECT_THAT(session.run({"BISECT STOP"}).output, Not(HasSubstr("deadly runs")));
    raiseFlag();
    EXPECT_EQ(session.run({}).exitStatus, -SIGSEGV);
    EXPECT_THAT(session.run({"VERSION"}).output, HasSubstr("It is not loaded by itself any more, until "));
}

TEST_F(BisectAndCrash, EndsTheTrialOfWhatItLoads)
{
    killASearchOnTrial({writeDeadly(), write("a")});
    EXPECT_THAT(session.run({"BISECT STOP"}).output, HasSubstr("deadly runs"));
    raiseFlag();
    EXPECT_EQ(session.run({}).exitStatus, -SIGSEGV);
    EXPECT_THAT(session.run({"VERSION"}).output, HasSubstr("the next one lets it in once more.\n"))
        << "it was loaded with success in between";
}

TEST_F(BisectAndCrash, JudgesNoSessionThatKeepsOutWhatWasToBeTried)
{
    const std::string bad = writeDeadly();
    begin({bad, write("a")});
    raiseFlag();
    EXPECT_EQ(session.run({"VERSION"}).exitStatus, -SIGSEGV);
    expectNotJudged(bad, "is kept out because it ended Tessel ");
    lowerFlag();
    EXPECT_EQ(session.run({"ENABLE " + bad}).exitStatus, 0);
    EXPECT_THAT(session.run({"BISECT GOOD"}).output,
                AllOf(HasSubstr("deadly runs"), HasSubstr("1 application is still suspected; ")));
}

TEST_F(BisectAndCrash, JudgesNoSessionInWhichThePersonKeepsOutWhatWasToBeTried)
{
    const std::string a = write("a");
    begin({a, write("b")});
    session.run({"DISABLE " + a});
    expectNotJudged(a, "is kept out at starts by DISABLE since ");
}

// What loads the suspects is kept out itself.
TEST_F(BisectAndCrash, JudgesNoSessionInWhichNobodyAskedForWhatWasToBeTried)
{
    const std::string a = write("a");
    begin({a, write("b")});
    session.run({"DISABLE Modrig.bundle"});
    const auto result = session.run({"BISECT BAD"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output,
                HasSubstr("This session cannot be judged: \"" + a +
                          "\", which was to be loaded, was kept out of this start or not asked for. "));
}

TEST_F(BisectAndCrash, JudgesASessionAfterACrashOfWhatIsNoSuspect)
{
    begin({write("a"), write("b")});
    const std::string bad = deadly(session, "abort");
    EXPECT_EQ(session.run({"LOAD " + bad}).exitStatus, -SIGABRT);
    const auto result = session.run({"BISECT GOOD"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, AllOf(HasSubstr("The application \"" + bad + "\" ended Tessel "),
                                     HasSubstr("1 application is still suspected; ")));
}
