// Where the Tab key goes: through every control, in the order in which they are read.
#include "tests/dialogs/support/DialogTest.h"

#include <tesselui/tsuieach.h>

#import <tesselui/TsOCOpenFileDialog.h>

#include "host/ui/QuestionPanel.h"
#include "host/ui/platform/Windowing.h"

#import "modrig/dialogs/ModrigStartupSuitController.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

using testing::ElementsAre;

namespace
{
std::wstring stopName(NSView* view)
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
    std::vector<std::wstring> stops = {stopName(first)};
    for (NSView* view = [first nextValidKeyView]; view && view != first && stops.size() < 40;
         view = [view nextValidKeyView])
        stops.push_back(stopName(view));
    return stops;
}

// "Up", before which nothing is read.
NSView* firstStopOf(NSWindow* panel)
{
    return [[[[[panel contentView] subviews] objectAtIndex:0] subviews] objectAtIndex:0];
}

class TabOrder : public OpenDialogTest
{
protected:
    NSView* firstStop() { return firstStopOf(mPanel); }
    std::wstring lastFolder() { return wide([[mPanel directory] lastPathComponent]); }
};
} // namespace

TEST_F(TabOrder, OfTheMainDialogIsThatOfReading)
{
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    open();
    show();
    [mController setTabViewSelectedIndex:kLoadedApplicationsTab];
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

TEST_F(TabOrder, OfTheStartupSuiteIsThatOfReading)
{
    open();
    ModrigStartupSuitController* suite = [[[ModrigStartupSuitController alloc] init] autorelease];
    NSWindow* window = [suite window];
    [suite doInit];
    NSView* table = [suite valueForKey:@"startupTableView"];
    EXPECT_EQ([window initialFirstResponder], table);
    EXPECT_THAT(stopsFrom(table), ElementsAre(L"table of Folder", L"NSSegmentedControl", L"Help", L"Close"));
    [suite doClean];
}

TEST_F(TabOrder, OfTheAddPanelIsThatOfReading)
{
    NSMutableArray* filters = [NSMutableArray array];
    [TsOCModrigUtil populateModrigFileFilter:filters];
    TsOCOpenFileDialog* dialog = [[[TsOCOpenFileDialog alloc] init] autorelease];
    NSString* folder = [path("one.lsp") stringByDeletingLastPathComponent];
    [dialog setInitialPath:folder];
    [dialog setFileFilters:filters];
    std::vector<std::wstring> stops;
    const ModalSteps steps({[&]
                            {
                                auto* panel = (NSOpenPanel*)[NSApp modalWindow];
                                selectFilesIn(panel, {L"one.lsp"});
                                stops = stopsFrom(firstStopOf(panel));
                                [NSApp stopModal];
                            }});
    [dialog runModal];
    EXPECT_THAT(stops, ElementsAre(L"Up", L"Home", wide([folder lastPathComponent]), L"menu Recent",
                                   L"table of Kind", L"field", L"Hidden files",
                                   L"menu All Tessel applications", L"Cancel", L"Open"));
}

TEST_F(TabOrder, OfAMessageBoxIsThatOfReading)
{
    std::vector<std::wstring> stops;
    const ModalSteps steps({[&]
                            {
                                stops = stopsFrom((NSView*)[[NSApp modalWindow] initialFirstResponder]);
                                [NSApp stopModal];
                            }});
    tessel::windowing::runMessage(@"It failed.", @"There is no such file.", true);
    EXPECT_THAT(stops, ElementsAre(L"OK", L"field"));
}

TEST_F(TabOrder, OfAQuestionIsThatOfReading)
{
    std::vector<std::wstring> stops;
    const auto stopsOf = [&](const tessel::Questions::Question& question)
    {
        const ModalSteps steps({[&]
                                {
                                    NSWindow* window = [NSApp modalWindow];
                                    [window
                                        makeFirstResponder:nil]; // a field that is typed into is passed over
                                    stops = stopsFrom((NSView*)[window initialFirstResponder]);
                                    [NSApp stopModal];
                                }});
        tsuiAskInWindow({L"moon.bundle", question, {}, [] { return false; }});
        return stops;
    };
    EXPECT_THAT(stopsOf({L"Size"}), ElementsAre(L"field", L"Cancel", L"OK"));
    EXPECT_THAT(stopsOf({L"Which", {}, std::nullopt, tessel::Questions::File::kThereOrNew}),
                ElementsAre(L"field", L"Choose…", L"Cancel", L"OK"));
    EXPECT_THAT(stopsOf({L"Really?", {L"Yes", L"No"}, L"No"}), ElementsAre(L"No", L"Yes", L"Cancel"));
    EXPECT_THAT(stopsOf({L"Really?", {L"Yes", L"No"}}), ElementsAre(L"Yes", L"Cancel", L"No"));
}
