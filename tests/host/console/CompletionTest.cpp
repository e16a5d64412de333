#include <gmock/gmock.h>

#include "host/console/Completion.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
const std::vector<std::wstring> kNames = {L"HELP", L"MODLIST", L"MODRIG", L"Öffnen"};
}

TEST(Completion, CompletesTheOnlyNameThatFits)
{
    const auto completion = tessel::completeCommand(L"he", kNames);
    ASSERT_TRUE(completion);
    EXPECT_EQ(completion->text, L"HELP ");
    EXPECT_THAT(completion->candidates, IsEmpty());
}

TEST(Completion, CompletesAsFarAsTheNamesAgree)
{
    const auto completion = tessel::completeCommand(L"m", kNames);
    ASSERT_TRUE(completion);
    EXPECT_EQ(completion->text, L"MOD");
    EXPECT_THAT(completion->candidates, ElementsAre(L"MODLIST", L"MODRIG"));
}

TEST(Completion, ComparesLettersOfEveryAlphabetWithoutRegardToCase)
{
    const auto completion = tessel::completeCommand(L"öFF", kNames);
    ASSERT_TRUE(completion);
    EXPECT_EQ(completion->text, L"Öffnen ");
}

TEST(Completion, OffersEveryNameOnAnEmptyLine)
{
    const auto completion = tessel::completeCommand(L"", kNames);
    ASSERT_TRUE(completion);
    EXPECT_EQ(completion->candidates, kNames);
    EXPECT_EQ(completion->text, L"");
}

TEST(Completion, KnowsNothingAboutArgumentsOrUnknownNames)
{
    EXPECT_FALSE(tessel::completeCommand(L"HELP m", kNames));
    EXPECT_FALSE(tessel::completeCommand(L"x", kNames));
    EXPECT_FALSE(tessel::completeCommand(L"HELPX", kNames));
    EXPECT_FALSE(tessel::completeCommand(L"", {}));
}
