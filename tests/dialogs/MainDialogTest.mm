#include "tests/dialogs/support/DialogTest.h"

#include <objc/runtime.h>

#include "modrig/messages/MessageIds.h"
#include "modrig/messages/Messages.h"
#include "modrig/module/DialogBridge.h"

#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/NSSavePanel+ModrigRuntime.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class MainDialog : public OpenDialogTest
{
protected:
    std::wstring settingsKey() const
    {
        return L"Software\\Tessel\\R21\\Profiles\\Default\\DialogSettings\\Modrig";
    }
    std::optional<std::wstring> setting(const wchar_t* name)
    {
        return host().registry.value(settingsKey(), name);
    }
    static NSString* shownIn(NSTableView* table, NSUInteger column, NSInteger row)
    {
        return [[table dataSource] tableView:table
                   objectValueForTableColumn:[[table tableColumns] objectAtIndex:column]
                                         row:row];
    }
};
} // namespace

TEST_F(MainDialog, ShowsLoadedApplicationsAndThoseOfTheStartupSuiteThatAreLoaded)
{
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    gLoadedAppList.AddTail(file("gone.zmb"));
    gStartupList.AddTail(loadedModule("two.zmb"));
    gStartupList.AddTail(file("one.zmb"));
    gStartupList.AddTail(file("missing.zmb"));
    gStartupList.AddTail(file("tool.lsp"));
    open();
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("one.zmb"), file("two.zmb"), file("tool.lsp")));
    EXPECT_EQ(3, [loadedTable() numberOfRows]);
}

TEST_F(MainDialog, ShowsTheWholeHistory)
{
    fill(gHistoryList, {"one.zmb", "two.lsp"});
    open();
    EXPECT_THAT(rowsOf(historyList()), ElementsAre(file("one.zmb"), file("two.lsp")));
    EXPECT_EQ(2, [historyTable() numberOfRows]);
}

TEST_F(MainDialog, OpensWithNothingSelected)
{
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    fill(gHistoryList, {"one.zmb"});
    open();
    EXPECT_THAT(selectionOf(loadedApps()), IsEmpty());
    EXPECT_THAT(selectionOf(historyList()), IsEmpty());
    EXPECT_FALSE([mController canUnloadApp]);
    EXPECT_FALSE([mController canRemoveHistory]);
}

TEST_F(MainDialog, ShowsFileAndFolderInTheColumns)
{
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    open();
    NSArray* columns = [loadedTable() tableColumns];
    ASSERT_EQ(2u, [columns count]);
    EXPECT_EQ(L"File", wide([[[columns objectAtIndex:0] headerCell] stringValue]));
    EXPECT_EQ(L"Folder", wide([[[columns objectAtIndex:1] headerCell] stringValue]));
    EXPECT_EQ(L"one.zmb", wide(shownIn(loadedTable(), 0, 0)));
    EXPECT_EQ(mFolder.path().wstring(), wide(shownIn(loadedTable(), 1, 0)));
}

TEST_F(MainDialog, IsTheCurrentControllerWhileItIsOpen)
{
    open();
    EXPECT_EQ(mController, [TsOCModrigUtil getModrigController]);
    close();
    EXPECT_EQ(nil, [TsOCModrigUtil getModrigController]);
}

TEST_F(MainDialog, LetsGoOfItsPanelWhenItCloses)
{
    open();
    ModrigController* controller = [[mController retain] autorelease];
    EXPECT_EQ(mPanel, [controller valueForKey:@"mOpenPanel"]);
    close();
    EXPECT_EQ(nil, [controller valueForKey:@"mOpenPanel"]);
}

TEST_F(MainDialog, TakesMessagesIntoItsMessageLineOnlyWhileItIsOpen)
{
    ModrigUtils::ModrigCmdlineMessage(CStdStr(L"before"));
    open();
    EXPECT_EQ(L"", message());
    ModrigUtils::ModrigCmdlineMessage(CStdStr(L"now"));
    EXPECT_EQ(L"now", message());
    ModrigUtils::ModrigCmdlineMessage(ModrigMessages::kManyLoaded, 0u);
    EXPECT_EQ(L"now", message());
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(MainDialog, LoadsTheSelectedFilesAndShowsThem)
{
    open();
    load({"one.zmb", "two.zmb"});
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("one.zmb"), file("two.zmb")));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyLoaded, L"2")));
    EXPECT_EQ(Message(ModrigMessages::kManyLoaded, L"2"), message());
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(file("one.zmb"), file("two.zmb")));
}

TEST_F(MainDialog, LeavesTheHistoryAloneUnlessItIsToBeSaved)
{
    open();
    [mController setSaveHistory:NO];
    load({"one.zmb", "two.zmb"});
    EXPECT_TRUE(gHistoryList.IsEmpty());
    EXPECT_THAT(rowsOf(historyList()), IsEmpty());
}

TEST_F(MainDialog, AddsLoadedFilesToTheHistoryListAndItsTable)
{
    fill(gHistoryList, {"one.zmb"});
    open();
    [mController setSaveHistory:YES];
    load({"one.zmb", "two.zmb"});
    EXPECT_THAT(Texts(gHistoryList), ElementsAre(file("one.zmb"), file("two.zmb")));
    EXPECT_THAT(rowsOf(historyList()), ElementsAre(file("one.zmb"), file("two.zmb")));
}

TEST_F(MainDialog, StopsAtTheSecondOfThreeFilesWithoutASummary)
{
    open();
    host().linker.refuseToLoad(file("two.zmb"));
    load({"one.zmb", "two.zmb", "three.zmb"});
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("one.zmb")));
    EXPECT_FALSE(host().linker.isLoaded(file("three.zmb")));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kLoadFailed, file("two.zmb"))));
    EXPECT_EQ(L"", message());
}

TEST_F(MainDialog, ShowsApplicationsThatCannotBeLoadedAndSaysSoWhenOneIsChosen)
{
    for (const char* name : {"plates.mcp", "survey.rpk"})
    {
        const std::wstring chosen = file(name);
        open();
        EXPECT_TRUE([mController panel:mPanel shouldShowFilename:path(name)]) << name;
        load({name});
        EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, chosen),
                                         Message(ModrigMessages::kLoadFailed, chosen)));
        close();
        host().output.boxes.clear();
    }
}

TEST_F(MainDialog, SaysThatAFileIsLoadedAlreadyAndAddsNoRow)
{
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    open();
    load({"one.zmb"});
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kAlreadyLoaded, L"one.zmb")));
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("one.zmb")));
}

TEST_F(MainDialog, GivesALispFileThatIsLoadedAgainNoSecondRow)
{
    gLoadedAppList.AddTail(file("tool.lsp"));
    open();
    load({"tool.lsp"});
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneLoaded, L"tool.lsp")));
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("tool.lsp")));
}

TEST_F(MainDialog, DoesNothingButRememberTheFolderWithoutSelectedFiles)
{
    open();
    [mController onLoad:nil];
    EXPECT_THAT(lines(), IsEmpty());
    EXPECT_TRUE(setting(L"InitialPath"));
}

TEST_F(MainDialog, RemembersTheFolderOfThePanelWhenItLoads)
{
    host().registry.setValue(settingsKey(), L"InitialPath", mFolder.path().wstring());
    open();
    host().registry.removeValue(settingsKey(), L"InitialPath");
    load({"one.zmb"});
    EXPECT_EQ(mFolder.path().wstring(), setting(L"InitialPath"));
}

TEST_F(MainDialog, OnlyMovesIntoTheHostsFolderWhenThatIsAllThatIsSelected)
{
    host().registry.setValue(settingsKey(), L"InitialPath", mFolder.path().wstring());
    open();
    host().registry.removeValue(settingsKey(), L"InitialPath");
    NSString* hostFolder = [[NSBundle mainBundle] bundlePath];
    [[mController selectedFiles]
        addObject:[[[ModrigFilePath alloc] initWithFilePathName:hostFolder] autorelease]];
    [mController onLoad:nil];
    EXPECT_EQ(wide(hostFolder), wide([mPanel directory]));
    EXPECT_FALSE(setting(L"InitialPath"));
    EXPECT_THAT(lines(), IsEmpty());
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(MainDialog, PassesOverTheHostsFolderAmongOtherFiles)
{
    host().registry.setValue(settingsKey(), L"InitialPath", mFolder.path().wstring());
    open();
    selectFiles({"one.zmb"});
    NSString* hostFolder = [[NSBundle mainBundle] bundlePath];
    [[mController selectedFiles]
        insertObject:[[[ModrigFilePath alloc] initWithFilePathName:hostFolder] autorelease]
             atIndex:0];
    EXPECT_FALSE([mController openTesselFolder]);
    [mController onLoad:nil];
    EXPECT_EQ(mFolder.path().wstring(), wide([mPanel directory]));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneLoaded, L"one.zmb")));
}

TEST_F(MainDialog, LoadsEveryFileThoughLoadingChangesWhatIsChosen)
{
    open();
    [mController setSaveHistory:YES];
    load({"one.zmb", "two.zmb", "three.zmb"});
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("one.zmb"), file("two.zmb"), file("three.zmb")));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyLoaded, L"3")));
}

TEST_F(MainDialog, LoadsLispFilesAlone)
{
    open();
    load({"one.lsp"});
    EXPECT_EQ(L"(load \"" + file("one.lsp") + L"\")", host().lisp.queued[0]);
}

TEST_F(MainDialog, LoadsAllOfALispFileThatJoinsTheStartupSuite)
{
    fill(gHistoryList, {"one.lsp"});
    open();
    select(historyTable(), {0});
    [mController onLoadFromHistory:nil];
    [mController onAddToStartupSuiteFromHistory:nil];
    ASSERT_EQ(6u, host().lisp.queued.size());
    EXPECT_EQ(L"(load \"" + file("one.lsp") + L"\")", host().lisp.queued[0]);
    EXPECT_EQ(L"(progn (_INTERNAL-LOAD-ALL-FILE \"" + file("one.lsp") + L"\" nil T T nil)(princ))",
              host().lisp.queued[3]);
}

TEST_F(MainDialog, DoesNotRememberTheFolderWhenItLoadsFromTheHistory)
{
    fill(gHistoryList, {"one.zmb"});
    open();
    select(historyTable(), {0});
    [mController onLoadFromHistory:nil];
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneLoaded, L"one.zmb")));
    EXPECT_FALSE(setting(L"InitialPath"));
}

TEST_F(MainDialog, RemembersTheFolderAfterABatchThatEndedEarly)
{
    host().registry.setValue(settingsKey(), L"InitialPath", mFolder.path().wstring());
    open();
    host().registry.removeValue(settingsKey(), L"InitialPath");
    host().linker.refuseToLoad(file("bad.zmb"));
    load({"bad.zmb", "one.zmb"});
    EXPECT_FALSE(host().linker.isLoaded(file("one.zmb")));
    EXPECT_EQ(mFolder.path().wstring(), setting(L"InitialPath"));
}

TEST_F(MainDialog, LoadsSelectedHistoryRowsWithTheLoadButton)
{
    fill(gHistoryList, {"one.zmb", "two.zmb", "three.zmb"});
    open();
    selectFiles({"other.zmb"});
    select(historyTable(), {0, 2});
    EXPECT_TRUE([mController canRemoveHistory]);
    [mController onLoad:nil];
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("one.zmb"), file("three.zmb")));
}

TEST_F(MainDialog, LoadsNothingFromTheHistoryWithoutASelection)
{
    fill(gHistoryList, {"one.zmb"});
    open();
    [mController onLoadFromHistory:nil];
    EXPECT_THAT(rowsOf(loadedApps()), IsEmpty());
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(MainDialog, LoadsHistoryRowsByTheirOwnButtonAndByDoubleClick)
{
    fill(gHistoryList, {"one.zmb", "two.zmb"});
    open();
    select(historyTable(), {1});
    [mController onLoadFromHistory:nil];
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("two.zmb")));
    select(historyTable(), {0});
    EXPECT_TRUE(sel_isEqual(@selector(onDoubleClickHistoryTableView:), [historyTable() doubleAction]));
    [mController onDoubleClickHistoryTableView:historyTable()];
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("two.zmb"), file("one.zmb")));
}

TEST_F(MainDialog, TakesADoubleClickFromTheHistoryTableOnly)
{
    fill(gHistoryList, {"one.zmb"});
    open();
    select(historyTable(), {0});
    [mController onDoubleClickHistoryTableView:loadedTable()];
    EXPECT_THAT(rowsOf(loadedApps()), IsEmpty());
}

TEST_F(MainDialog, AddsHistoryRowsToTheStartupSuiteAsIfTheyWereDropped)
{
    fill(gHistoryList, {"one.zmb", "two.zmb", "three.zmb"});
    open();
    select(historyTable(), {0, 2});
    [mController onAddToStartupSuiteFromHistory:nil];
    EXPECT_THAT(Texts(gStartupList), ElementsAre(file("one.zmb"), file("three.zmb")));
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("one.zmb"), file("three.zmb")));
    EXPECT_EQ(Message(ModrigMessages::kManyAddedToStartupSuite, L"2"), message());
}

TEST_F(MainDialog, NamesTheOnlyRowRemovedFromTheHistory)
{
    fill(gHistoryList, {"one.zmb", "two.zmb"});
    open();
    select(historyTable(), {0});
    [mController onRemove:nil];
    EXPECT_THAT(rowsOf(historyList()), ElementsAre(file("two.zmb")));
    EXPECT_THAT(Texts(gHistoryList), ElementsAre(file("two.zmb")));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneRemovedFromHistory, L"one.zmb")));
    EXPECT_FALSE([mController canRemoveHistory]);
}

TEST_F(MainDialog, CountsThreeRowsRemovedFromTheHistory)
{
    fill(gHistoryList, {"one.zmb", "two.zmb", "three.zmb", "four.zmb"});
    open();
    select(historyTable(), {0, 1, 3});
    [mController onRemove:nil];
    EXPECT_THAT(rowsOf(historyList()), ElementsAre(file("three.zmb")));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyRemovedFromHistory, L"3")));
}

TEST_F(MainDialog, RemovesNothingWithoutASelection)
{
    fill(gHistoryList, {"one.zmb"});
    open();
    [mController onRemove:nil];
    [mController onUnload:nil];
    EXPECT_THAT(rowsOf(historyList()), ElementsAre(file("one.zmb")));
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(MainDialog, UnloadsTheSelectedRowAndNamesIt)
{
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    gLoadedAppList.AddTail(loadedModule("two.zmb"));
    open();
    select(loadedTable(), {1});
    EXPECT_TRUE([mController canUnloadApp]);
    [mController onUnload:nil];
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("one.zmb")));
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(file("one.zmb")));
    EXPECT_FALSE(host().linker.isLoaded(file("two.zmb")));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneUnloaded, L"two.zmb")));
    EXPECT_FALSE([mController canUnloadApp]);
}

TEST_F(MainDialog, CountsTwoUnloadedRows)
{
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    gLoadedAppList.AddTail(loadedModule("two.zmb"));
    open();
    select(loadedTable(), {0, 1});
    [mController onUnload:nil];
    EXPECT_THAT(rowsOf(loadedApps()), IsEmpty());
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyUnloaded, L"2")));
}

TEST_F(MainDialog, TakesOutEachRowBeforeItUnloadsTheNext)
{
    for (const char* name : {"one.zmb", "two.zmb"})
        gLoadedAppList.AddTail(loadedModule(name));
    open();
    std::vector<std::wstring> rows;
    std::vector<std::wstring> entries;
    host().linker.setEntryPoint(file("two.zmb"),
                                [&](unsigned, void*)
                                {
                                    rows = rowsOf(loadedApps());
                                    entries = Texts(gLoadedAppList);
                                    return TSRX_RET_OK;
                                });
    select(loadedTable(), {0, 1});
    [mController onUnload:nil];
    EXPECT_THAT(rows, ElementsAre(file("two.zmb")));
    EXPECT_THAT(entries, ElementsAre(file("two.zmb")));
}

TEST_F(MainDialog, PassesOverARowThatCouldNotBeUnloadedWhenItWasMade)
{
    host().linker.setLocked(file("locked.zmb"));
    gLoadedAppList.AddTail(loadedModule("locked.zmb"));
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    open();
    host().linker.setLocked(file("locked.zmb"), false);
    [loadedTable() setDelegate:nil]; // which would take the row out of the selection
    [loadedApps() setSelectionIndexes:[NSIndexSet indexSetWithIndexesInRange:NSMakeRange(0, 2)]];
    [mController onUnload:nil];
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("locked.zmb")));
    EXPECT_TRUE(host().linker.isLoaded(file("locked.zmb")));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneUnloaded, L"one.zmb")));
}

TEST_F(MainDialog, NamesTheLastRowTriedWhenOneOfTwoWasUnloaded)
{
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    gLoadedAppList.AddTail(loadedModule("two.zmb"));
    open();
    host().linker.setLocked(file("two.zmb"));
    select(loadedTable(), {0, 1});
    [mController onUnload:nil];
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("two.zmb")));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kModuleLocked, L"two.zmb"),
                                     Message(ModrigMessages::kOneUnloaded, L"two.zmb")));
}

TEST_F(MainDialog, KeepsRowsThatCannotBeUnloadedFromBeingSelected)
{
    gLoadedAppList.AddTail(file("tool.lsp"));
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    fill(gHistoryList, {"tool.lsp"});
    open();
    EXPECT_FALSE([mController tableView:loadedTable() shouldSelectRow:0]);
    EXPECT_TRUE([mController tableView:loadedTable() shouldSelectRow:1]);
    EXPECT_FALSE([mController tableView:loadedTable() shouldSelectRow:2]);
    EXPECT_FALSE([mController tableView:loadedTable() shouldSelectRow:-1]);
    EXPECT_TRUE([mController tableView:historyTable() shouldSelectRow:0]);
    EXPECT_FALSE([mController canUnloadApp]);
}

TEST_F(MainDialog, EnablesButtonsWithTheSelection)
{
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    fill(gHistoryList, {"one.zmb"});
    open();
    select(loadedTable(), {0});
    EXPECT_TRUE([mController canUnloadApp]);
    EXPECT_FALSE([mController canRemoveHistory]);
    [loadedTable() deselectAll:nil];
    EXPECT_FALSE([mController canUnloadApp]);
}

TEST_F(MainDialog, IgnoresTheSelectionOfAnyOtherTable)
{
    open();
    selectFiles({"one.zmb"});
    NSTableView* other = [[[NSTableView alloc] init] autorelease];
    [mController tableViewSelectionDidChange:[NSNotification notificationWithName:@"selection" object:other]];
    EXPECT_EQ(1u, [[mController selectedFiles] count]);
}

TEST_F(MainDialog, EmptiesTheSelectedFilesWithTheHistorySelection)
{
    fill(gHistoryList, {"one.zmb"});
    open();
    select(historyTable(), {0});
    EXPECT_EQ(1u, [[mController selectedFiles] count]);
    [historyTable() deselectAll:nil];
    EXPECT_EQ(0u, [[mController selectedFiles] count]);
}

TEST_F(MainDialog, RemembersCheckBoxAndTab)
{
    open();
    EXPECT_FALSE([mController saveHistory]);
    EXPECT_EQ(kLoadedApplicationsTab, [mController tabViewSelectedIndex]);
    [mController setSaveHistory:YES];
    [mController setTabViewSelectedIndex:kHistoryTab];
    close();
    EXPECT_EQ(L"1", setting(L"SaveHistory"));
    EXPECT_EQ(L"1", setting(L"LastTab"));
    open();
    EXPECT_TRUE([mController saveHistory]);
    EXPECT_EQ(kHistoryTab, [mController tabViewSelectedIndex]);
}

TEST_F(MainDialog, ScrollsTheShownTableToTheNewRow)
{
    fillWithMany(gLoadedAppList);
    open();
    load({"last.zmb"});
    EXPECT_TRUE(NSContainsRect([loadedTable() visibleRect], [loadedTable() rectOfRow:kMany]));
}

TEST_F(MainDialog, ScrollsTheHistoryWhenThatShows)
{
    fillWithMany(gHistoryList);
    open();
    [mController setTabViewSelectedIndex:kHistoryTab];
    [mController setSaveHistory:YES];
    load({"last.zmb"});
    EXPECT_TRUE(NSContainsRect([historyTable() visibleRect], [historyTable() rectOfRow:kMany]));
}

TEST_F(MainDialog, ScrollsNowhereWhenAnotherTabShows)
{
    for (CStringList* list : {&gLoadedAppList, &gHistoryList})
        fillWithMany(*list);
    open();
    // No view is bound any more that would object to a tab that is not there.
    [mController setSaveHistory:YES];
    [mController setValue:[NSNumber numberWithInt:2] forKey:@"tabViewSelectedIndex"];
    load({"last.zmb"});
    EXPECT_EQ(kMany + 1u, rowsOf(loadedApps()).size());
    for (NSTableView* table : {loadedTable(), historyTable()})
        EXPECT_TRUE(NSLocationInRange(0, [table rowsInRect:[table visibleRect]]));
    [mController setTabViewSelectedIndex:kLoadedApplicationsTab];
}

TEST_F(MainDialog, ScrollsNowhereAfterAFailure)
{
    fillWithMany(gLoadedAppList);
    open();
    host().linker.refuseToLoad(file("bad.zmb"));
    load({"one.zmb", "bad.zmb"});
    EXPECT_EQ(kMany + 1u, rowsOf(loadedApps()).size());
    EXPECT_TRUE(NSLocationInRange(0, [loadedTable() rowsInRect:[loadedTable() visibleRect]]));
}

TEST_F(MainDialog, EndsABatchSilentlyWhereLispIsOff)
{
    host().variables.set(L"LISPENABLED", RecordingValue::Short(0));
    open();
    load({"one.zmb", "tool.lsp", "two.zmb"});
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("one.zmb")));
    EXPECT_FALSE(host().linker.isLoaded(file("two.zmb")));
    EXPECT_THAT(boxes(), IsEmpty());
    EXPECT_THAT(lines(), IsEmpty());
    EXPECT_EQ(L"", message());
}

TEST_F(MainDialog, AddsNothingToTheStartupSuiteWithoutASelection)
{
    fill(gHistoryList, {"one.zmb"});
    open();
    [mController onAddToStartupSuiteFromHistory:nil];
    EXPECT_TRUE(gStartupList.IsEmpty());
    EXPECT_THAT(rowsOf(loadedApps()), IsEmpty());
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(MainDialog, TurnsDropsOffWhenItCloses)
{
    open();
    NSTableView* table = [[loadedTable() retain] autorelease];
    EXPECT_EQ(mController, [table dataSource]);
    EXPECT_THAT(wide([[table registeredDraggedTypes] lastObject]), wide(NSFilenamesPboardType));
    close();
    EXPECT_EQ(nil, [table dataSource]);
    EXPECT_EQ(0u, [[table registeredDraggedTypes] count]);
}

TEST_F(MainDialog, OpensItsHelpPage)
{
    open();
    [mController onHelp:nil];
    ASSERT_EQ(1u, host().output.helpCalls.size());
    EXPECT_EQ(L"load_unload_applications_dialog", host().output.helpCalls[0].topic);
}

TEST_F(MainDialog, StoresTheListsWhenARunEnds)
{
    host().loadedModules.applicationName = L"/host/PlugIns/Modrig.bundle";
    const ModalSteps steps(
        {[this]
         {
             ModrigController* controller = [TsOCModrigUtil getModrigController];
             [controller setSaveHistory:YES];
             NSArray* files = [NSArray
                 arrayWithObject:[[[ModrigFilePath alloc] initWithFilePathName:path("one.zmb")] autorelease]];
             [controller loadApps:files successedApps:nil addToStartupSuit:NO];
             gStartupList.AddTail(file("suite.lsp"));
             EXPECT_FALSE(host().registry.value(host().moduleKey() + L"\\History", L"NumHistory"));
         },
         [] { [[runningPanel() cancelButton] performClick:nil]; }});
    ModrigUtils::RunModrigDialog();
    EXPECT_EQ(L"1", host().registry.value(host().moduleKey() + L"\\History", L"NumHistory"));
    EXPECT_EQ(file("one.zmb"), host().registry.value(host().moduleKey() + L"\\History", L"1History"));
    EXPECT_EQ(file("suite.lsp"), host().registry.value(host().moduleKey() + L"\\Startup", L"1Startup"));
    EXPECT_EQ(nil, [TsOCModrigUtil getModrigController]);
}

TEST_F(MainDialog, RebuildsTheListOfLoadedApplicationsWhenItOpens)
{
    loadedModule("elsewhere.zmb");
    const ModalSteps steps({[this]
                            {
                                NSArrayController* rows =
                                    [[TsOCModrigUtil getModrigController] valueForKey:@"loadedApps"];
                                EXPECT_THAT(rowsOf(rows), ElementsAre(file("elsewhere.zmb")));
                            },
                            [] { [runningPanel() cancel:nil]; }});
    ModrigUtils::RunModrigDialog();
}
