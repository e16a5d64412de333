// Which of a module's languages a person gets texts in.
#include "host/resources/ModuleLanguages.h"

#include <gtest/gtest.h>

namespace
{
using tessel::inWantedOrder;
using tessel::numbersOf;
using Numbers = std::vector<tessel::LanguageNumber>;

constexpr tessel::LanguageNumber kGerman = 0x0007, kGermany = 0x0407, kSwitzerland = 0x0807,
                                 kAustria = 0x0c07;
constexpr tessel::LanguageNumber kAmerica = 0x0409, kBritain = 0x0809, kFrench = 0x000c;

TEST(ModuleLanguages, HaveTheNumbersThatScriptsOfResourcesName)
{
    EXPECT_EQ(numbersOf({"de_AT", "de", "en_US", "en_GB", "fr"}),
              Numbers({kAustria, kGerman, kAmerica, kBritain, kFrench}));
    EXPECT_EQ(numbersOf({"zh_TW", "pt_BR"}), Numbers({0x0404, 0x0416}));
}

TEST(ModuleLanguages, LeaveOutNamesThatNobodyKnows)
{
    EXPECT_EQ(numbersOf({"xx_YY", "", "q", "de"}), Numbers({kGerman}));
}

TEST(ModuleLanguages, StayInTheModulesOrderWhereNoneIsWanted)
{
    EXPECT_EQ(inWantedOrder({kAmerica, kGermany, kFrench}, {}), Numbers({kAmerica, kGermany, kFrench}));
    EXPECT_EQ(inWantedOrder({kFrench, kAmerica}, {kGermany, kGerman}), Numbers({kFrench, kAmerica}));
}

TEST(ModuleLanguages, BeginWithTheWantedOnesInTheirOrder)
{
    EXPECT_EQ(inWantedOrder({kAmerica, kGermany, kFrench}, {kFrench, kGermany}),
              Numbers({kFrench, kGermany, kAmerica}));
}

TEST(ModuleLanguages, GiveTheCountrysOwnThenTheLanguageThenThatOfItsMainCountryThenOthers)
{
    EXPECT_EQ(inWantedOrder({kAmerica, kSwitzerland, kGermany, kGerman, kAustria}, {kAustria, kGerman}),
              Numbers({kAustria, kGerman, kGermany, kSwitzerland, kAmerica}));
}

TEST(ModuleLanguages, OfAnotherCountryAreNotWantedByThemselves)
{
    EXPECT_EQ(inWantedOrder({kFrench, kAmerica, kBritain}, {kBritain}),
              Numbers({kBritain, kFrench, kAmerica}));
}

// Some languages by themselves have numbers that look like those with a country.
TEST(ModuleLanguages, AreFoundByTheNameOfALanguageWithoutACountry)
{
    const Numbers chinese = numbersOf({"zh"}), norwegian = numbersOf({"nb"});
    EXPECT_EQ(inWantedOrder({kAmerica, 0x0804}, chinese), Numbers({0x0804, kAmerica}));
    EXPECT_EQ(inWantedOrder({kAmerica, 0x0414}, norwegian), Numbers({0x0414, kAmerica}));
}
} // namespace
