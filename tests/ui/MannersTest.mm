// What a person expects of the dialog's tables without being told: real clicks and keys in its window.
#include "tests/ui/support/DialogTest.h"
#include "tests/ui/support/Events.h"

#import "ui/ModrigFilePath.h"
#import "ui/TsOCModrigUtil.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
constexpr int kHistoryTab = 1;

class Manners : public OpenDialogTest
{
protected:
    void openHistory(std::initializer_list<std::string> names)
    {
        for (const std::string& name : names)
            gHistoryList.AddTail(CStdStr(file(name)));
        open();
        [mController setTabViewSelectedIndex:kHistoryTab];
        show();
    }
    void openLoaded(std::initializer_list<std::string> names)
    {
        for (const std::string& name : names)
            gLoadedAppList.AddTail(name.ends_with(".zmb") ? loadedModule(name) : file(name));
        open();
        show();
    }
    // As it shows on the screen while it runs.
    void show()
    {
        [mPanel makeKeyAndOrderFront:nil];
        events::pump();
    }
    std::wstring message() { return wide([mController message]); }
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
    selectFiles({"one.zmb"});
    [mController onLoad:nil];
    ASSERT_EQ(Message(8, L"one.zmb"), message());
    host().linker.refuseToLoad(file("bad.zmb"));
    selectFiles({"bad.zmb"});
    [mController onLoad:nil];
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
