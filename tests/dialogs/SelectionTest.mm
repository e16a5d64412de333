// What is selected, by the user or by itself, and what the buttons make of it.
#include "tests/dialogs/support/DialogTest.h"

#include <algorithm>

#include "modrig/messages/MessageIds.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class Selection : public OpenDialogTest
{
protected:
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
    id panelWith(std::initializer_list<std::string> names) { return panelWithSelected(paths(names)); }
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
    runDialog({[this] { clickRow(loadedTable(), rowOf("tool.lsp")); }, [] {},
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
               }});
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
    runDialog({[this]
               {
                   [mController setSaveHistory:YES];
                   [mController setTabViewSelectedIndex:kHistoryTab];
                   load({"a.lsp", "b.lsp"});
               },
               [this] { clickRow(historyTable(), 1); }, [] {},
               [this]
               {
                   EXPECT_THAT(selectedFiles(), ElementsAre(file("b.lsp")));
                   [mController onLoad:nil];
                   EXPECT_EQ(Message(ModrigMessages::kOneLoaded, L"b.lsp"), message());
               }});
}

TEST_F(Selection, InThePanelCountsAgainAfterFilesHaveJoinedTheHistory)
{
    open();
    [mController setSaveHistory:YES];
    load({"a.lsp", "b.lsp"});
    [mController panelSelectionDidChange:panelWithSelected(paths({"a.lsp"}))];
    EXPECT_THAT(selectedFiles(), ElementsAre(file("a.lsp")));
}

TEST_F(Selection, OfTheHistoryRowThatADropMadeReplacesThatOfThePanel)
{
    open();
    [mController setSaveHistory:YES];
    load({"a.lsp"});
    [mController panelSelectionDidChange:panelWithSelected(paths({"a.lsp"}))];
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
    [mController panelSelectionDidChange:panelWithSelected(paths({"a.lsp"}))];
    select(historyTable(), {0});
    EXPECT_THAT(selectedFiles(), ElementsAre(file("old.lsp")));
    [mController panelSelectionDidChange:panelWithSelected(paths({"a.lsp"}))];
    EXPECT_THAT(selectedFiles(), ElementsAre(file("a.lsp")));
    [mController panelSelectionDidChange:panelWithSelected(paths({}))];
    EXPECT_THAT(selectedFiles(), IsEmpty());
}

TEST_F(Selection, OfTheHistoryOutlivesAnotherFileType)
{
    gHistoryList.AddTail(file("old.zmb"));
    open();
    select(historyTable(), {0});
    chooseFileType(kLispFileType);
    EXPECT_THAT(selectedFiles(), ElementsAre(file("old.zmb")));
    [mController onLoad:nil];
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneLoaded, L"old.zmb")));
}

TEST_F(Selection, OfTheHistoryIsLoadedWhenThePanelLeavesNothingChosen)
{
    gHistoryList.AddTail(file("old.zmb"));
    open();
    select(historyTable(), {0});
    [mController panelSelectionDidChange:panelWithSelected(paths({}))];
    [mController onLoad:nil];
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneLoaded, L"old.zmb")));
}

TEST_F(Selection, OfTheHistoryIsLoadedWhenThePanelHasAFolderChosen)
{
    gHistoryList.AddTail(file("old.zmb"));
    mFolder.write("folder/inside.txt", "");
    open();
    select(historyTable(), {0});
    [mController panelSelectionDidChange:panelWith({"folder"})];
    [mController onLoad:nil];
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneLoaded, L"old.zmb")));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(Selection, OfTheHistoryTakesInWhatIsAFolderNow)
{
    mFolder.write("old.zmb/inside.txt", "");
    gHistoryList.AddTail(CStdStr((mFolder / "old.zmb").wstring()));
    open();
    select(historyTable(), {0});
    [mController onLoad:nil];
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneLoaded, L"old.zmb")));
}

TEST_F(Selection, OfNothingIsAnsweredInTheMessageLine)
{
    open();
    [mController onLoad:nil];
    EXPECT_EQ(L"Select a file in the list above or in the History first.", message());
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(Selection, OfNewRowsIsOnAgainWhenTheTablesAreFilled)
{
    open();
    EXPECT_TRUE([loadedApps() selectsInsertedObjects]);
    EXPECT_TRUE([historyList() selectsInsertedObjects]);
}

TEST_F(Selection, IsMadeByNobodyButThePersonWhenTheDialogOpens)
{
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    gHistoryList.AddTail(CStdStr(file("old.zmb")));
    open();
    for (NSArrayController* rows : {loadedApps(), historyList(), fileTypes()})
        EXPECT_FALSE([rows avoidsEmptySelection]);
    EXPECT_THAT(selectionOf(loadedApps()), IsEmpty());
    EXPECT_THAT(selectionOf(historyList()), IsEmpty());
    EXPECT_THAT(selectedFiles(), IsEmpty());
    EXPECT_FALSE([mController canUnloadApp]);
    EXPECT_FALSE([mController canRemoveHistory]);
}
