#include <gmock/gmock.h>

#include "host/text/Nearest.h"

using tessel::nearest;
using testing::Eq;
using testing::Optional;

namespace
{
const std::vector<std::wstring> kTypable = {L"APPS",   L"CD",     L"HELP",  L"LOAD",
                                            L"MODRIG", L"UNLOAD", L"Öffnen"};
}

TEST(Nearest, FindsWhatOneSlipMadeOfAName)
{
    EXPECT_THAT(nearest(L"LAOD", kTypable), Optional(Eq(L"LOAD"))) << "swapped";
    EXPECT_THAT(nearest(L"hel", kTypable), Optional(Eq(L"HELP"))) << "missing";
    EXPECT_THAT(nearest(L"applss", kTypable), Optional(Eq(L"APPS"))) << "two added to what is long by then";
    EXPECT_THAT(nearest(L"heap", kTypable), Optional(Eq(L"HELP"))) << "replaced";
    EXPECT_THAT(nearest(L"cdd", kTypable), Optional(Eq(L"CD")));
    EXPECT_THAT(nearest(L"öfnen", kTypable), Optional(Eq(L"Öffnen")));
}

TEST(Nearest, AllowsTwoSlipsInALongName)
{
    EXPECT_THAT(nearest(L"MORDIGG", kTypable), Optional(Eq(L"MODRIG")));
    EXPECT_EQ(nearest(L"LAODS", kTypable), std::nullopt);
    EXPECT_EQ(nearest(L"MODERATE", kTypable), std::nullopt);
}

TEST(Nearest, TakesTheNearestOfSeveral)
{
    EXPECT_THAT(nearest(L"UNLOAT", kTypable), Optional(Eq(L"UNLOAD")));
    EXPECT_THAT(nearest(L"LOADD", kTypable), Optional(Eq(L"LOAD")));
    EXPECT_THAT(nearest(L"suit", {L"QUIT", L"SUITE"}), Optional(Eq(L"SUITE"))) << "begins so";
    EXPECT_THAT(nearest(L"suit", {L"SUITE", L"QUIT"}), Optional(Eq(L"SUITE")));
}

TEST(Nearest, TakesTheBeginningOfASingleName)
{
    EXPECT_THAT(nearest(L"mod", kTypable), Optional(Eq(L"MODRIG")));
    EXPECT_EQ(nearest(L"mo", kTypable), std::nullopt) << "anybody's guess";
    EXPECT_EQ(nearest(L"car", {L"CARPET", L"CARTON"}), std::nullopt);
}

TEST(Nearest, FindsNothingForWhatIsFarFromAll)
{
    EXPECT_EQ(nearest(L"x", kTypable), std::nullopt);
    EXPECT_EQ(nearest(L"", kTypable), std::nullopt);
    EXPECT_EQ(nearest(L"FOO", kTypable), std::nullopt);
    EXPECT_EQ(nearest(L"xy", {L"A"}), std::nullopt) << "nothing of the name is left";
    EXPECT_EQ(nearest(std::wstring(1000, L'A'), {std::wstring(999, L'A')}), std::nullopt);
}
