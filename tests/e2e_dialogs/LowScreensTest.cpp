// The dialogs on screens that are lower than the dialog, or hardly higher.
#include "tests/e2e_dialogs/DialogTest.h"

#include <cstdio>

namespace
{
constexpr int kHalf = 2;

struct Size
{
    int width = 0;
    int height = 0;
};

// Named by its size and resolution: "800x600at96".
class LowScreens : public DialogTest, public testing::WithParamInterface<DisplayKind>
{
protected:
    LowScreens() : DialogTest(GetParam()) {}

    Size sizeOf(const std::string& window) const
    {
        Size size;
        std::sscanf(mScreen.sizeOf(window).c_str(), "%dx%d", &size.width, &size.height);
        return size;
    }

    void expectIsOnScreen(const std::string& window) const
    {
        const Size size = sizeOf(window);
        const Place middle = mScreen.middleOf(window);
        EXPECT_GE(middle.x - size.width / kHalf, 0);
        EXPECT_GE(middle.y - size.height / kHalf, 0);
        EXPECT_LE(middle.x + size.width / kHalf, GetParam().width);
        EXPECT_LE(middle.y + size.height / kHalf, GetParam().height);
    }

    // Of a place in the lower part of the dialog, which keeps its distance from the lower edge.
    Place low(Place place) const { return {place.x, place.y - kUsualHeight + sizeOf(mDialog).height}; }

    static constexpr int kUsualHeight = 729;
};
} // namespace

TEST_P(LowScreens, HoldAllOfTheDialogWhereEverythingCanBeClicked)
{
    storeHistory({writeLisp("a.lsp")});
    const std::string file = writeLisp("b.lsp");
    open();
    expectIsOnScreen(mDialog);
    click(places::file(1));
    click(low(places::kLoad));
    EXPECT_TRUE(prints(wasLoaded("b.lsp")));
    click(low(places::kHistoryTab));
    shoot("history");
    click({places::tableRow(0).x, low(places::kHistoryTab).y + 54});
    click(low(places::kLoadFromHistory));
    EXPECT_TRUE(prints(wasLoaded("a.lsp")));
    shoot("loaded");
    click(low(places::kClose));
    EXPECT_TRUE(mScreen.waitUntilGone(kDialog));
    end();
}

TEST_P(LowScreens, HoldAllOfTheStartupSuiteAndOfItsPanelAndOfAMessageBox)
{
    writeBroken();
    open();
    click(places::file(0));
    click(low(places::kLoad));
    const std::string box = mScreen.waitForActive(kMessageBox);
    ASSERT_FALSE(box.empty());
    expectIsOnScreen(box);
    dismissMessageBox();
    ASSERT_TRUE(mScreen.waitUntilActive(mDialog));
    click(low(places::kContents));
    const std::string suite = mScreen.waitForActive(kSuiteDialog);
    ASSERT_FALSE(suite.empty());
    expectIsOnScreen(suite);
    mScreen.click(suite, places::kAdd);
    const std::string panel = mScreen.waitForActive(kAddPanel);
    ASSERT_FALSE(panel.empty());
    expectIsOnScreen(panel);
    shoot("panel");
    mScreen.key("Escape");
    EXPECT_TRUE(mScreen.waitUntilGone(kAddPanel));
    shoot("suite");
    mScreen.key("Escape");
    EXPECT_TRUE(mScreen.waitUntilGone(kSuiteDialog));
    closeAndEnd();
}

INSTANTIATE_TEST_SUITE_P(, LowScreens,
                         testing::Values(DisplayKind{.width = 800, .height = 600},
                                         DisplayKind{.width = 1024, .height = 600},
                                         DisplayKind{.width = 1280, .height = 800},
                                         DisplayKind{.width = 1366, .height = 768},
                                         DisplayKind{.width = 800, .height = 600, .dotsPerInch = 144}),
                         [](const auto& instance)
                         {
                             return std::to_string(instance.param.width) + "x" +
                                    std::to_string(instance.param.height) + "at" +
                                    std::to_string(instance.param.dotsPerInch);
                         });
