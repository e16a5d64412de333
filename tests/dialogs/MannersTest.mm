// What a person expects of the dialog's tables without being told: real clicks and keys in its window.
#include "tests/dialogs/support/DialogTest.h"
#include "tests/dialogs/support/Events.h"
#include "tests/dialogs/support/Pictures.h"

#include "host/ui/platform/gnustep/TextFitting.h"

#include <tesselui/tsuieach.h>

#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/ModrigNameCell.h"
#import "modrig/dialogs/ModrigTableView.h"
#import "modrig/dialogs/ModrigTipButton.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

#include "modrig/messages/MessageIds.h"
#include "tests/support/recording/RecordingKeptOut.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
// The button with that action in the view.
NSButton* buttonIn(NSView* view, SEL action)
{
    if ([view isKindOfClass:[NSButton class]] && sel_isEqual([(NSButton*)view action], action))
        return (NSButton*)view;
    for (NSView* inner : tsuiEach<NSView*>([view subviews]))
        if (NSButton* found = buttonIn(inner, action))
            return found;
    return nil;
}

class Manners : public OpenDialogTest
{
protected:
    void openLoaded(std::initializer_list<std::string> names)
    {
        for (const std::string& name : names)
            gLoadedAppList.AddTail(name.ends_with(".zmb") ? loadedModule(name) : file(name));
        open();
        [mController setTabViewSelectedIndex:kLoadedApplicationsTab];
        show();
    }
    NSButton* buttonOf(SEL action) { return buttonIn([mController view], action); }
    static NSPoint headerOf(NSTableView* table)
    {
        return events::middleOf([[table headerView] headerRectOfColumn:0]);
    }
};
} // namespace

TEST_F(Manners, LoadNothingForADoubleClickOnAColumnsHeader)
{
    openHistory({"one.lsp", "two.lsp"});
    events::clickRow(historyTable(), 1);
    ASSERT_THAT(selectionOf(historyList()), ElementsAre(file("two.lsp")));
    events::click([historyTable() headerView], headerOf(historyTable()), 0, 2);
    EXPECT_THAT(rowsOf(loadedApps()), IsEmpty());
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(Manners, LoadNothingForADoubleClickBelowTheLastRow)
{
    openHistory({"one.lsp", "two.lsp"});
    events::clickRow(historyTable(), 1);
    const NSRect last = [historyTable() rectOfRow:1];
    events::click(historyTable(), NSMakePoint(NSMidX(last), NSMaxY(last) + 20), 0, 2);
    EXPECT_THAT(rowsOf(loadedApps()), IsEmpty());
}

TEST_F(Manners, LoadARowThatIsDoubleClicked)
{
    openHistory({"one.lsp", "two.lsp"});
    events::clickRow(historyTable(), 1, 0, 2);
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("two.lsp")));
}

TEST_F(Manners, TakeTheLastSuccessAwayWhenTheNextLoadFails)
{
    open();
    load({"one.zmb"});
    ASSERT_EQ(Message(ModrigMessages::kOneLoaded, L"one.zmb"), message());
    host().linker.refuseToLoad(file("bad.zmb"));
    load({"bad.zmb"});
    EXPECT_EQ(L"", message());
}

TEST_F(Manners, TakeTheLastSuccessAwayWhenTheNextUnloadFails)
{
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    open();
    [mController setMessage:@"two.zmb was unloaded."];
    select(loadedTable(), {0});
    host().linker.refuseToUnload(file("one.zmb"));
    [mController onUnload:nil];
    EXPECT_EQ(L"", message());
}

TEST_F(Manners, LeaveTheMessageAloneWhenAnActionHasNothingToDo)
{
    open();
    [mController setMessage:@"one.zmb was loaded."];
    [mController onUnload:nil];
    [mController onRemove:nil];
    [mController onLoadFromHistory:nil];
    EXPECT_EQ(L"one.zmb was loaded.", message());
}

TEST_F(Manners, TakeTheLastSuccessAwayWhenADropIsRefused)
{
    open();
    [mController setMessage:@"one.zmb was loaded."];
    NSMutableArray* many = [NSMutableArray array];
    for (int index = 0; index < 51; ++index)
        [many addObject:path("one.zmb")];
    [mController loadedAppsTableViewDropFiles:many atRow:0];
    EXPECT_EQ(L"", message());
    [mController setMessage:@"one.zmb was loaded."];
    [mController loadedAppsTableViewDropFiles:paths({"readme.txt"}) atRow:0];
    EXPECT_EQ(L"", message());
}

namespace
{
NSString* key(unichar character)
{
    return [NSString stringWithCharacters:&character length:1];
}

class TableKeys : public Manners
{
protected:
    void pressInTable(NSTableView* table, NSString* characters, unsigned modifiers = 0)
    {
        [[table window] makeFirstResponder:table];
        events::press([table window], characters, modifiers);
    }
    // The menu that a click with the other button opens on the row.
    static NSMenu* menuOn(NSTableView* table, NSInteger row)
    {
        const NSPoint place = events::middleOf([table rectOfRow:row]);
        return [table menuForEvent:[NSEvent mouseEventWithType:NSRightMouseDown
                                                      location:[table convertPoint:place toView:nil]
                                                 modifierFlags:0
                                                     timestamp:0
                                                  windowNumber:[[table window] windowNumber]
                                                       context:[[table window] graphicsContext]
                                                   eventNumber:0
                                                    clickCount:1
                                                      pressure:1]];
    }
    static std::vector<std::wstring> titlesIn(NSMenu* menu)
    {
        std::vector<std::wstring> titles;
        for (NSInteger index = 0; index < [menu numberOfItems]; ++index)
        {
            NSMenuItem* item = [menu itemAtIndex:index];
            titles.push_back([item isSeparatorItem] ? L"-" : wide([item title]));
        }
        return titles;
    }
    std::vector<std::size_t> selectedRows()
    {
        std::vector<std::size_t> rows;
        NSIndexSet* selected = [historyTable() selectedRowIndexes];
        for (NSUInteger row = [selected firstIndex]; row != NSNotFound;
             row = [selected indexGreaterThanIndex:row])
            rows.push_back(row);
        return rows;
    }
    static bool isEnabled(NSTableView* table, NSMenu* menu, NSString* title)
    {
        return [(id)table validateMenuItem:[menu itemWithTitle:title]];
    }
    static void choose(NSMenu* menu, NSString* title)
    {
        id item = [menu itemWithTitle:title];
        [NSApp sendAction:[item action] to:[item target] from:item];
    }
    static std::wstring copied()
    {
        return wide([[NSPasteboard generalPasteboard] stringForType:NSStringPboardType]);
    }
};
} // namespace

TEST_F(TableKeys, RemoveTheSelectedRowsOfTheHistory)
{
    openHistory({"a.lsp", "b.lsp", "c.lsp"});
    select(historyTable(), {1});
    pressInTable(historyTable(), key(NSDeleteFunctionKey));
    EXPECT_THAT(rowsOf(historyList()), ElementsAre(file("a.lsp"), file("c.lsp")));
    EXPECT_THAT(Texts(gHistoryList), ElementsAre(file("a.lsp"), file("c.lsp")));
    EXPECT_EQ(Message(ModrigMessages::kOneRemovedFromHistory, L"b.lsp"), message());
}

TEST_F(TableKeys, SelectEveryRow)
{
    openHistory({"a.lsp", "b.lsp", "c.lsp"});
    pressInTable(historyTable(), @"a", NSControlKeyMask);
    EXPECT_THAT(selectionOf(historyList()), ElementsAre(file("a.lsp"), file("b.lsp"), file("c.lsp")));
    EXPECT_TRUE([mController canRemoveHistory]);
}

TEST_F(TableKeys, SelectEveryRowThatCanBeUnloaded)
{
    openLoaded({"a.zmb", "tool.lsp", "b.zmb"});
    pressInTable(loadedTable(), @"\001", NSControlKeyMask);
    EXPECT_THAT(selectionOf(loadedApps()), ElementsAre(file("a.zmb"), file("b.zmb")));
}

TEST_F(TableKeys, GoToTheRowThatBeginsWithWhatIsTyped)
{
    openHistory({"gears.lsp", "moon.lsp", "monk.lsp", "primes.lsp"});
    pressInTable(historyTable(), @"m");
    EXPECT_THAT(selectionOf(historyList()), ElementsAre(file("moon.lsp")));
    pressInTable(historyTable(), @"o");
    pressInTable(historyTable(), @"n");
    EXPECT_THAT(selectionOf(historyList()), ElementsAre(file("monk.lsp")));
    EXPECT_TRUE([mController canRemoveHistory]);
}

TEST_F(TableKeys, CopyThePathsOfTheSelectedRows)
{
    openHistory({"a.lsp", "b.lsp", "c.lsp"});
    select(historyTable(), {0, 2});
    pressInTable(historyTable(), @"c", NSControlKeyMask);
    EXPECT_EQ(file("a.lsp") + L"\n" + file("c.lsp"), copied());
}

TEST_F(TableKeys, OpenHelpFromEverywhereInTheDialog)
{
    openHistory({"a.lsp"});
    pressInTable(historyTable(), key(NSF1FunctionKey));
    EXPECT_THAT(host().journal.entries(),
                testing::Contains(testing::HasSubstr(L"load_unload_applications_dialog")));
}

TEST_F(TableKeys, TakeARangeWithShiftAndSingleRowsWithControl)
{
    openHistory({"a.lsp", "b.lsp", "c.lsp", "d.lsp"});
    events::clickRow(historyTable(), 0);
    events::clickRow(historyTable(), 2, NSShiftKeyMask);
    EXPECT_THAT(selectionOf(historyList()), ElementsAre(file("a.lsp"), file("b.lsp"), file("c.lsp")));
    events::clickRow(historyTable(), 1, NSControlKeyMask);
    EXPECT_THAT(selectionOf(historyList()), ElementsAre(file("a.lsp"), file("c.lsp")));
    events::clickRow(historyTable(), 3, NSControlKeyMask);
    EXPECT_THAT(selectionOf(historyList()), ElementsAre(file("a.lsp"), file("c.lsp"), file("d.lsp")));
}

TEST_F(TableKeys, TakeARangeWithShiftAndTheArrows)
{
    openHistory({"a.lsp", "b.lsp", "c.lsp", "d.lsp"});
    events::clickRow(historyTable(), 1);
    pressInTable(historyTable(), key(NSDownArrowFunctionKey), NSShiftKeyMask);
    EXPECT_THAT(selectedRows(), ElementsAre(1, 2));
    pressInTable(historyTable(), key(NSDownArrowFunctionKey), NSShiftKeyMask);
    EXPECT_THAT(selectedRows(), ElementsAre(1, 2, 3));
    pressInTable(historyTable(), key(NSUpArrowFunctionKey), NSShiftKeyMask);
    EXPECT_THAT(selectedRows(), ElementsAre(1, 2));
    pressInTable(historyTable(), key(NSUpArrowFunctionKey), NSShiftKeyMask);
    pressInTable(historyTable(), key(NSUpArrowFunctionKey), NSShiftKeyMask);
    EXPECT_THAT(selectedRows(), ElementsAre(0, 1));
}

TEST_F(TableKeys, TakeARangeToTheEndsWithShift)
{
    openHistory({"a.lsp", "b.lsp", "c.lsp", "d.lsp"});
    events::clickRow(historyTable(), 1);
    pressInTable(historyTable(), key(NSEndFunctionKey), NSShiftKeyMask);
    EXPECT_THAT(selectedRows(), ElementsAre(1, 2, 3));
    pressInTable(historyTable(), key(NSHomeFunctionKey), NSShiftKeyMask);
    EXPECT_THAT(selectedRows(), ElementsAre(0, 1));
    pressInTable(historyTable(), key(NSEndFunctionKey));
    EXPECT_THAT(selectedRows(), ElementsAre(3));
    pressInTable(historyTable(), key(NSHomeFunctionKey));
    EXPECT_THAT(selectedRows(), ElementsAre(0));
}

TEST_F(TableKeys, GoAPageFurtherAndTakeItWithShift)
{
    for (int number = 0; number < 60; ++number)
        gHistoryList.AddTail(CStdStr(file("tool" + std::to_string(number) + ".lsp")));
    openHistory({});
    events::clickRow(historyTable(), 0);
    pressInTable(historyTable(), key(NSPageDownFunctionKey), NSShiftKeyMask);
    const auto page = selectedRows();
    EXPECT_GT(page.size(), 4u);
    EXPECT_LT(page.size(), 30u);
    EXPECT_EQ(0u, page.front());
    pressInTable(historyTable(), key(NSPageDownFunctionKey));
    EXPECT_THAT(selectedRows(), ElementsAre(2 * page.back()));
    EXPECT_TRUE(NSLocationInRange(2 * page.back(), [historyTable() rowsInRect:[historyTable() visibleRect]]));
    pressInTable(historyTable(), key(NSPageUpFunctionKey), NSShiftKeyMask);
    EXPECT_EQ(page.back(), selectedRows().front());
    EXPECT_EQ(page.size(), selectedRows().size());
}

TEST_F(TableKeys, PassOverRowsThatCannotBeSelected)
{
    openLoaded({"a.zmb", "tool.lsp", "b.zmb", "other.lsp"});
    events::clickRow(loadedTable(), 0);
    pressInTable(loadedTable(), key(NSDownArrowFunctionKey));
    EXPECT_THAT(selectionOf(loadedApps()), ElementsAre(file("b.zmb")));
    pressInTable(loadedTable(), key(NSHomeFunctionKey));
    EXPECT_THAT(selectionOf(loadedApps()), ElementsAre(file("a.zmb")));
    pressInTable(loadedTable(), key(NSEndFunctionKey), NSShiftKeyMask);
    EXPECT_THAT(selectionOf(loadedApps()), ElementsAre(file("a.zmb"), file("b.zmb")));
    pressInTable(loadedTable(), key(NSEndFunctionKey));
    EXPECT_THAT(selectionOf(loadedApps()), ElementsAre(file("b.zmb")));
}

TEST_F(TableKeys, OfTheMouseOpenAMenuWithWhatTheButtonsDo)
{
    openHistory({"a.lsp", "b.lsp"});
    NSMenu* menu = menuOn(historyTable(), 1);
    EXPECT_THAT(selectionOf(historyList()), ElementsAre(file("b.lsp"))) << "the row under the pointer";
    EXPECT_THAT(titlesIn(menu), ElementsAre(L"Load", L"Add to Startup Suite", L"Remove", L"-", L"Copy Path",
                                            L"Show in Folder"));
    choose(menu, @"Load");
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("b.lsp")));
    choose(menuOn(historyTable(), 1), @"Add to Startup Suite");
    EXPECT_THAT(Texts(gStartupList), ElementsAre(file("b.lsp")));
    choose(menuOn(historyTable(), 1), @"Remove");
    EXPECT_THAT(rowsOf(historyList()), ElementsAre(file("a.lsp")));
}

TEST_F(TableKeys, OfTheMouseKeepApplicationsOutAndLetThemIn)
{
    RecordingKeptOut service;
    host().services.set(TSRX_KEPT_OUT, &service);
    openHistory({"a.lsp", "b.lsp"});
    select(historyTable(), {0, 1});
    NSMenu* menu = menuOn(historyTable(), 1);
    EXPECT_THAT(titlesIn(menu), ElementsAre(L"Load", L"Add to Startup Suite", L"Remove", L"-",
                                            L"Keep Out at Starts", L"-", L"Copy Path", L"Show in Folder"));
    choose(menu, @"Keep Out at Starts");
    EXPECT_THAT(service.keptOut, ElementsAre(file("a.lsp"), file("b.lsp")));
    EXPECT_EQ(file("a.lsp") + L"\nThis application is kept out.", wide([(id)historyTable() tipForRow:0]));
    EXPECT_EQ([NSColor disabledControlTextColor], [(id)historyTable() textColorOfRow:0]);
    service.reasons.erase(file("a.lsp"));
    EXPECT_EQ(file("a.lsp"), wide([(id)historyTable() tipForRow:0]));
    EXPECT_EQ([NSColor controlTextColor], [(id)historyTable() textColorOfRow:0]);
    choose(menuOn(historyTable(), 1), @"Let In at Starts");
    EXPECT_THAT(service.letInAgain, ElementsAre(file("b.lsp")));
    EXPECT_THAT(rowsOf(historyList()), ElementsAre(file("a.lsp"), file("b.lsp")));
    host().services.miss(TSRX_KEPT_OUT);
}

TEST_F(TableKeys, OfTheMouseKeepSeveralSelectedRowsForTheMenu)
{
    openHistory({"a.lsp", "b.lsp", "c.lsp"});
    select(historyTable(), {0, 1});
    NSMenu* menu = menuOn(historyTable(), 1);
    EXPECT_THAT(selectionOf(historyList()), ElementsAre(file("a.lsp"), file("b.lsp")));
    choose(menu, @"Copy Path");
    EXPECT_EQ(file("a.lsp") + L"\n" + file("b.lsp"), copied());
}

TEST_F(TableKeys, OfTheMouseLeaveARowThatCannotBeUnloadedUnselected)
{
    openLoaded({"a.zmb", "tool.lsp"});
    NSMenu* menu = menuOn(loadedTable(), 1);
    EXPECT_THAT(selectionOf(loadedApps()), IsEmpty());
    EXPECT_FALSE(isEnabled(loadedTable(), menu, @"Unload"));
    EXPECT_TRUE(isEnabled(loadedTable(), menu, @"Copy Path"));
    choose(menu, @"Copy Path");
    EXPECT_EQ(file("tool.lsp"), copied());
    choose(menuOn(loadedTable(), 0), @"Unload");
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("tool.lsp")));
}

TEST_F(Manners, TellTheWholePathAndWhyARowIsGrey)
{
    openHistory({"a.lsp"});
    const auto tipOf = [](NSTableView* table, NSInteger row) { return wide([(id)table tipForRow:row]); };
    EXPECT_EQ(file("a.lsp"), tipOf(historyTable(), 0));
    std::filesystem::remove(mFolder / "a.lsp");
    EXPECT_EQ(file("x").substr(0, file("x").size() - 1) + L"a.lsp\nThis file does not exist.",
              tipOf(historyTable(), 0));
}

TEST_F(Manners, ShowWhichApplicationsCouldNotBeLoadedAtOnceAndUntilTheyAre)
{
    openHistory({"good.zmb", "bad.zmb"});
    host().linker.refuseToLoad(file("bad.zmb"));
    const auto look = [this] { return pictureOf(historyTable(), [historyTable() rectOfRow:1]); };
    NSData* before = look();
    select(historyTable(), {1});
    [mPanel displayIfNeeded];
    ASSERT_FALSE([historyTable() needsDisplay]);
    [mController onLoadFromHistory:nil];
    EXPECT_TRUE([historyTable() needsDisplay]);
    [historyTable() deselectAll:nil];
    events::pump();
    EXPECT_FALSE([before isEqual:look()]) << "the row is not grey";
    const auto tip = [this] { return wide([(id)historyTable() tipForRow:1]); };
    EXPECT_EQ(file("bad.zmb") + L"\nThis application could not be loaded when it was last tried.", tip());
    host().linker.allow(file("bad.zmb"));
    select(historyTable(), {1});
    [mController onLoadFromHistory:nil];
    [historyTable() deselectAll:nil];
    events::pump();
    EXPECT_TRUE([before isEqual:look()]) << "the row is still grey";
    EXPECT_EQ(file("bad.zmb"), tip());
}

TEST_F(Manners, DrawMissingFilesInGreyAndLongNamesWithAnEllipsis)
{
    const std::string longName = std::string(120, 'n') + ".lsp";
    openHistory({"a.lsp", "gone.lsp", longName});
    std::filesystem::remove(mFolder / "gone.lsp");
    const auto cellOf = [this](NSInteger row)
    {
        NSTableColumn* column = [[historyTable() tableColumns] objectAtIndex:0];
        NSCell* cell = [column dataCellForRow:row];
        [cell setStringValue:[[historyTable() dataSource] tableView:historyTable()
                                          objectValueForTableColumn:column
                                                                row:row]];
        return (NSTextFieldCell*)cell;
    };
    EXPECT_EQ([NSColor controlTextColor], [(ModrigTableView*)historyTable() textColorOfRow:0]);
    EXPECT_EQ(L"a.lsp", wide([cellOf(0) stringValue]));
    EXPECT_EQ([NSColor disabledControlTextColor], [(ModrigTableView*)historyTable() textColorOfRow:1]);
    const std::wstring shown = wide([(ModrigNameCell*)cellOf(2) textIn:170]);
    EXPECT_EQ(L'…', shown.back());
    EXPECT_LT(shown.size(), 40u);
}

TEST_F(Manners, FillTheWidthOfTheTableAtEverySize)
{
    openHistory({"a.lsp"});
    const auto widthOfColumns = [this]
    {
        const NSRect last = [historyTable() rectOfColumn:1];
        return NSMaxX(last);
    };
    NSRect frame = [mPanel frame];
    for (const CGFloat more : {150, -100})
    {
        frame.size.width += more;
        [mPanel setFrame:frame display:YES];
        events::pump();
        EXPECT_NEAR(NSWidth([[historyTable() enclosingScrollView] documentVisibleRect]), widthOfColumns(), 6);
    }
}

TEST_F(Manners, AreRememberedForTheWindowAndItsColumns)
{
    openHistory({"a.lsp"});
    NSRect frame = [mPanel frame];
    frame.origin.x += 37;
    frame.size.width += 60;
    [mPanel setFrame:frame display:YES];
    [[[historyTable() tableColumns] objectAtIndex:0] setWidth:231];
    close();
    open();
    EXPECT_TRUE(NSEqualRects(frame, [mPanel frame])) << [NSStringFromRect([mPanel frame]) UTF8String];
    EXPECT_EQ(231, [[[historyTable() tableColumns] objectAtIndex:0] width]);
}

TEST_F(Manners, ShowTheTipOfARowWhenThePointerRestsOnIt)
{
    openHistory({"a.lsp", "b.lsp"});
    const std::size_t before = events::windowsOnTheScreen();
    events::movePointerTo(historyTable(), events::middleOf([historyTable() rectOfRow:1]));
    EXPECT_TRUE(events::comesTrue([&] { return events::windowsOnTheScreen() > before; }));
    events::movePointerTo([mPanel contentView], NSMakePoint(1, 1));
}

TEST_F(Manners, TellWhyNothingCanBeUnloadedInTheTipOfTheButton)
{
    openLoaded({"tool.lsp"});
    NSButton* unload = buttonOf(@selector(onUnload:));
    ASSERT_FALSE([unload isEnabled]);
    const auto tip = [&] { return wide([[unload target] tipOfButton:unload]); };
    EXPECT_EQ(L"None of these applications can be unloaded.\nLisp applications cannot be unloaded.", tip());
    load({"one.zmb"});
    ASSERT_TRUE([unload isEnabled]);
    EXPECT_EQ(L"Unload the selected applications", tip());
}

TEST_F(Manners, ShowTheTipOfTheDisabledUnloadButtonWhenThePointerRestsOnIt)
{
    openLoaded({"tool.lsp"});
    NSButton* unload = buttonOf(@selector(onUnload:));
    const std::size_t before = events::windowsOnTheScreen();
    events::movePointerTo(unload, events::middleOf([unload bounds]));
    EXPECT_TRUE(events::comesTrue([&] { return events::windowsOnTheScreen() > before; }));
    events::movePointerTo([mPanel contentView], NSMakePoint(1, 1));
}

TEST_F(Manners, EndTheTitleOfANarrowColumnInAnEllipsis)
{
    openHistory({"a.lsp"});
    NSTableColumn* column = [[historyTable() tableColumns] objectAtIndex:0];
    const auto lookOf = [&](NSString* title)
    {
        [[column headerCell] setStringValue:title];
        [[historyTable() headerView] setNeedsDisplay:YES];
        [mPanel displayIfNeeded];
        return pictureOf([historyTable() headerView], [[historyTable() headerView] headerRectOfColumn:0]);
    };
    NSString* title = @"Files that were loaded before, in the order of loading";
    const CGFloat room = [column width] - 8;
    NSString* shown = tessel::windowing::fitted(title, [[column headerCell] font], room);
    EXPECT_EQ(L'…', wide(shown).back());
    EXPECT_GT([shown length], 10u);
    EXPECT_TRUE([lookOf(title) isEqual:lookOf(shown)]);
    EXPECT_EQ(L"File", wide(tessel::windowing::fitted(@"File", [[column headerCell] font], room)));
}
