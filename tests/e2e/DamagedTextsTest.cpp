// A Modrig whose resource module is missing or damaged. Without its texts it does not start; with some of
// them it does what it can. The product is tried in a copy.
#include <gmock/gmock.h>

#include <fstream>
#include <random>

#include "tests/e2e/Applications.h"
#include "tests/support/Content.h"

namespace fs = std::filesystem;

using testing::AnyOf;
using testing::HasSubstr;

namespace
{
class DamagedTexts : public testing::Test
{
protected:
    DamagedTexts()
    {
        const fs::path app = fs::path(TESSEL_PROGRAM).parent_path();
        fs::copy(app, copy, fs::copy_options::recursive);
        session.startBy("exec '" + (copy / "Tessel").string() + "' \"$@\"");
    }

    // What is said after the banner.
    HostResult run(const std::vector<std::string>& commands) const
    {
        HostResult result = session.run(commands);
        EXPECT_TRUE(result.output.starts_with(kBanner)) << result.output;
        result.output.erase(0, std::string(kBanner).size());
        return result;
    }

    std::string refusal(const std::string& reason) const { return "The resource module \"" + reason + ".\n"; }

    void expectNoModrig(const std::string& reason) const
    {
        const auto result = run({"APPS", "MODRIG"});
        EXPECT_EQ(result.exitStatus, 1);
        EXPECT_EQ(result.output, refusal(reason) + notStarted() +
                                     "Command: MODRIG\nUnknown command \"MODRIG\". Type HELP for the list of "
                                     "commands.\n");
    }

    // The summary of the start, and what APPS says.
    std::string notStarted() const
    {
        return startSummary({{bundle, "its entry point answered 3."}}) +
               "Command: APPS\nNo application is loaded.\n" +
               listedAsNotLoaded({{bundle, "its entry point answered 3"}});
    }

    HostSession session;
    const fs::path copy = session.folder() / "a copy of Tessel.app";
    const std::string bundle = copy / "PlugIns/Modrig.bundle";
    const fs::path texts = fs::path(bundle) / "Resources/ModrigRes.dll";
};
} // namespace

TEST_F(DamagedTexts, AreReadFromWhereTheProductIsMovedTo)
{
    EXPECT_EQ(run({"APPS"}).output, "Command: APPS\n" + listed(bundle));
}

TEST_F(DamagedTexts, ThatAreMissingKeepModrigFromStarting)
{
    fs::remove(texts);
    expectNoModrig("ModrigRes.dll\" cannot be opened: there is no \"" + texts.string() + "\" and no \"" +
                   (copy / "Resources/ModrigRes.dll").string() + "\"");
}

TEST_F(DamagedTexts, ThatAreMissingKeepTheStartupSuiteFromBeingLoaded)
{
    storeSuite(session, {fixtureModule("Good.zmb")});
    fs::remove(texts);
    EXPECT_EQ(run({"APPS"}).output.find("Good.zmb"), std::string::npos);
    EXPECT_EQ(run({std::string("REGISTRY GET ") + kSuiteKey + " NumStartup"}).exitStatus, 0)
        << "what was stored is still there";
}

TEST_F(DamagedTexts, ThatAreNoResourceModuleKeepModrigFromStarting)
{
    std::ofstream(texts, std::ios::binary) << "Dear Sir or Madam,\n";
    const auto result = run({"APPS"});
    EXPECT_THAT(result.output,
                HasSubstr("The resource module \"" + texts.string() + "\" cannot be opened: "));
    EXPECT_TRUE(result.output.ends_with(".\n" + notStarted())) << result.output;
}

// Wherever the file ends, the host says so, or Modrig starts with the texts that are left.
TEST_F(DamagedTexts, ThatAreCutShortNeverEndTheHost)
{
    const std::string whole = contentOf(texts);
    for (std::size_t length = 0; length < whole.size(); length += whole.size() / 12)
    {
        std::ofstream(texts, std::ios::binary) << whole.substr(0, length);
        const auto result = run({"APPS", "VERSION"});
        EXPECT_EQ(result.exitStatus, 0) << length << result.output;
        const std::string notOpened = "The resource module \"" + texts.string() + "\" cannot be opened: ";
        if (result.output.starts_with(notOpened))
            EXPECT_THAT(result.output, HasSubstr(".\n" + notStarted()));
        else
            EXPECT_TRUE(result.output.starts_with("Command: APPS\n" + listed(bundle))) << result.output;
        EXPECT_TRUE(result.output.ends_with(
            "Command: VERSION\nTessel R21, reference host for Modrig, version " MODRIG_VERSION "\n"))
            << length << result.output;
    }
}

TEST_F(DamagedTexts, WithRandomBytesChangedNeverEndTheHost)
{
    const std::string whole = contentOf(texts);
    storeSuite(session, {"/nowhere/missing.zmb", sample("survey.rpk")});
    std::mt19937 random(2027);
    for (int round = 0; round < 25; ++round)
    {
        std::string changed = whole;
        for (int count = 0; count < 40; ++count)
            changed[random() % changed.size()] = static_cast<char>(random());
        std::ofstream(texts, std::ios::binary) << changed;
        const auto result = run({"VERSION"});
        EXPECT_EQ(result.exitStatus, 0) << "round " << round << ": " << result.output;
        EXPECT_TRUE(result.output.ends_with(
            "Command: VERSION\nTessel R21, reference host for Modrig, version " MODRIG_VERSION "\n"))
            << "round " << round << ": " << result.output;
        EXPECT_THAT(result.output,
                    AnyOf(HasSubstr("/nowhere/missing.zmb"), HasSubstr("The resource module \"")));
    }
}
