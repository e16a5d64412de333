// What Modrig makes of a stored Startup Suite, whole or not.
#include <gtest/gtest.h>

#include "tests/e2e/Applications.h"

namespace
{
constexpr char kGears[] = "Gears: type GEARS for the table of a speed reducer.\n";
constexpr char kMoon[] = "Moon: type MOONPHASE for tonight's moon, LOCKMOON to keep this module loaded, "
                         "UNLOCKMOON to let it go.\n";
constexpr char kHilbert[] = "Hilbert: type (hilbert 4) to draw the curve of that order, from 1 to 5.\n";
constexpr char kCalendar[] = "Calendar: type (calendar) for this month, (calendar 2027 2) for another.\n";

constexpr char kHilbertOfOrder2[] = "╶─┐ ┌─╴\n"
                                    "┌─┘ └─┐\n"
                                    "│ ┌─┐ │\n"
                                    "└─┘ └─┘\n";
constexpr char kFebruary2027[] = "   February 2027\n"
                                 "Mo Tu We Th Fr Sa Su\n"
                                 " 1  2  3  4  5  6  7\n"
                                 " 8  9 10 11 12 13 14\n"
                                 "15 16 17 18 19 20 21\n"
                                 "22 23 24 25 26 27 28\n";

class StartupSuite : public testing::Test
{
protected:
    // Starts with the Suite and lists what is loaded; the output after the banner.
    std::string startWith(const Paths& suite)
    {
        storeSuite(session, suite);
        return started();
    }

    std::string started()
    {
        const auto result = session.run({"APPS"});
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        EXPECT_TRUE(result.output.starts_with(kBanner)) << result.output;
        return result.output.substr(std::string(kBanner).size());
    }

    const std::string apps = "Command: APPS\n" + listed(modrigBundle());
    HostSession session;
};
} // namespace

TEST_F(StartupSuite, LoadsAModuleAndBothKindsOfLispInOrder)
{
    const std::string loaded = std::string(kMoon) + kHilbert + kLispReady + kCalendar + kLispReady + apps +
                               listed(sample("moon.bundle")) + listed(sample("hilbert.lsp"), "Lisp") +
                               listed(sample("calendar.qbc"), "Lisp");
    EXPECT_EQ(startWith({sample("moon.bundle"), sample("hilbert.lsp"), sample("calendar.qbc")}), loaded);
    EXPECT_EQ(started(), loaded) << "the second start is like the first";
}

TEST_F(StartupSuite, LoadsEveryKindOfCompiledModule)
{
    EXPECT_EQ(startWith({sample("primes.zmb"), sample("gears.omp"), sample("moon.bundle")}),
              std::string(kPrimes) + kGears + kMoon + apps + listed(sample("primes.zmb")) +
                  listed(sample("gears.omp")) + listed(sample("moon.bundle")));
}

TEST_F(StartupSuite, HasEffectsThatTheUserSees)
{
    storeSuite(session, {sample("primes.zmb"), sample("hilbert.lsp"), sample("calendar.qbc")});
    const auto result = session.run({"(hilbert 2)", "(calendar 2027 2)", "HELP PRIMES"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_EQ(result.output, std::string(kBanner) + kPrimes + kHilbert + kLispReady + kCalendar + kLispReady +
                                 "Command: (hilbert 2)\n" + kHilbertOfOrder2 +
                                 "Command: (calendar 2027 2)\n" + kFebruary2027 +
                                 "Command: HELP PRIMES\nPRIMES: Shows the primes on a spiral\n"
                                 "Usage: PRIMES\n");
}

TEST_F(StartupSuite, EndsAtTheFirstGapInTheNumbering)
{
    storeSuite(session, {sample("primes.zmb"), sample("moon.bundle"), sample("gears.omp")});
    const std::string remove = std::string("REGISTRY DELETE ") + kSuiteKey + " 2Startup";
    ASSERT_EQ(session.start({"--safe", "-c", remove}).exitStatus, 0);
    EXPECT_EQ(started(), kPrimes + apps + listed(sample("primes.zmb")));
}

TEST_F(StartupSuite, EndsAtItsCount)
{
    storeSuite(session, {sample("primes.zmb"), sample("gears.omp")});
    ASSERT_EQ(session.start({"--safe", "-c", setInSuite("NumStartup", "1 or more")}).exitStatus, 0);
    EXPECT_EQ(started(), kPrimes + apps + listed(sample("primes.zmb")));
    ASSERT_EQ(session.start({"--safe", "-c", setInSuite("NumStartup", "many")}).exitStatus, 0);
    EXPECT_EQ(started(), apps);
}

TEST_F(StartupSuite, WithAnEnormousCountStartsAtOnce)
{
    storeSuite(session, {sample("primes.zmb")});
    ASSERT_EQ(session.start({"--safe", "-c", setInSuite("NumStartup", "2147483647")}).exitStatus, 0);
    EXPECT_EQ(started(), kPrimes + apps + listed(sample("primes.zmb")));
}

TEST_F(StartupSuite, LoadsADuplicateInOtherLetterCaseOnce)
{
    EXPECT_EQ(startWith({lispFixture("good.lsp"), lispFixture("GOOD.LSP"), sample("primes.zmb"),
                         sample("Primes.ZMB")}),
              std::string(kPrimes) + "good.lsp: loaded\n" + kLispReady + apps + listed(sample("primes.zmb")) +
                  listed(lispFixture("good.lsp"), "Lisp"));
}

TEST_F(StartupSuite, GoesOnAfterMissingFilesAndNamesThem)
{
    const std::string module = "/nowhere/at all/100%s.zmb";
    const std::string lisp = "/nowhere/größe.lsp";
    EXPECT_EQ(
        startWith({module, lisp, sample("primes.zmb")}),
        std::string(kPrimes) + kLispReady +
            startSummary({{module, "No such file or directory."}, {lisp, "No such file or directory."}}) +
            apps + listed(sample("primes.zmb")) +
            listedAsNotLoaded({{module, "No such file or directory"}, {lisp, "No such file or directory"}}));
}

TEST_F(StartupSuite, KeepsAnEntryWithoutADotAndDoesNotLoadIt)
{
    EXPECT_EQ(startWith({"tool", sample("primes.zmb")}), kPrimes + apps + listed(sample("primes.zmb")));
    EXPECT_EQ(session.run({std::string("REGISTRY GET ") + kSuiteKey + " 1Startup"}).output,
              std::string(kBanner) + kPrimes + "Command: REGISTRY GET " + kSuiteKey + " 1Startup\ntool\n");
}

TEST_F(StartupSuite, RefusesWhatCannotBeLoadedAndGoesOn)
{
    const std::string dotOfFolder = "/some.where/tool";
    std::vector<NotLoaded> refusals;
    const Paths refused = {sample("survey.rpk"), sample("plates.mcp"), "/a/readme.txt", dotOfFolder};
    for (const std::string& path : refused)
        refusals.emplace_back(path, notOfAType(path));
    Paths suite = refused;
    suite.push_back(sample("primes.zmb"));
    EXPECT_EQ(startWith(suite), kPrimes + startSummary(refusals) + apps + listed(sample("primes.zmb")) +
                                    listedAsNotLoaded(refusals));
}

TEST_F(StartupSuite, WithModrigItselfLoadsItOnce)
{
    EXPECT_EQ(startWith({modrigBundle(), sample("primes.zmb")}),
              kPrimes + apps + listed(sample("primes.zmb")));
}

TEST_F(StartupSuite, OfAnotherProfileIsAnotherSuite)
{
    storeSuite(session, {sample("primes.zmb")});
    ASSERT_EQ(session.start({"--safe", "-c", "PROFILE Office"}).exitStatus, 0);
    EXPECT_EQ(started(), apps);
    ASSERT_EQ(session.start({"--safe", "-c", "PROFILE Default"}).exitStatus, 0);
    EXPECT_EQ(started(), kPrimes + apps + listed(sample("primes.zmb")));
}

TEST_F(StartupSuite, DoesNotLoadAModuleAgainButALispFile)
{
    const std::string module = fixtureModule("Good.zmb");
    const std::string lisp = lispFixture("good.lsp");
    storeSuite(session, {module, lisp});
    putOffModrig(session);
    const auto result = session.run({"LOAD " + module, "LOAD " + lisp, "LOAD " + modrigBundle(), "APPS"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_EQ(result.output,
              kBanner + ("Command: LOAD " + module + "\nGood.zmb: message 1\n" + module + " is loaded.\n") +
                  "Command: LOAD " + lisp + "\ngood.lsp: loaded\n" + lisp + " is loaded.\n" +
                  "Command: LOAD " + modrigBundle() + "\n" + modrigBundle() + " is loaded.\n" +
                  "good.lsp: loaded\n" + kLispReady + "Command: APPS\n" + listed(module) +
                  listed(modrigBundle()) + listed(lisp, "Lisp") + "Good.zmb: message 2\n");
}

TEST_F(StartupSuite, TakesAModuleOfTheSameNameElsewhereForLoaded)
{
    const auto copy = session.folder() / "elsewhere/GOOD.zmb";
    std::filesystem::create_directories(copy.parent_path());
    std::filesystem::copy_file(fixtureModule("Good.zmb"), copy);
    EXPECT_EQ(startWith({fixtureModule("Good.zmb"), copy}),
              "Good.zmb: message 1\n" + apps + listed(fixtureModule("Good.zmb")) + "Good.zmb: message 2\n");
}
