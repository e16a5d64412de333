// What the host's listing commands answer to programs, read by another's reader.
#include <filesystem>

#include <gmock/gmock.h>

#include <nlohmann/json.hpp>

#include "tests/e2e/Applications.h"

using nlohmann::json;
using testing::HasSubstr;

namespace
{
class Listings : public testing::Test
{
protected:
    // All that is printed is the one document.
    static json document(const HostResult& result)
    {
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        EXPECT_TRUE(result.output.ends_with("}\n")) << result.output;
        return json::parse(result.output);
    }
    json answer(const std::string& command) const { return document(session.run({command + " --json"})); }

    HostSession session;
};
} // namespace

TEST_F(Listings, OfApplicationsTellWhatIsLoadedAndWhatIsNot)
{
    const std::string broken = session.folder().write("broken.zmb", "no module").string();
    putOffModrig(session);
    session.run({"DISABLE " + sample("gears.omp")});
    const auto result =
        session.start({"-c", "LOAD " + sample("primes.zmb"), "-c", "LOAD " + lispFixture("good.lsp"), "-c",
                       "LOAD " + broken, "-c", "APPS --json"});
    const json apps = json::parse(result.output.substr(result.output.rfind("\n{") + 1));
    ASSERT_EQ(apps["loaded"].size(), 2U);
    EXPECT_EQ(apps["loaded"][0]["path"], sample("primes.zmb"));
    EXPECT_EQ(apps["loaded"][0]["kind"], "compiled");
    EXPECT_EQ(apps["loaded"][0]["isLocked"], false);
    EXPECT_GT(apps["loaded"][0]["loadedInMicroseconds"], 0);
    EXPECT_EQ(apps["loaded"][1]["path"], lispFixture("good.lsp"));
    EXPECT_EQ(apps["loaded"][1]["kind"], "lisp");
    ASSERT_EQ(apps["keptOut"].size(), 1U);
    EXPECT_EQ(apps["keptOut"][0]["path"], sample("gears.omp"));
    EXPECT_THAT(std::string(apps["keptOut"][0]["reason"]), HasSubstr("kept out"));
    ASSERT_EQ(apps["notLoaded"].size(), 1U);
    EXPECT_EQ(apps["notLoaded"][0]["path"], broken);
    EXPECT_NE(apps["notLoaded"][0]["reason"], "");
}

TEST_F(Listings, TellTheVersionAlone)
{
    EXPECT_EQ(answer("VERSION"), json({{"program", "Tessel R21"}, {"version", MODRIG_VERSION}}));
    EXPECT_EQ(session.run({"VERSION 2"}).exitStatus, 1);
    EXPECT_EQ(session.run({"VERSION 2 --json"}).exitStatus, 1);
}

TEST_F(Listings, OfCommandsAreTheSameByTheShortName)
{
    EXPECT_EQ(answer("?"), answer("HELP"));
}

TEST_F(Listings, OfCommandsKnowThoseThatAreNotLoadedYet)
{
    const json help = answer("HELP");
    const auto named = [&](const std::string& name)
    {
        for (const json& command : help["commands"])
            if (command["name"] == name)
                return command;
        return json();
    };
    EXPECT_EQ(named("REGISTRY")["group"], "Settings");
    EXPECT_THAT(std::string(named("REGISTRY")["usage"]), HasSubstr("LIST [key] [--json] | GET key"));
    EXPECT_EQ(named("SUITE")["summary"],
              "Shows and changes the Startup Suite, what Modrig loads at each start");
    EXPECT_EQ(named("NOTHING"), json());
}

TEST_F(Listings, OfProfilesTellTheCurrentOne)
{
    session.run({"PROFILE Site"});
    EXPECT_EQ(answer("PROFILE"), json({{"current", "Site"}, {"profiles", {"Default", "Site"}}}));
}

TEST_F(Listings, OfVariablesKeepNumbersAndTextsApart)
{
    session.run({"SETVAR SEARCHPATH /a;/b"});
    EXPECT_EQ(answer("SETVAR searchpath")["variables"][0]["value"], "/a;/b");
    EXPECT_EQ(answer("SETVAR LISPENABLED")["variables"],
              json::array({{{"name", "LISPENABLED"},
                            {"value", 1},
                            {"purpose", "1: applications may load Lisp files; 0: not"}}}));
    EXPECT_GT(answer("SETVAR")["variables"].size(), 3U);
}

TEST_F(Listings, OfTheRegistryTellWhereAValueComesFrom)
{
    session.alwaysWith({"--safe", "--layout-dir", (session.folder() / "layout").string()});
    const std::string file =
        session.folder()
            .write("layout/site.reg", "Windows Registry Editor Version 5.00\n\n"
                                      "[HKEY_CURRENT_USER\\Software\\Trial]\n\"theirs\"=\"1\"\n")
            .string();
    session.run({R"(REGISTRY SET Software\Trial "our ""own""" "größe \ 100%s")",
                 R"(REGISTRY SET Software\Trial\Below)"});
    EXPECT_EQ(answer(R"(REGISTRY LIST Software\Trial)"),
              json({{"key", R"(Software\Trial)"},
                    {"keys", {"Below"}},
                    {"values",
                     {{{"name", "our \"own\""}, {"data", "größe \\ 100%s"}, {"file", nullptr}},
                      {{"name", "theirs"}, {"data", "1"}, {"file", file}}}}}));
    EXPECT_EQ(answer(R"(REGISTRY GET Software\Trial theirs)"),
              json({{"key", R"(Software\Trial)"}, {"name", "theirs"}, {"data", "1"}}));
}

TEST_F(Listings, WriteWhatIsNoTextAsAPrivateCharacter)
{
    session.run({"REGISTRY SET Software\\Trial name \"a \x1B[2J \xFF\""});
    const json read = answer("REGISTRY GET Software\\Trial name");
    EXPECT_EQ(read["data"], "a \x1B[2J \U0010FEFF");
}

TEST_F(Listings, ThatFailSayWhyAndAnswerNoDocument)
{
    const auto missing = session.start({"--safe", "-c", "REGISTRY LIST Software\\Nothing --json"});
    EXPECT_EQ(missing.exitStatus, 1);
    EXPECT_EQ(missing.output, "The registry key \"Software\\Nothing\" does not exist.\n");
    for (const std::string command :
         {"APPS all", "HELP LOAD", "PROFILE Other", "REGISTRY SET a b", "SETVAR a b"})
    {
        const auto result = session.start({"--safe", "-c", command + " --json"});
        EXPECT_EQ(result.exitStatus, 1) << command;
        EXPECT_TRUE(result.output.starts_with("Usage: ")) << result.output;
    }
    EXPECT_EQ(session.start({"--safe", "-c", "SETVAR NONE --json"}).output,
              "There is no variable called \"NONE\".\n");
    EXPECT_EQ(answer("PROFILE")["current"], "Default");
}

TEST_F(Listings, AnswerTheLinesOfAScriptOneByOne)
{
    const auto result = session.start({"--safe", "-c", "PROFILE --json", "-c", "SETVAR LISPENABLED --json"});
    const auto end = result.output.find('\n');
    EXPECT_EQ(json::parse(result.output.substr(0, end))["current"], "Default");
    EXPECT_EQ(json::parse(result.output.substr(end))["variables"].size(), 1U);
}
