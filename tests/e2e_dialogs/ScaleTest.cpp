// Dialogs on screens of any resolution.
#include "tests/e2e_dialogs/DialogTest.h"

#include <cstdio>

namespace
{
constexpr DisplayKind kLargeDisplay{.width = 2600, .height = 2500};
constexpr int kDialogHeight = 729;
constexpr Place kNameLabel{36, 330};
constexpr Place kHiddenFilesBox{597, 331};
constexpr char kTip[] = "Window"; // what the toolkit calls windows without a title
constexpr int kNarrowestTip = 145;
constexpr int kLowestTip = 20;
constexpr double kRounding = 3; // of the parts to whole pixels, added up

void expectScaled(const std::string& size, double scale)
{
    int width = 0;
    int height = 0;
    ASSERT_EQ(2, std::sscanf(size.c_str(), "%dx%d", &width, &height)) << size;
    EXPECT_NEAR(width, places::kDialogWidth * scale, kRounding);
    EXPECT_NEAR(height, kDialogHeight * scale, kRounding);
}

Place scaledPlace(Place place, double scale)
{
    return {static_cast<int>(place.x * scale), static_cast<int>(place.y * scale)};
}

class DialogScale : public DialogTest, public testing::WithParamInterface<double>
{
protected:
    DialogScale() : DialogTest(kLargeDisplay) {}
};

class DialogResolution : public DialogTest, public testing::WithParamInterface<std::pair<int, double>>
{
protected:
    DialogResolution() : DialogTest({.width = 2600, .height = 2500, .dotsPerInch = GetParam().first}) {}
};
} // namespace

TEST_P(DialogScale, OpensLargerAndAnswersClicks)
{
    const double scale = GetParam();
    storeHistory(writeManyLisp(30)); // more than fit: the table gets a scroller
    setToolkitSetting("GSScaleFactor", std::to_string(scale));
    open();
    expectScaled(mScreen.sizeOf(mDialog), scale);
    click(scaledPlace(places::kHistoryTab, scale));
    click(scaledPlace(places::tableRow(1), scale));
    click(scaledPlace(places::kLoadFromHistory, scale));
    EXPECT_TRUE(prints(wasLoaded("many2.lsp")));
    shoot("loaded");
    closeAndEnd();
}

// What lies outside of the inside of a window is black, and what is cut of it is missing.
TEST_P(DialogScale, FillsTheWindowToItsEdges)
{
    setToolkitSetting("GSScaleFactor", std::to_string(GetParam()));
    open();
    int width = 0;
    int height = 0;
    ASSERT_EQ(2, std::sscanf(mScreen.sizeOf(mDialog).c_str(), "%dx%d", &width, &height));
    const std::string background = mScreen.colourOf(mDialog, {0, 0}, width, 2);
    EXPECT_NE(background, "several");
    EXPECT_EQ(mScreen.colourOf(mDialog, {0, height - 2}, width, 2), background);
    EXPECT_EQ(mScreen.colourOf(mDialog, {0, 0}, 2, height), background);
    EXPECT_EQ(mScreen.colourOf(mDialog, {width - 2, 0}, 2, height), background);
    closeAndEnd();
}

// Letters that are drawn over themselves look bold, and the frame of the focus stays where it was.
TEST_P(DialogScale, DrawsAgainWhatWasThere)
{
    setToolkitSetting("GSScaleFactor", std::to_string(GetParam()));
    open();
    const Place label = scaledPlace(kNameLabel, GetParam());
    const Place box = scaledPlace(kHiddenFilesBox, GetParam());
    const std::string labelBefore = look(label);
    const std::string boxBefore = look(box);
    press("Tab", 2);
    EXPECT_TRUE(changes(box, boxBefore)) << "it has the focus";
    shoot("focus");
    press("Tab", 3);
    EXPECT_TRUE(comesTrue([&] { return look(box) == boxBefore; }));
    EXPECT_EQ(look(label), labelBefore);
    closeAndEnd();
}

TEST_P(DialogScale, ShowsTipsAsLargeAsTheirText)
{
    setToolkitSetting("GSScaleFactor", std::to_string(GetParam()));
    open();
    mScreen.moveOn(mDialog, scaledPlace(places::kLoad, GetParam()));
    std::string tip;
    EXPECT_TRUE(comesTrue([&] { return !(tip = mScreen.window(kTip)).empty(); }));
    shoot("tip");
    int width = 0;
    int height = 0;
    ASSERT_EQ(2, std::sscanf(mScreen.sizeOf(tip).c_str(), "%dx%d", &width, &height));
    EXPECT_GT(width, kNarrowestTip * GetParam());
    EXPECT_GT(height, kLowestTip * GetParam());
    closeAndEnd();
}

INSTANTIATE_TEST_SUITE_P(Quarters, DialogScale, testing::Values(1, 1.25, 1.5, 1.75, 2, 2.5, 3));

TEST_P(DialogResolution, GivesTheScaleWhenNoneIsSet)
{
    open();
    expectScaled(mScreen.sizeOf(mDialog), GetParam().second);
    closeAndEnd();
}

TEST_P(DialogResolution, GivesWayToAScaleThatIsSet)
{
    setToolkitSetting("GSScaleFactor", "1");
    open();
    expectScaled(mScreen.sizeOf(mDialog), 1);
    closeAndEnd();
}

TEST_P(DialogResolution, GivesWayToAScaleThatIsSetForAllProgramsOfTheToolkit)
{
    mSession.folder().write("home/GNUstep/Defaults/NSGlobalDomain.plist", "{ GSScaleFactor = 1.75; }\n");
    open();
    expectScaled(mScreen.sizeOf(mDialog), 1.75);
    closeAndEnd();
}

TEST_P(DialogResolution, GivesWayToTheResolutionThatTheDesktopWants)
{
    mScreen.setResource("Xft.dpi:\t120\n");
    open();
    expectScaled(mScreen.sizeOf(mDialog), 1.25);
    closeAndEnd();
}

INSTANTIATE_TEST_SUITE_P(DotsPerInch, DialogResolution,
                         testing::Values(std::pair{72, 1.0}, std::pair{100, 1.0}, std::pair{144, 1.5},
                                         std::pair{192, 2.0}));

namespace
{
struct SmallScreen
{
    DisplayKind kind;
    int percent; // of the usual size
};

class DialogOnSmallScreens : public DialogTest, public testing::WithParamInterface<SmallScreen>
{
protected:
    DialogOnSmallScreens() : DialogTest(GetParam().kind) {}

    // Neither the size that it has with room, nor less than what it can do with.
    void expectIsScaledToTheScreen() const
    {
        int width = 0;
        int height = 0;
        ASSERT_EQ(2, std::sscanf(mScreen.sizeOf(mDialog).c_str(), "%dx%d", &width, &height));
        const double scale = GetParam().percent / 100.0;
        EXPECT_NEAR(width, places::kDialogWidth * scale, kRounding);
        EXPECT_LE(height, GetParam().kind.height);
        EXPECT_GE(height, kLeastDialogHeight * scale);
    }

    static constexpr int kLeastDialogHeight = 480;
};
} // namespace

// Letters as large as the screen's resolution asks for would leave no room for what is to be done.
TEST_P(DialogOnSmallScreens, IsNoLargerThanLetsItBeUsed)
{
    open();
    expectIsScaledToTheScreen();
    closeAndEnd();
}

TEST_P(DialogOnSmallScreens, IsNoLargerThanThatByASettingEither)
{
    setToolkitSetting("GSScaleFactor", "3");
    open();
    expectIsScaledToTheScreen();
    shoot("dialog");
    closeAndEnd();
}

INSTANTIATE_TEST_SUITE_P(
    , DialogOnSmallScreens,
    testing::Values(SmallScreen{{.width = 800, .height = 600, .dotsPerInch = 144}, 100},
                    SmallScreen{{.width = 1024, .height = 768, .dotsPerInch = 192}, 125},
                    SmallScreen{{.width = 1280, .height = 720, .dotsPerInch = 192}, 125},
                    SmallScreen{{.width = 1200, .height = 1000, .dotsPerInch = 192}, 150}),
    [](const auto& instance)
    { return std::to_string(instance.param.kind.width) + "x" + std::to_string(instance.param.kind.height); });
