// The person's languages, as the environment tells them.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "host/text/Languages.h"
#include "tests/support/EnvironmentVariable.h"

namespace
{
using Languages = std::vector<std::string>;

class PersonsLanguages : public testing::Test
{
protected:
    Languages with(const std::string& all, const std::string& messages, const std::string& lang,
                   const std::string& list = "")
    {
        const EnvironmentVariable setAll("LC_ALL", all);
        const EnvironmentVariable setMessages("LC_MESSAGES", messages);
        const EnvironmentVariable setLang("LANG", lang);
        const EnvironmentVariable setList("LANGUAGE", list);
        return tessel::personsLanguages();
    }
};

TEST_F(PersonsLanguages, AreOfTheFirstVariableThatIsNotEmpty)
{
    EXPECT_EQ(with("de", "fr", "it"), Languages({"de"}));
    EXPECT_EQ(with("", "fr", "it"), Languages({"fr"}));
    EXPECT_EQ(with("", "", "it"), Languages({"it"}));
}

TEST_F(PersonsLanguages, EndWithTheLanguageOfTheCountrysOwn)
{
    EXPECT_EQ(with("", "", "de_AT.UTF-8@euro"), Languages({"de_AT", "de"}));
    EXPECT_EQ(with("", "", "de@euro"), Languages({"de"}));
}

TEST_F(PersonsLanguages, BeginWithTheListOfThem)
{
    EXPECT_EQ(with("", "", "en_GB.UTF-8", "pt_BR:fr::pt"), Languages({"pt_BR", "pt", "fr", "en_GB", "en"}));
}

TEST_F(PersonsLanguages, AreNoneForWhomThePlainTextsAreWanted)
{
    EXPECT_EQ(with("C", "de", "de", "de"), Languages());
    EXPECT_EQ(with("", "POSIX", "de", "de"), Languages());
    EXPECT_EQ(with("", "C.UTF-8", "de", "de"), Languages());
    EXPECT_EQ(with("", "", "", "de"), Languages());
}
} // namespace
