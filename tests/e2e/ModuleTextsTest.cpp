// The texts of modules, in the languages that the environment names.
#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostProcess.h"

using testing::HasSubstr;

namespace
{
// What the moon says of itself to a person with these languages.
std::string moonFor(const std::string& lang, const std::string& list = "")
{
    HostSession session;
    session.set("LC_ALL", "");
    session.set("LC_MESSAGES", "");
    session.set("LANG", lang);
    session.set("LANGUAGE", list);
    return session.start({sample("moon.bundle"), "-c", "MOONPHASE"}).output;
}
} // namespace

TEST(ModuleTexts, ComeInThePersonsLanguageWithoutTheSystemsDataOfIt)
{
    EXPECT_THAT(moonFor("de_DE.UTF-8"), HasSubstr("Heute Nacht: "));
    EXPECT_THAT(moonFor("de_AT.UTF-8@euro"), HasSubstr("Heute Nacht: "));
    EXPECT_THAT(moonFor("en_GB.UTF-8", "fr:de"), HasSubstr("Heute Nacht: "));
}

TEST(ModuleTexts, ComeInTheModulesFirstLanguageToAllOthers)
{
    for (const char* lang : {"fr_FR.UTF-8", "C.UTF-8", ""})
        EXPECT_THAT(moonFor(lang), HasSubstr("Tonight: ")) << lang;
    EXPECT_THAT(moonFor("en_US.UTF-8", "en:de"), HasSubstr("Tonight: "));
}
