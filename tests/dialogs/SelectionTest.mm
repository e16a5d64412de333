// What is selected, by the user or by itself, and what the buttons make of it.
#include "tests/dialogs/support/DialogTest.h"

#include <algorithm>

#include "modrig/messages/MessageIds.h"
#include "modrig/module/DialogBridge.h"

#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

// What a panel answers about its selection.
@interface ChoosingPanel : NSObject
{
    NSArray* mPaths;
}
- (id)initWithPaths:(NSArray*)paths;
@end

@implementation ChoosingPanel

- (id)initWithPaths:(NSArray*)paths
{
    if ((self = [super init]))
        mPaths = [paths copy];
    return self;
}

- (void)dealloc
{
    [mPaths release];
    [super dealloc];
}

- (NSArray*)URLs
{
    NSMutableArray* urls = [NSMutableArray array];
    for (NSUInteger index = 0; index < [mPaths count]; ++index)
        [urls addObject:[NSURL fileURLWithPath:[mPaths objectAtIndex:index]]];
    return urls;
}

@end

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class Selection : public OpenDialogTest
{
protected:
    void load(std::initializer_list<std::string> names)
    {
        selectFiles(names);
        [mController onLoad:nil];
    }
    void drop(std::initializer_list<std::string> names, NSInteger row)
    {
        [mController loadedAppsTableViewDropFiles:paths(names) atRow:row];
    }
    NSInteger rowOf(const std::string& name)
    {
        const auto rows = rowsOf(loadedApps());
        return std::ranges::find(rows, file(name)) - rows.begin();
    }
    // A panel that has the files selected.
    id panelWith(std::initializer_list<std::string> names)
    {
        return [[[ChoosingPanel alloc] initWithPaths:paths(names)] autorelease];
    }
    void chooseLisp()
    {
        NSArrayController* types = [mController valueForKey:@"fileTypes"];
        [types setSelectionIndex:3];
        [mController onFileTypesChanged:types];
    }
    std::vector<std::wstring> selectedFiles()
    {
        std::vector<std::wstring> files;
        for (NSUInteger index = 0; index < [[mController selectedFiles] count]; ++index)
            files.push_back(wide([[[mController selectedFiles] objectAtIndex:index] filePathName]));
        return files;
    }
};
} // namespace

TEST_F(Selection, LeavesOutANewRowThatCannotBeUnloaded)
{
    open();
    load({"tool.lsp"});
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("tool.lsp")));
    EXPECT_THAT(selectionOf(loadedApps()), IsEmpty());
    EXPECT_EQ(0, [loadedTable() numberOfSelectedRows]);
    EXPECT_FALSE([mController canUnloadApp]);
}

TEST_F(Selection, TakesInANewRowThatCanBeUnloaded)
{
    open();
    load({"tool.lsp", "one.zmb"});
    EXPECT_THAT(selectionOf(loadedApps()), ElementsAre(file("one.zmb")));
    EXPECT_EQ(1, [loadedTable() selectedRow]);
    EXPECT_TRUE([mController canUnloadApp]);
}

TEST_F(Selection, LeavesOutANewRowInThePlaceOfTheSelectedOne)
{
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    open();
    select(loadedTable(), {0});
    drop({"tool.lsp"}, 0);
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("tool.lsp"), file("one.zmb")));
    EXPECT_THAT(selectionOf(loadedApps()), IsEmpty());
    EXPECT_EQ(0, [loadedTable() numberOfSelectedRows]);
    EXPECT_FALSE([mController canUnloadApp]);
}

TEST_F(Selection, OfSeveralRowsIsThatOfThoseThatCanBeUnloaded)
{
    for (const char* name : {"a.zmb", "b.zmb"})
        gLoadedAppList.AddTail(loadedModule(name));
    gLoadedAppList.AddTail(file("tool.lsp"));
    open();
    select(loadedTable(), {0, 1, 2});
    EXPECT_THAT(selectionOf(loadedApps()), ElementsAre(file("a.zmb"), file("b.zmb")));
    EXPECT_EQ(2, [loadedTable() numberOfSelectedRows]);
    EXPECT_TRUE([mController canUnloadApp]);
}

TEST_F(Selection, IsNotMadeByAClickOnARowThatCannotBeUnloaded)
{
    gLoadedAppList.AddTail(file("tool.lsp"));
    loadedModule("one.zmb");
    const ModalSteps steps({[this]
                            {
                                mController = [TsOCModrigUtil getModrigController];
                                mPanel = runningPanel();
                                clickRow(loadedTable(), rowOf("tool.lsp"));
                            },
                            [] {},
                            [this]
                            {
                                EXPECT_THAT(selectionOf(loadedApps()), IsEmpty());
                                EXPECT_EQ(0, [loadedTable() numberOfSelectedRows]);
                                EXPECT_FALSE([mController canUnloadApp]);
                                clickRow(loadedTable(), rowOf("one.zmb"));
                            },
                            [] {},
                            [this]
                            {
                                EXPECT_THAT(selectionOf(loadedApps()), ElementsAre(file("one.zmb")));
                                EXPECT_TRUE([mController canUnloadApp]);
                                [mPanel cancel:nil];
                            }});
    ModrigUtils::RunModrigDialog();
    mController = nil;
}

TEST_F(Selection, OfTheNewHistoryRowIsWhatLoadLoadsNext)
{
    open();
    [mController setSaveHistory:YES];
    load({"a.lsp", "b.lsp"});
    EXPECT_THAT(selectionOf(historyList()), ElementsAre(file("b.lsp")));
    EXPECT_EQ(1, [historyTable() selectedRow]);
    EXPECT_TRUE([mController canRemoveHistory]);
    EXPECT_THAT(selectedFiles(), ElementsAre(file("b.lsp")));
    [mController onLoad:nil];
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyLoaded, L"2"),
                                     Message(ModrigMessages::kOneLoaded, L"b.lsp")));
}

TEST_F(Selection, OfTheNewHistoryRowIsTheSameAfterAClickOnIt)
{
    const ModalSteps steps({[this]
                            {
                                mController = [TsOCModrigUtil getModrigController];
                                mPanel = runningPanel();
                                [mController setSaveHistory:YES];
                                [mController setTabViewSelectedIndex:1];
                                load({"a.lsp", "b.lsp"});
                            },
                            [this] { clickRow(historyTable(), 1); }, [] {},
                            [this]
                            {
                                EXPECT_THAT(selectedFiles(), ElementsAre(file("b.lsp")));
                                [mController onLoad:nil];
                                EXPECT_EQ(Message(ModrigMessages::kOneLoaded, L"b.lsp"),
                                          wide([mController message]));
                                [mPanel cancel:nil];
                            }});
    ModrigUtils::RunModrigDialog();
    mController = nil;
}

TEST_F(Selection, InThePanelCountsAgainAfterFilesHaveJoinedTheHistory)
{
    open();
    [mController setSaveHistory:YES];
    load({"a.lsp", "b.lsp"});
    [mController panelSelectionDidChange:panelWith({"a.lsp"})];
    EXPECT_THAT(selectedFiles(), ElementsAre(file("a.lsp")));
}

TEST_F(Selection, OfTheHistoryRowThatADropMadeReplacesThatOfThePanel)
{
    open();
    [mController setSaveHistory:YES];
    load({"a.lsp"});
    [mController panelSelectionDidChange:panelWith({"a.lsp"})];
    drop({"dropped.lsp"}, 0);
    EXPECT_THAT(selectedFiles(), ElementsAre(file("dropped.lsp")));
}

TEST_F(Selection, InThePanelStaysWhenNothingJoinsTheHistory)
{
    open();
    [mController setSaveHistory:NO];
    load({"a.lsp"});
    EXPECT_THAT(selectedFiles(), ElementsAre(file("a.lsp")));
}

TEST_F(Selection, IsTheLastOneMadeInThePanelOrInTheHistory)
{
    gHistoryList.AddTail(file("old.lsp"));
    open();
    [mController panelSelectionDidChange:panelWith({"a.lsp"})];
    select(historyTable(), {0});
    EXPECT_THAT(selectedFiles(), ElementsAre(file("old.lsp")));
    [mController panelSelectionDidChange:panelWith({"a.lsp"})];
    EXPECT_THAT(selectedFiles(), ElementsAre(file("a.lsp")));
    [mController panelSelectionDidChange:panelWith({})];
    EXPECT_THAT(selectedFiles(), IsEmpty());
}

TEST_F(Selection, OfTheHistoryOutlivesAnotherFileType)
{
    gHistoryList.AddTail(file("old.zmb"));
    open();
    select(historyTable(), {0});
    chooseLisp();
    EXPECT_THAT(selectedFiles(), ElementsAre(file("old.zmb")));
    [mController onLoad:nil];
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneLoaded, L"old.zmb")));
}

TEST_F(Selection, OfTheHistoryIsLoadedWhenThePanelLeavesNothingChosen)
{
    gHistoryList.AddTail(file("old.zmb"));
    open();
    select(historyTable(), {0});
    [mController panelSelectionDidChange:panelWith({})];
    [mController onLoad:nil];
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneLoaded, L"old.zmb")));
}

TEST_F(Selection, OfNothingIsAnsweredInTheMessageLine)
{
    open();
    [mController onLoad:nil];
    EXPECT_EQ(L"Select a file in the list above or in the History first.", wide([mController message]));
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(Selection, OfNewRowsIsOnAgainWhenTheTablesAreFilled)
{
    open();
    EXPECT_TRUE([loadedApps() selectsInsertedObjects]);
    EXPECT_TRUE([historyList() selectsInsertedObjects]);
}
