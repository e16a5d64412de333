#include "tests/dialogs/support/DialogTest.h"
#include "tests/dialogs/support/Events.h"
#include "tests/dialogs/support/Pictures.h"

#import "modrig/dialogs/ModrigStartupSuitController.h"
#import "modrig/dialogs/ModrigStartupSuiteBox.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

#include "modrig/messages/MessageIds.h"

using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;

namespace
{
class Dropping : public OpenDialogTest
{
protected:
    NSDragOperation hover(NSTableView* table, NSArray* files, NSTableViewDropOperation operation)
    {
        return [mController tableView:table
                         validateDrop:dragOf(files)
                          proposedRow:0
                proposedDropOperation:operation];
    }
    NSDragOperation hover(NSArray* files, NSTableViewDropOperation operation)
    {
        return hover(loadedTable(), files, operation);
    }
    BOOL drop(NSTableView* table, NSArray* files, NSInteger row)
    {
        return [mController tableView:table
                           acceptDrop:dragOf(files)
                                  row:row
                        dropOperation:NSTableViewDropAbove];
    }
    NSArray* manyFiles(int count)
    {
        NSMutableArray* files = [NSMutableArray array];
        for (int index = 0; index < count; ++index)
            [files addObject:path("tool" + std::to_string(index) + ".zmb")];
        return files;
    }
    ModrigStartupSuiteBox* box() { return [mController valueForKey:@"startupSuiteBox"]; }
};
} // namespace

TEST_F(Dropping, OffersToCopyBetweenRowsWhenOneFileCanBeLoaded)
{
    open();
    EXPECT_EQ(NSDragOperationCopy, hover(paths({"a.txt", "b.lsp"}), NSTableViewDropAbove));
    EXPECT_EQ(NSDragOperationNone, hover(paths({"a.txt", "b.txt"}), NSTableViewDropAbove));
    EXPECT_EQ(NSDragOperationNone, hover([NSArray array], NSTableViewDropAbove));
    EXPECT_EQ(NSDragOperationNone, hover(nil, NSTableViewDropAbove));
}

TEST_F(Dropping, IsOfferedByWhicheverTableAsks)
{
    open();
    NSTableView* other = [[[NSTableView alloc] init] autorelease];
    NSTableView* const tables[] = {loadedTable(), historyTable(), other};
    for (NSTableView* table : tables)
        EXPECT_EQ(NSDragOperationCopy, hover(table, paths({"b.lsp"}), NSTableViewDropAbove));
}

TEST_F(Dropping, ShowsNoBoxWhileFilesWithoutAnExtensionHover)
{
    open();
    std::filesystem::create_directory(mFolder / "folder");
    NSArray* files = paths({"folder", "README", "ends."});
    for (int move = 0; move < 3; ++move)
    {
        EXPECT_EQ(NSDragOperationNone, hover(files, NSTableViewDropAbove));
        EXPECT_EQ(NSDragOperationNone, [box() draggingEntered:dragOf(files)]);
    }
    EXPECT_EQ(NSDragOperationCopy, hover(paths({"README", "one.zmb"}), NSTableViewDropAbove));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(Dropping, TellsOfAFileWithoutAnExtensionOnceItIsDropped)
{
    open();
    drop(loadedTable(), paths({"README", "one.zmb"}), 0);
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, file("README"))));
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("one.zmb")));
}

TEST_F(Dropping, ScrollsToNoRow)
{
    fillWithMany(gLoadedAppList);
    open();
    drop(loadedTable(), paths({"one.zmb"}), kMany);
    EXPECT_EQ(file("one.zmb"), rowsOf(loadedApps()).back());
    EXPECT_TRUE(NSLocationInRange(0, [loadedTable() rowsInRect:[loadedTable() visibleRect]]));
}

TEST_F(Dropping, IsRefusedOnARow)
{
    open();
    EXPECT_EQ(NSDragOperationNone, hover(paths({"b.lsp"}), NSTableViewDropOn));
}

TEST_F(Dropping, IsTakenBelowTheRowsAsAtTheEnd)
{
    for (const char* name : {"m0.zmb", "m1.zmb"})
        gLoadedAppList.AddTail(loadedModule(name));
    open();
    const auto below = [this](NSTableView* table, NSArray* files)
    {
        return [mController tableView:table
                         validateDrop:dragOf(files)
                          proposedRow:-1
                proposedDropOperation:NSTableViewDropOn];
    };
    EXPECT_EQ(NSDragOperationCopy, below(loadedTable(), paths({"b.lsp"})));
    EXPECT_EQ(NSDragOperationNone, below(loadedTable(), paths({"b.txt"})));
    EXPECT_EQ(NSDragOperationNone, below(historyTable(), paths({"b.lsp"})));
    drop(loadedTable(), paths({"b.lsp"}), 2);
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("m0.zmb"), file("m1.zmb"), file("b.lsp")));
}

TEST_F(Dropping, IsSignedByTheStartupSuiteBoxAsLongAsItWouldBeTaken)
{
    open();
    const NSUInteger parts = [[[box() superview] subviews] count];
    const auto signs = [&] { return [[[box() superview] subviews] count] - parts; };
    [box() draggingEntered:dragOf(paths({"a.txt"}))];
    EXPECT_EQ(0u, signs());
    [box() draggingEntered:dragOf(paths({"b.lsp"}))];
    [box() draggingEntered:dragOf(paths({"b.lsp"}))];
    EXPECT_EQ(1u, signs());
    [box() draggingExited:dragOf(paths({"b.lsp"}))];
    EXPECT_EQ(0u, signs());
    [box() draggingEntered:dragOf(paths({"b.lsp"}))];
    [box() performDragOperation:dragOf(paths({"b.lsp"}))];
    EXPECT_EQ(0u, signs());
}

TEST_F(Dropping, IsOfferedByTheStartupSuiteBoxForOneFileThatCanBeLoaded)
{
    open();
    EXPECT_EQ(NSDragOperationCopy, [box() draggingEntered:dragOf(paths({"a.txt", "b.lsp"}))]);
    EXPECT_EQ(NSDragOperationNone, [box() draggingEntered:dragOf(paths({"a.txt"}))]);
}

TEST_F(Dropping, InsertsFilesAtTheRowTheLastOneOnTop)
{
    for (const char* name : {"m0.zmb", "m1.zmb", "m2.zmb", "m3.zmb", "m4.zmb"})
        gLoadedAppList.AddTail(loadedModule(name));
    open();
    EXPECT_FALSE(drop(loadedTable(), paths({"one.zmb", "two.zmb"}), 3));
    EXPECT_THAT(rowsOf(loadedApps()),
                ElementsAre(file("m0.zmb"), file("m1.zmb"), file("m2.zmb"), file("two.zmb"), file("one.zmb"),
                            file("m3.zmb"), file("m4.zmb")));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyLoaded, L"2")));
    EXPECT_TRUE(gStartupList.IsEmpty());
}

TEST_F(Dropping, InsertsIntoAShorterHistoryAtItsEnd)
{
    for (const char* name : {"m0.zmb", "m1.zmb", "m2.zmb"})
        gLoadedAppList.AddTail(loadedModule(name));
    gHistoryList.AddTail(file("old.zmb"));
    open();
    [mController setSaveHistory:YES];
    drop(loadedTable(), paths({"one.zmb", "two.zmb"}), 2);
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("m0.zmb"), file("m1.zmb"), file("two.zmb"),
                                                  file("one.zmb"), file("m2.zmb")));
    EXPECT_THAT(rowsOf(historyList()), ElementsAre(file("old.zmb"), file("one.zmb"), file("two.zmb")));
}

// The list goes by applications, the table by files.
TEST_F(Dropping, ShowsInTheHistoryAnObjectModuleThatItsListKnowsFromElsewhere)
{
    gHistoryList.AddTail(CStdStr(L"/elsewhere/one.omp"));
    open();
    [mController setSaveHistory:YES];
    drop(loadedTable(), paths({"one.omp"}), 0);
    EXPECT_THAT(Texts(gHistoryList), ElementsAre(L"/elsewhere/one.omp"));
    EXPECT_THAT(rowsOf(historyList()), UnorderedElementsAre(file("one.omp"), L"/elsewhere/one.omp"));
}

TEST_F(Dropping, AppendsAgainAfterwards)
{
    gLoadedAppList.AddTail(loadedModule("m0.zmb"));
    open();
    drop(loadedTable(), paths({"one.zmb"}), 0);
    load({"two.zmb"});
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("one.zmb"), file("m0.zmb"), file("two.zmb")));
}

TEST_F(Dropping, IgnoresFilesOnTheHistoryTable)
{
    open();
    EXPECT_FALSE(drop(historyTable(), paths({"one.zmb"}), 0));
    EXPECT_THAT(rowsOf(loadedApps()), IsEmpty());
    EXPECT_THAT(rowsOf(historyList()), IsEmpty());
    EXPECT_THAT(lines(), IsEmpty());
    EXPECT_FALSE(host().linker.isLoaded(file("one.zmb")));
}

TEST_F(Dropping, IgnoresFilesOnAnyOtherTable)
{
    open();
    EXPECT_FALSE(drop([[[NSTableView alloc] init] autorelease], paths({"one.zmb"}), 0));
    EXPECT_FALSE(host().linker.isLoaded(file("one.zmb")));
}

TEST_F(Dropping, OnTheHistoryTableEndsInsertingAtARowAndOnAnyOtherDoesNot)
{
    open();
    [mController setValue:[NSNumber numberWithInt:3] forKey:@"mInsertRow"];
    drop([[[NSTableView alloc] init] autorelease], paths({"one.zmb"}), 0);
    EXPECT_EQ(3, [[mController valueForKey:@"mInsertRow"] intValue]);
    drop(historyTable(), paths({"one.zmb"}), 0);
    EXPECT_EQ(-1, [[mController valueForKey:@"mInsertRow"] intValue]);
}

TEST_F(Dropping, TakesFiftyFiles)
{
    open();
    drop(loadedTable(), manyFiles(50), 0);
    EXPECT_EQ(50u, rowsOf(loadedApps()).size());
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyLoaded, L"50")));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(Dropping, RefusesFiftyOneFilesAndLoadsNone)
{
    open();
    drop(loadedTable(), manyFiles(51), 0);
    EXPECT_TRUE([box() performDragOperation:dragOf(manyFiles(51))]);
    EXPECT_THAT(rowsOf(loadedApps()), IsEmpty());
    EXPECT_TRUE(gStartupList.IsEmpty());
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kTooManyFiles, L"50"),
                                     Message(ModrigMessages::kTooManyFiles, L"50")));
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(Dropping, AddsFilesToTheStartupSuite)
{
    open();
    EXPECT_TRUE([box() performDragOperation:dragOf(paths({"one.zmb", "two.zmb"}))]);
    EXPECT_THAT(Texts(gStartupList), ElementsAre(file("one.zmb"), file("two.zmb")));
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("one.zmb"), file("two.zmb")));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyLoaded, L"2"),
                                     Message(ModrigMessages::kManyAddedToStartupSuite, L"2")));
}

TEST_F(Dropping, CountsAFileOfTheStartupSuiteWithoutAddingItTwice)
{
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    gStartupList.AddTail(file("one.zmb"));
    open();
    [box() performDragOperation:dragOf(paths({"one.zmb"}))];
    EXPECT_THAT(Texts(gStartupList), ElementsAre(file("one.zmb")));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kAlreadyLoaded, L"one.zmb"),
                                     Message(ModrigMessages::kOneAddedToStartupSuite, L"one.zmb")));
}

TEST_F(Dropping, AddsWhatWasLoadedBeforeAFailure)
{
    open();
    host().linker.refuseToLoad(file("bad.zmb"));
    [box() performDragOperation:dragOf(paths({"one.zmb", "bad.zmb", "two.zmb"}))];
    EXPECT_THAT(Texts(gStartupList), ElementsAre(file("one.zmb")));
    EXPECT_FALSE(host().linker.isLoaded(file("two.zmb")));
    EXPECT_EQ(Message(ModrigMessages::kOneAddedToStartupSuite, L"one.zmb"), message());
}

TEST_F(Dropping, KeepsTemporaryInternetFilesOutOfTheStartupSuite)
{
    open();
    host().internet.urlsOfLocalFiles[file("net.zmb")] = L"http://example.org/net.zmb";
    [box() performDragOperation:dragOf(paths({"net.zmb"}))];
    EXPECT_TRUE(gStartupList.IsEmpty());
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("net.zmb")));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kTemporaryInternetFile, file("net.zmb"))));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneLoaded, L"net.zmb")));
}

TEST_F(Dropping, NamesTheFileThatJoinedTheStartupSuiteWhenTheLastOneCannot)
{
    open();
    host().internet.urlsOfLocalFiles[file("net.zmb")] = L"http://example.org/net.zmb";
    [box() performDragOperation:dragOf(paths({"one.zmb", "net.zmb"}))];
    EXPECT_THAT(Texts(gStartupList), ElementsAre(file("one.zmb")));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyLoaded, L"2"),
                                     Message(ModrigMessages::kOneAddedToStartupSuite, L"one.zmb")));
}

TEST_F(Dropping, LoadsALispFileAloneOnTheTableAndAllOfItOnTheStartupSuiteBox)
{
    open();
    drop(loadedTable(), paths({"one.lsp"}), 0);
    [box() performDragOperation:dragOf(paths({"two.lsp"}))];
    ASSERT_EQ(6u, host().lisp.queued.size());
    EXPECT_EQ(L"(load \"" + file("one.lsp") + L"\")", host().lisp.queued[0]);
    EXPECT_EQ(L"(progn (_INTERNAL-LOAD-ALL-FILE \"" + file("two.lsp") + L"\" nil T T nil)(princ))",
              host().lisp.queued[3]);
}

TEST_F(Dropping, StopsSilentlyWhenNoFileIsUsable)
{
    open();
    EXPECT_TRUE([box() performDragOperation:dragOf(paths({"a.txt"}))]);
    drop(loadedTable(), [NSArray arrayWithObject:@"/gone/missing.lsp"], 0);
    EXPECT_THAT(lines(), IsEmpty());
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(Dropping, LoadsAFileByThePathItWasFoundAt)
{
    host().files.found[L"tool.zmb"] = file("elsewhere/tool.zmb");
    open();
    drop(loadedTable(), [NSArray arrayWithObject:@"/gone/tool.zmb"], 0);
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("elsewhere/tool.zmb")));
}

TEST_F(Dropping, AcceptsADragWithoutFilesOnTheBoxAndDoesNothing)
{
    open();
    EXPECT_TRUE([box() performDragOperation:dragOf(nil)]);
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(Dropping, FindsNoDialogWhenNoneIsOpen)
{
    ModrigStartupSuiteBox* box = [[[ModrigStartupSuiteBox alloc] initWithFrame:NSZeroRect] autorelease];
    EXPECT_EQ(NSDragOperationNone, [box draggingEntered:dragOf(paths({"b.lsp"}))]);
    EXPECT_FALSE([box performDragOperation:dragOf(paths({"b.lsp"}))]);
}

TEST_F(Dropping, DoesNotShowInAStartupSuiteDialogThatIsOpen)
{
    open();
    ModrigStartupSuitController* suite = [[[ModrigStartupSuitController alloc] init] autorelease];
    ASSERT_TRUE([suite window]);
    [suite doInit];
    [box() performDragOperation:dragOf(paths({"one.zmb"}))];
    EXPECT_THAT(Texts(gStartupList), ElementsAre(file("one.zmb")));
    EXPECT_THAT(rowsOf([suite valueForKey:@"startupApps"]), IsEmpty());
}

namespace
{
// Files that hover over the rows of the loaded applications, of which there are three.
class HoveringOverRows : public Dropping
{
protected:
    static constexpr int kRows = 3;

    void SetUp() override
    {
        Dropping::SetUp();
        for (const char* name : {"m0.zmb", "m1.zmb", "m2.zmb"})
            gLoadedAppList.AddTail(loadedModule(name));
        open();
        [mController setTabViewSelectedIndex:kLoadedApplicationsTab];
        show();
        [mPanel displayIfNeeded];
        for (int gap = 0; gap <= kRows; ++gap)
            mUnmarked.push_back(lookOfGap(gap));
    }
    NSData* lookOfGap(int gap)
    {
        const CGFloat place = gap * NSHeight([loadedTable() rectOfRow:0]);
        return [[pictureOf(loadedTable(), NSMakeRect(0, place - 1, 200, 3)) retain] autorelease];
    }
    // `quarter`: of the row's height, from above.
    id<NSDraggingInfo> over(NSInteger row, int quarter)
    {
        const NSRect rect = [loadedTable() rectOfRow:0];
        const CGFloat place = NSHeight(rect) * (static_cast<CGFloat>(row) + (quarter - 0.5) / 4);
        return dragOver(loadedTable(), NSMakePoint(50, place), paths({"new.zmb"}));
    }
    std::vector<int> markedGaps()
    {
        std::vector<int> marked;
        for (int gap = 0; gap <= kRows; ++gap)
            if (![mUnmarked[static_cast<std::size_t>(gap)] isEqual:lookOfGap(gap)])
                marked.push_back(gap);
        return marked;
    }
    void dropIt(id<NSDraggingInfo> drag)
    {
        [loadedTable() prepareForDragOperation:drag];
        [loadedTable() performDragOperation:drag];
        [loadedTable() concludeDragOperation:drag];
    }
    // Comes over the table there and stays; answers whether a drop is taken, which then lands in that gap.
    bool hoverAt(id<NSDraggingInfo> drag, int gap)
    {
        if ([loadedTable() draggingEntered:drag] == NSDragOperationNone)
            return false;
        EXPECT_THAT(markedGaps(), ElementsAre(gap));
        EXPECT_EQ(NSDragOperationCopy, [loadedTable() draggingUpdated:drag]);
        dropIt(drag);
        EXPECT_EQ(file("new.zmb"), rowsOf(loadedApps())[static_cast<std::size_t>(gap)]);
        return true;
    }

private:
    std::vector<NSData*> mUnmarked;
};

class HoveringOverOneRow : public HoveringOverRows, public testing::WithParamInterface<int>
{
};
} // namespace

TEST_P(HoveringOverOneRow, MarksTheGapAboveAtItsUpperEdgeWhereTheDropLands)
{
    EXPECT_TRUE(hoverAt(over(GetParam(), 1), GetParam()));
}

TEST_P(HoveringOverOneRow, MarksTheGapBelowAtItsLowerEdgeWhereTheDropLands)
{
    EXPECT_TRUE(hoverAt(over(GetParam(), 4), GetParam() + 1));
}

TEST_P(HoveringOverOneRow, MarksNothingInItsMiddleWhereNoDropIsTaken)
{
    for (const int quarter : {2, 3})
    {
        EXPECT_EQ(NSDragOperationNone, [loadedTable() draggingEntered:over(GetParam(), quarter)]);
        EXPECT_THAT(markedGaps(), IsEmpty());
        EXPECT_EQ(NSDragOperationNone, [loadedTable() draggingUpdated:over(GetParam(), quarter)]);
        EXPECT_THAT(markedGaps(), IsEmpty());
    }
}

INSTANTIATE_TEST_SUITE_P(EveryRow, HoveringOverOneRow, testing::Values(0, 1, 2));

TEST_F(HoveringOverRows, MarksTheEndAnywhereBelowThemWhereTheDropLands)
{
    for (int quarter = 1; quarter <= 8; ++quarter)
    {
        id<NSDraggingInfo> drag = over(kRows, quarter);
        EXPECT_EQ(NSDragOperationCopy, [loadedTable() draggingEntered:drag]);
        EXPECT_THAT(markedGaps(), ElementsAre(kRows)) << "quarter " << quarter;
    }
    EXPECT_TRUE(hoverAt(over(kRows, 6), kRows));
}

TEST_F(HoveringOverRows, MarksAGapAgainAfterTheMiddleOfARow)
{
    [loadedTable() draggingEntered:over(1, 1)];
    EXPECT_THAT(markedGaps(), ElementsAre(1));
    [loadedTable() draggingUpdated:over(1, 2)];
    EXPECT_THAT(markedGaps(), IsEmpty());
    [loadedTable() draggingUpdated:over(1, 1)];
    EXPECT_THAT(markedGaps(), ElementsAre(1));
    [loadedTable() draggingUpdated:over(1, 4)];
    EXPECT_THAT(markedGaps(), ElementsAre(2));
}
