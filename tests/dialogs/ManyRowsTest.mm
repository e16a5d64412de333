// Tables of thousands of rows: what is done to all of them at once is one change of the table.
#include "tests/dialogs/support/DialogTest.h"

#import "modrig/dialogs/ModrigStartupSuitController.h"

using testing::IsEmpty;

// Counts how often a table asks how many rows it has, and how often it is told that others are selected.
@interface CountedTable : NSObject
{
    id mSource;
    int mAsked;
    int mTold;
}
- (id)initWithTable:(NSTableView*)table;
- (int)asked;
- (int)told;
@end

@implementation CountedTable

- (id)initWithTable:(NSTableView*)table
{
    self = [super init];
    mSource = [table dataSource];
    [table setDataSource:self];
    mAsked = 0;
    [[NSNotificationCenter defaultCenter] addObserver:self
                                             selector:@selector(onSelection:)
                                                 name:NSTableViewSelectionDidChangeNotification
                                               object:table];
    return self;
}

- (void)dealloc
{
    [[NSNotificationCenter defaultCenter] removeObserver:self];
    [super dealloc];
}

- (int)asked
{
    return mAsked;
}

- (int)told
{
    return mTold;
}

- (void)onSelection:(NSNotification*)notification
{
    ++mTold;
}

- (NSInteger)numberOfRowsInTableView:(NSTableView*)table
{
    ++mAsked;
    return [mSource numberOfRowsInTableView:table];
}

- (id)tableView:(NSTableView*)table objectValueForTableColumn:(NSTableColumn*)column row:(NSInteger)row
{
    return [mSource tableView:table objectValueForTableColumn:column row:row];
}

@end

namespace
{
class ManyRows : public OpenDialogTest
{
protected:
    struct Cost
    {
        int asked = 0; // how many rows there are
        int told = 0;  // that others are selected
    };

    // Told of the selected rows that lie beyond the table's new end, and then of the others.
    static void expectOneChange(Cost cost)
    {
        EXPECT_EQ(1, cost.asked);
        EXPECT_LE(cost.told, 2);
    }

    template <class Change> Cost cost(NSTableView* table, Change change)
    {
        id source = [table dataSource];
        CountedTable* counted = [[[CountedTable alloc] initWithTable:table] autorelease];
        change();
        [table setDataSource:source];
        return {[counted asked], [counted told]};
    }

    Cost costOfRemovingFromHistory(int count)
    {
        fillWithMany(gHistoryList);
        open();
        select(historyTable(), {});
        [historyTable() selectRowIndexes:upTo(count) byExtendingSelection:NO];
        const auto result = cost(historyTable(), [this] { [mController onRemove:nil]; });
        EXPECT_EQ(static_cast<std::size_t>(kMany - count), gHistoryList.GetCount());
        EXPECT_EQ(static_cast<NSUInteger>(kMany - count), [[historyList() arrangedObjects] count]);
        EXPECT_THAT(selectionOf(historyList()), IsEmpty());
        EXPECT_THAT(selectedFiles(), IsEmpty());
        EXPECT_FALSE([mController canRemoveHistory]);
        close();
        gHistoryList.RemoveAll();
        return result;
    }

    Cost costOfRemovingFromSuite(int count)
    {
        fillWithMany(gStartupList);
        ModrigStartupSuitController* suite = [[[ModrigStartupSuitController alloc] init] autorelease];
        EXPECT_TRUE([suite window]);
        [suite doInit];
        NSTableView* table = [suite valueForKey:@"startupTableView"];
        [table selectRowIndexes:upTo(count) byExtendingSelection:NO];
        const auto result = cost(table, [suite] { [suite onRemove]; });
        EXPECT_EQ(static_cast<std::size_t>(kMany - count), gStartupList.GetCount());
        EXPECT_THAT(selectionOf([suite valueForKey:@"startupApps"]), IsEmpty());
        [suite doClean];
        gStartupList.RemoveAll();
        return result;
    }

    static NSIndexSet* upTo(int count)
    {
        return [NSIndexSet indexSetWithIndexesInRange:NSMakeRange(0, static_cast<NSUInteger>(count))];
    }
};
} // namespace

TEST_F(ManyRows, LeaveTheHistoryInOneChange)
{
    expectOneChange(costOfRemovingFromHistory(kMany - 1));
}

TEST_F(ManyRows, LeaveTheStartupSuiteInOneChange)
{
    expectOneChange(costOfRemovingFromSuite(kMany - 1));
}
