// What is selected, by the user or by itself, and what the buttons make of it.
#include "tests/ui/support/DialogTest.h"

#include <algorithm>

#include "module/DialogBridge.h"

#import "ui/ModrigFilePath.h"
#import "ui/TsOCModrigUtil.h"

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

TEST_F(Selection, StaysThatOfThePanelWhenItsFilesJoinTheHistory)
{
    open();
    [mController setSaveHistory:YES];
    load({"a.lsp", "b.lsp"});
    EXPECT_THAT(selectionOf(historyList()), ElementsAre(file("b.lsp")));
    EXPECT_THAT(selectedFiles(), ElementsAre(file("a.lsp"), file("b.lsp")));
    [mController onLoad:nil];
    EXPECT_THAT(lines(), ElementsAre(Message(9, L"2"), Message(9, L"2")));
}

TEST_F(Selection, StaysThatOfThePanelWhenADroppedFileJoinsTheHistory)
{
    open();
    [mController setSaveHistory:YES];
    load({"a.lsp"});
    drop({"dropped.lsp"}, 0);
    EXPECT_THAT(selectedFiles(), ElementsAre(file("a.lsp")));
}

TEST_F(Selection, FollowsTheHistoryWhenItsRowsWereChosen)
{
    gHistoryList.AddTail(file("old.lsp"));
    open();
    [mController setSaveHistory:YES];
    selectFiles({"other.lsp"});
    select(historyTable(), {0});
    drop({"new.lsp"}, 0);
    EXPECT_EQ(selectionOf(historyList()), selectedFiles());
}

TEST_F(Selection, OfNewRowsIsOnAgainWhenTheTablesAreFilled)
{
    open();
    EXPECT_TRUE([loadedApps() selectsInsertedObjects]);
    EXPECT_TRUE([historyList() selectsInsertedObjects]);
}
