// A session that loads nothing by itself: MODRIG is there all the same, whatever the profile holds, and
// nothing that Modrig would load with itself.
#include <csignal>
#include <ostream>

#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"
#include "tests/support/Content.h"

using testing::AllOf;
using testing::HasSubstr;
using testing::Not;

namespace
{
constexpr char kOpens[] = "Tessel cannot open a window: there is no display.\n";
constexpr char kIsSafe[] =
    "Tessel was started with --safe and loads nothing by itself: APPS lists what would have been "
    "loaded now, LOAD loads it by hand.\n";

struct Profile
{
    const char* name;
    std::vector<std::string> commands; // that make it what it is
};

void PrintTo(const Profile& profile, std::ostream* stream)
{
    *stream << profile.name;
}

std::string record(const std::string& rest)
{
    return std::string("REGISTRY SET ") + kRecordKey + " " + rest;
}

class SafeMode : public testing::TestWithParam<Profile>
{
protected:
    void SetUp() override
    {
        storeSuite(session, suite);
        std::vector<std::string> arguments = byArguments(GetParam().commands);
        arguments.emplace_back("--safe");
        if (!GetParam().commands.empty())
            session.start(arguments);
        session.alwaysWith({"--safe"});
    }

    std::string storedSuite() const
    {
        const std::string output = session.run({std::string("REGISTRY LIST ") + kSuiteKey}).output;
        return output.substr(output.find("Startup\n"));
    }

    HostSession session;
    std::string bad = deadly(session, "abort");
    std::string lisp = lispFixture("good.lsp");
    Paths suite = {fixtureModule("Good.zmb"), bad, lisp};
};
} // namespace

TEST_P(SafeMode, HasModrigAndNothingOfItsSuite)
{
    const std::string before = storedSuite();
    const auto result = session.run({"MODRIG"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_THAT(result.output, HasSubstr(kOpens));
    EXPECT_TRUE(result.output.ends_with(std::string("\n") + kIsSafe + kOpens + kLispReady)) << result.output;
    EXPECT_THAT(result.output, Not(HasSubstr("is not loaded: "))) << "one sentence for all";
    EXPECT_THAT(result.output, Not(HasSubstr("Message: ")));
    EXPECT_THAT(result.output, AllOf(Not(HasSubstr("message 1")), Not(HasSubstr("good.lsp: loaded"))));
    EXPECT_EQ(storedSuite(), before);
}

TEST_P(SafeMode, LoadsEverythingByHand)
{
    const auto result =
        session.run({"LOAD " + fixtureModule("Good.zmb"), "LOAD " + lisp, "MODRIG", "LOAD " + lisp});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, AllOf(HasSubstr("Good.zmb: message 1"), HasSubstr("good.lsp: loaded")));
    EXPECT_EQ(session.run({"LOAD " + bad}).exitStatus, -SIGABRT);
}

TEST_P(SafeMode, ListsWhatItDidNotLoad)
{
    const std::string said = session.run({"MODRIG", "APPS"}).output;
    const std::string reason = "Tessel was started with --safe and loads nothing by itself";
    EXPECT_TRUE(said.ends_with(
        listedAsNotLoaded({{fixtureModule("Good.zmb"), reason}, {bad, reason}, {lisp, reason}})))
        << said;
}

TEST_P(SafeMode, IsOverAtTheNextStart)
{
    ASSERT_EQ(session.run({"MODRIG"}).exitStatus, 0);
    session.alwaysWith({});
    EXPECT_THAT(session.run({"LOAD " + modrigBundle()}).output, HasSubstr("Good.zmb: message 1"));
}

INSTANTIATE_TEST_SUITE_P(
    OfAProfile, SafeMode,
    testing::Values(Profile{"WithoutARecord", {}},
                    Profile{"WithTheRecordOfASuite",
                            {record("Module " + inQuotes(MODRIG_BUNDLE)), record("LoadReasons 6"),
                             record(R"(Commands\ MODRIG MODRIG)")}},
                    Profile{"WithARecordOfNoCommand",
                            {record("Module " + inQuotes(MODRIG_BUNDLE)), record("LoadReasons 2")}},
                    Profile{"WithARecordOfWhereItWas",
                            {record("Module /opt/old/Modrig.bundle"), record("LoadReasons 6")}}),
    [](const auto& profile) { return profile.param.name; });

TEST(SafeModeAfterACrash, HasModrigThatEndedTheHostItself)
{
    HostSession session;
    storeSuite(session, {deadly(session, "kill")});
    const auto crash = session.start({"-c", "VERSION"});
    EXPECT_EQ(crash.exitStatus, -SIGKILL);
    session.alwaysWith({"--safe"});
    const auto result = session.run({"MODRIG"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, AllOf(HasSubstr("kill.zmb\" ended Tessel "), HasSubstr(kOpens)));
}

// What is there to find out by, of somebody else's, is left alone.
TEST(SafeModeCommands, LoadNoPlugInThatIsNotCalledLikeThem)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    const auto result = session.run({"NOBODYS", "APPS"});
    EXPECT_EQ(result.output,
              kBanner + std::string("Command: NOBODYS\nUnknown command \"NOBODYS\". Type HELP for the "
                                    "list of commands.\nCommand: APPS\nNo application is loaded.\n"));
}
