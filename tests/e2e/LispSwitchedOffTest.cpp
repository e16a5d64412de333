// A host whose Lisp is switched off for applications, and one that knows no compiled and packaged Lisp.
#include <gtest/gtest.h>

#include "tests/e2e/Applications.h"

namespace
{
constexpr char kGood[] = "good.lsp: loaded\n";

// The variable counts for the session only, so that Modrig must be loaded after it is set.
std::string loadedWithLispEnabled(const HostSession& session, const std::string& value)
{
    const std::vector<std::string> commands = {"SETVAR LISPENABLED " + value, "LOAD " + modrigBundle(),
                                               "APPS"};
    putOffModrig(session);
    const auto result = session.run(commands);
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    const std::string start =
        std::string(kBanner) + "Command: " + commands[0] + "\nCommand: " + commands[1] + "\n";
    EXPECT_TRUE(result.output.starts_with(start)) << result.output;
    return result.output.substr(start.size());
}

std::string isLoaded(const std::string& path)
{
    return path + " is loaded.\n";
}
} // namespace

TEST(LispEnabled, WhenZeroKeepsLispAndMacrosOutWithoutAWord)
{
    const HostSession session;
    const auto upperCase = session.folder().write("LOUD.LSP", "(write-line \"never seen\")\n").string();
    storeSuite(session, {lispFixture("good.lsp"), sample("calendar.qbc"), sample("survey.rpk"),
                         sample("plates.mcp"), upperCase, "/nowhere/missing.lsp", sample("primes.zmb")});
    EXPECT_EQ(loadedWithLispEnabled(session, "0"), kPrimes + isLoaded(modrigBundle()) + "Command: APPS\n" +
                                                       listed(modrigBundle()) + listed(sample("primes.zmb")));
}

TEST(LispEnabled, WhenZeroDoesNotKeepModulesOfUnknownKindFromBeingTold)
{
    const HostSession session;
    storeSuite(session, {"/a/readme.txt"});
    EXPECT_EQ(loadedWithLispEnabled(session, "0"),
              modrigDoesNotKnow("/a/readme.txt") + modrigDoesNotLoad("/a/readme.txt") +
                  isLoaded(modrigBundle()) + "Command: APPS\n" + listed(modrigBundle()));
}

TEST(LispEnabled, WhenOneLetsLispIn)
{
    const HostSession session;
    storeSuite(session, {lispFixture("good.lsp")});
    EXPECT_EQ(loadedWithLispEnabled(session, "1"), isLoaded(modrigBundle()) + kGood + kLispReady +
                                                       "Command: APPS\n" + listed(modrigBundle()) +
                                                       listed(lispFixture("good.lsp"), "Lisp"));
}

TEST(LispEnabled, HoldsForAModrigThatItsCommandLoads)
{
    const HostSession session;
    storeSuite(session, {sample("primes.zmb")});
    ASSERT_EQ(session.run({"APPS"}).exitStatus, 0);
    storeSuite(session, {});
    ASSERT_EQ(session.run({"APPS"}).exitStatus, 0); // from here on Modrig waits for its command
    storeSuite(session, {lispFixture("good.lsp"), sample("primes.zmb")});
    const auto result = session.run({"SETVAR LISPENABLED 0", "MODRIG"});
    EXPECT_EQ(result.output, std::string(kBanner) + "Command: SETVAR LISPENABLED 0\nCommand: MODRIG\n" +
                                 kPrimes + "Tessel cannot open a window: there is no display.\n");
}

TEST(RemovingTsLisp, WhenOffMakesCompiledAndPackagedLispUnknown)
{
    const HostSession session;
    storeSuite(session, {sample("calendar.qbc"), sample("survey.rpk"), lispFixture("good.lsp")});
    ASSERT_EQ(session.start({"--safe", "-c", "SETVAR REMOVINGTSLISP 0"}).exitStatus, 0);
    const auto result = session.run({"APPS", "(good)"});
    EXPECT_EQ(result.exitStatus, 0);
    const std::vector<NotLoaded> refused = {{sample("calendar.qbc"), notOfAType(sample("calendar.qbc"))},
                                            {sample("survey.rpk"), notOfAType(sample("survey.rpk"))}};
    EXPECT_EQ(result.output, kBanner + (kGood + (kLispReady + startSummary(refused))) + "Command: APPS\n" +
                                 listed(modrigBundle()) + listed(lispFixture("good.lsp"), "Lisp") +
                                 listedAsNotLoaded(refused) + "Command: (good)\n42\n");
}

TEST(RemovingTsLisp, WhenOffLoadsLispByTheFunctionLoadAlone)
{
    const HostSession session;
    storeSuite(session, {lispFixture("good.lsp")});
    const std::string lookedUp = R"((fboundp '_internal-load-all-file))";
    EXPECT_EQ(session.start({"--safe", "-c", lookedUp}).output, kBanner + ("Command: " + lookedUp + "\nT\n"));
    ASSERT_EQ(session.start({"--safe", "-c", "SETVAR REMOVINGTSLISP 0"}).exitStatus, 0);
    EXPECT_EQ(session.run({lookedUp}).output,
              kBanner + (kGood + (kLispReady + ("Command: " + lookedUp + "\nNIL\n"))));
}

TEST(RemovingTsLisp, CountsFromTheNextStartOn)
{
    const HostSession session;
    storeSuite(session, {sample("calendar.qbc")});
    putOffModrig(session);
    EXPECT_EQ(session.run({"SETVAR REMOVINGTSLISP 0", "LOAD " + modrigBundle()}).output,
              kBanner + ("Command: SETVAR REMOVINGTSLISP 0\nCommand: LOAD " + modrigBundle() + "\n") +
                  isLoaded(modrigBundle()) +
                  "Calendar: type (calendar) for this month, (calendar 2027 2) for another.\n" + kLispReady);
}
