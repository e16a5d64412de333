// Where the Tab key goes: through every control, in the order in which they are read.
#include "tests/dialogs/support/DialogTest.h"

#include <tesselui/tsuieach.h>

#import <tesselui/TsOCOpenFileDialog.h>

#include "host/ui/platform/Windowing.h"

#import "modrig/dialogs/ModrigStartupSuitController.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

using testing::ElementsAre;

namespace
{
constexpr int kLoadedTab = 0;

std::wstring nameOf(NSView* view)
{
    if ([view isKindOfClass:[NSPopUpButton class]])
        return L"menu " + wide([(NSPopUpButton*)view title]);
    if ([view isKindOfClass:[NSButton class]])
        return wide([(NSButton*)view title]);
    if ([view isKindOfClass:[NSTableView class]])
        return L"table of " +
               wide([[[[(NSTableView*)view tableColumns] objectAtIndex:1] headerCell] stringValue]);
    if ([view isKindOfClass:[NSTextField class]])
        return L"field";
    return wide(NSStringFromClass([view class]));
}

std::vector<std::wstring> stopsFrom(NSView* first)
{
    std::vector<std::wstring> stops = {nameOf(first)};
    for (NSView* view = [first nextValidKeyView]; view && view != first && stops.size() < 40;
         view = [view nextValidKeyView])
        stops.push_back(nameOf(view));
    return stops;
}

class TabOrder : public OpenDialogTest
{
protected:
    // "Up", before which nothing is read.
    NSView* firstStop()
    {
        return [[[[[mPanel contentView] subviews] objectAtIndex:0] subviews] objectAtIndex:0];
    }
    std::wstring lastFolder() { return wide([[mPanel directory] lastPathComponent]); }
};
} // namespace

TEST_F(TabOrder, OfTheMainDialogIsThatOfReading)
{
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    open();
    show();
    [mController setTabViewSelectedIndex:kLoadedTab];
    select(loadedTable(), {0});
    EXPECT_THAT(stopsFrom(firstStop()),
                ElementsAre(L"Up", L"Home", lastFolder(), L"menu ", L"table of Kind", L"field",
                            L"Hidden files", L"menu All Tessel applications", L"Load", L"Add to History",
                            L"NSTabView", L"table of Folder", L"Unload", L"Contents…", L"Help", L"Close"));
}

TEST_F(TabOrder, OfTheHistoryIsThatOfReading)
{
    openHistory({"one.lsp"});
    select(historyTable(), {0});
    EXPECT_THAT(stopsFrom(firstStop()),
                ElementsAre(L"Up", L"Home", lastFolder(), L"menu ", L"table of Kind", L"field",
                            L"Hidden files", L"menu All Tessel applications", L"Load", L"Add to History",
                            L"NSTabView", L"table of Folder", L"Load", L"Add to Startup Suite", L"Remove",
                            L"Contents…", L"Help", L"Close"));
}
