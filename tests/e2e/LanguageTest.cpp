// What Tessel says to a person with a language of their own.
#include <gmock/gmock.h>

#include "tests/e2e/HostProcess.h"

namespace
{
using testing::HasSubstr;

class PersonsLanguage : public testing::Test
{
protected:
    std::string saysAbout(const std::string& command) { return mSession.run({command}).output; }

    HostSession mSession;
};

TEST_F(PersonsLanguage, IsSpokenWithoutALocaleOfItOnTheMachine)
{
    mSession.set("LC_ALL", "");
    mSession.set("LANG", "de_DE.UTF-8");
    EXPECT_THAT(saysAbout("SETVAR NONE 1"), HasSubstr("Eine Variable „NONE“ gibt es nicht."));
}

TEST_F(PersonsLanguage, IsThatOfTheLispToo)
{
    mSession.set("LC_ALL", "de_DE");
    EXPECT_THAT(saysAbout("(/ 1 0)"), HasSubstr("Division durch null."));
    EXPECT_THAT(saysAbout("(load \"none\")"), HasSubstr("„none“ kann nicht geladen werden: "));
}

TEST_F(PersonsLanguage, IsEnglishWhereTheHostDoesNotSpeakIt)
{
    mSession.set("LC_ALL", "tlh_AQ.UTF-8");
    EXPECT_THAT(saysAbout("SETVAR NONE 1"), HasSubstr("There is no variable called \"NONE\"."));
}

TEST_F(PersonsLanguage, IsThatOfTheGreetingTheVersionAndTheHeadOfHelp)
{
    mSession.set("LC_ALL", "de_DE.UTF-8");
    const std::string line = "Tessel R21, Referenzhost für Modrig";
    const auto said = mSession.start({"--safe", "-c", "VERSION", "-c", "HELP"}).output;
    EXPECT_THAT(said, testing::StartsWith(line + ". HELP zeigt"));
    EXPECT_THAT(said, HasSubstr("Command: VERSION\n" + line + ", Version " MODRIG_VERSION "\n"));
    EXPECT_THAT(said, HasSubstr("Command: HELP\n" + line + ", Version " MODRIG_VERSION "\n"));
}

TEST_F(PersonsLanguage, IsThatOfTheOptionsAndOfWhatIsWrongWithThem)
{
    mSession.set("LC_ALL", "de_DE.UTF-8");
    const auto help = mSession.start({"--help"}).output;
    for (const char* part : {"[OPTIONEN] [DATEI...]", "\n  DATEI ... ", "--profile-dir ORDNER ",
                             "--script SKRIPT ", "--command BEFEHL ", "--log DATEI "})
        EXPECT_THAT(help, HasSubstr(part));
    const auto refused = [this](const std::vector<std::string>& arguments)
    {
        const auto result = mSession.start(arguments);
        EXPECT_EQ(result.exitStatus, 2);
        return result.output;
    };
    const std::string more = "\nMehr dazu sagt --help.\n";
    EXPECT_EQ(refused({"--none"}), "Dieses Argument gibt es nicht: --none" + more);
    EXPECT_EQ(refused({"--none", "-z"}), "Diese Argumente gibt es nicht: -z --none" + more);
    EXPECT_EQ(refused({"--log"}), "Nach --log fehlt noch etwas: DATEI" + more);
    EXPECT_EQ(refused({"-q", "-v"}), "--quiet und --verbose können nicht zugleich angegeben werden." + more);
    EXPECT_EQ(refused({"--safe=3"}), "--safe nimmt keinen Wert." + more);
    EXPECT_EQ(refused({"--log", ""}), "--log: eine Datei ist nötig, und keine ist genannt" + more);
}

TEST_F(PersonsLanguage, IsFoundBesideAMovedProgram)
{
    const auto app = std::filesystem::path(TESSEL_PROGRAM).parent_path();
    const auto moved = mSession.folder() / "moved";
    std::filesystem::copy(app, moved, std::filesystem::copy_options::recursive);
    mSession.startBy("exec '" + (moved / "Tessel").string() + "' \"$@\"");
    mSession.set("LC_ALL", "de_AT.UTF-8");
    EXPECT_THAT(saysAbout("SETVAR NONE 1"), HasSubstr("Eine Variable „NONE“ gibt es nicht."));
    std::filesystem::remove_all(moved / "Resources" / "locale");
    EXPECT_THAT(saysAbout("SETVAR NONE 1"), HasSubstr("There is no variable called \"NONE\"."));
}
} // namespace
