// The host's record of Modrig: Modrig is loaded when the host starts while its Startup Suite has entries, and
// otherwise when its command is typed.
#include <gtest/gtest.h>

#include "tests/e2e/Applications.h"

namespace
{
constexpr char kNoDisplay[] = "Tessel cannot open a window: there is no display.\n";

const std::string kListRecord = std::string("REGISTRY LIST ") + kRecordKey;
const std::string kListCommands = kListRecord + "\\Commands";
const std::string kNothingIsLoaded = "Command: APPS\nNo application is loaded.\n";

std::string modrigLoaded()
{
    return "Command: APPS\n" + listed(modrigBundle());
}

class ModrigRecord : public testing::Test
{
protected:
    // Runs the commands and answers what is said after the banner.
    std::string run(const std::vector<std::string>& commands) const
    {
        const auto result = session.run(commands);
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        EXPECT_TRUE(result.output.starts_with(kBanner)) << result.output;
        return result.output.substr(std::string(kBanner).size());
    }

    // In safe mode, so that looking changes nothing.
    std::string record() const
    {
        const auto result = session.start({"--safe", "-c", kListRecord, "-c", kListCommands});
        return result.output.substr(std::string(kBanner).size());
    }

    static std::string recordWith(const std::string& reasons,
                                  const std::string& description = "TesselModrig Command Module")
    {
        return "Command: " + kListRecord + "\n[Commands]\nModule = " + modrigBundle() +
               "\nDescription = " + description + "\nLoadReasons = " + reasons +
               "\nCommand: " + kListCommands + "\nMODRIG = MODRIG\n";
    }

    void setInRecord(const std::string& name, const std::string& data) const
    {
        const std::string set = std::string("REGISTRY SET ") + kRecordKey + " " + name + " " + inQuotes(data);
        ASSERT_EQ(session.start({"--safe", "-c", set}).exitStatus, 0);
    }

    HostSession session;
};
} // namespace

TEST_F(ModrigRecord, AppearsWithTheFirstStartupSuite)
{
    run({"APPS"});
    EXPECT_EQ(record(), "Command: " + kListRecord + "\nThe registry key \"" + kRecordKey +
                            "\" does not exist.\nCommand: " + kListCommands + "\nThe registry key \"" +
                            kRecordKey + "\\Commands\" does not exist.\n");
    storeSuite(session, {sample("primes.zmb")});
    EXPECT_EQ(run({"APPS"}), kPrimes + modrigLoaded() + listed(sample("primes.zmb")));
    EXPECT_EQ(record(), recordWith("6"));
}

TEST_F(ModrigRecord, IsNotWrittenAgainWhileItSaysTheSame)
{
    storeSuite(session, {sample("primes.zmb")});
    run({"APPS"});
    setInRecord("Description", "What the user wrote");
    setInRecord("LoadReasons", "06"); // the same number, in a spelling that a write would replace
    EXPECT_EQ(run({"APPS"}), kPrimes + modrigLoaded() + listed(sample("primes.zmb")));
    EXPECT_EQ(record(), recordWith("06", "What the user wrote"));
}

TEST_F(ModrigRecord, LosesTheStartWhenTheSuiteIsEmptied)
{
    storeSuite(session, {sample("primes.zmb")});
    run({"APPS"});
    storeSuite(session, {});
    EXPECT_EQ(run({"APPS"}), modrigLoaded()) << "loaded once more, for the record says so";
    EXPECT_EQ(record(), recordWith("4"));
    EXPECT_EQ(run({"APPS"}), kNothingIsLoaded);
    EXPECT_EQ(record(), recordWith("4"));
}

TEST_F(ModrigRecord, LetsTheCommandLoadModrig)
{
    storeSuite(session, {sample("primes.zmb")});
    run({"APPS"});
    storeSuite(session, {});
    run({"APPS"});
    EXPECT_EQ(run({"APPS", "modrig", "APPS"}),
              kNothingIsLoaded + "Command: modrig\n" + kNoDisplay + modrigLoaded());
    EXPECT_EQ(record(), recordWith("4"));
}

TEST_F(ModrigRecord, GetsTheStartBackWhenTheSuiteIsFilledAgain)
{
    storeSuite(session, {sample("primes.zmb")});
    run({"APPS"});
    storeSuite(session, {});
    run({"APPS"});
    storeSuite(session, {sample("primes.zmb")});
    EXPECT_EQ(run({"APPS", "MODRIG", "APPS"}), kNothingIsLoaded + "Command: MODRIG\n" + kPrimes + kNoDisplay +
                                                   modrigLoaded() + listed(sample("primes.zmb")));
    EXPECT_EQ(record(), recordWith("6"));
    EXPECT_EQ(run({"APPS"}), kPrimes + modrigLoaded() + listed(sample("primes.zmb")));
}

TEST_F(ModrigRecord, KeepsReasonsThatAreNotModrigsToManage)
{
    storeSuite(session, {sample("primes.zmb")});
    run({"APPS"});
    setInRecord("LoadReasons", "70");
    storeSuite(session, {});
    run({"APPS"});
    EXPECT_EQ(record(), recordWith("68"));
}

TEST_F(ModrigRecord, FollowsAHostThatWasMoved)
{
    storeSuite(session, {sample("primes.zmb")});
    run({"APPS"});
    setInRecord("Module", "/nowhere/Modrig.bundle");
    EXPECT_EQ(run({"APPS"}), "The application \"TesselModrig\" is " + modrigBundle() +
                                 " now; /nowhere/Modrig.bundle is not there any more.\n" + kPrimes +
                                 modrigLoaded() + listed(sample("primes.zmb")));
    EXPECT_EQ(record(), recordWith("6"));
    EXPECT_EQ(run({"APPS"}), kPrimes + modrigLoaded() + listed(sample("primes.zmb"))) << "told once";
}

TEST_F(ModrigRecord, OfAnApplicationThatIsGoneIsToldAtOneStart)
{
    storeSuite(session, {sample("primes.zmb")});
    run({"APPS"});
    setInRecord("Module", "/nowhere/Other.bundle");
    EXPECT_EQ(run({"APPS"}), kPrimes +
                                 startSummary({{"/nowhere/Other.bundle", "No such file or directory."}}) +
                                 modrigLoaded() + listed(sample("primes.zmb")) +
                                 listedAsNotLoaded({{"/nowhere/Other.bundle", "No such file or directory"}}))
        << "the one in the PlugIns folder has no record and is loaded";
    EXPECT_EQ(run({"APPS"}), kPrimes + modrigLoaded() + listed(sample("primes.zmb")));
}
