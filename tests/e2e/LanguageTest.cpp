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
