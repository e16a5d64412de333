// The order of the Startup Suite under the hands of a person.
#include "tests/dialogs/support/DialogTest.h"
#include "tests/dialogs/support/Events.h"

#import "modrig/dialogs/ModrigStartupSuitController.h"
#import "modrig/dialogs/ModrigTableView.h"

using testing::ElementsAre;

namespace
{
class StartupSuiteOrder : public OpenDialogTest
{
protected:
    void SetUp() override
    {
        OpenDialogTest::SetUp();
        for (const char* name : {"one.lsp", "two.lsp", "three.lsp", "four.lsp"})
            gStartupList.AddTail(CStdStr(file(name)));
        mSuite = [[ModrigStartupSuitController alloc] init];
        ASSERT_TRUE([mSuite window]);
        [mSuite doInit];
        [[mSuite window] makeKeyAndOrderFront:nil];
        events::pump();
    }
    void TearDown() override
    {
        [[mSuite window] orderOut:nil];
        [mSuite doClean];
        [mSuite release];
        OpenDialogTest::TearDown();
    }
    NSArrayController* rows() { return [mSuite valueForKey:@"startupApps"]; }
    NSTableView* table() { return [mSuite valueForKey:@"startupTableView"]; }
    void press(unichar key, unsigned modifiers)
    {
        [[mSuite window] makeFirstResponder:table()];
        events::press([mSuite window], [NSString stringWithCharacters:&key length:1], modifiers);
    }
    // Table and list, which have to be the same.
    std::vector<std::wstring> order()
    {
        EXPECT_EQ(Texts(gStartupList), rowsOf(rows()));
        return Texts(gStartupList);
    }

    ModrigStartupSuitController* mSuite = nil;
};
} // namespace

TEST_F(StartupSuiteOrder, ChangesWithAltAndTheArrows)
{
    select(table(), {2});
    press(NSUpArrowFunctionKey, NSAlternateKeyMask);
    EXPECT_THAT(order(), ElementsAre(file("one.lsp"), file("three.lsp"), file("two.lsp"), file("four.lsp")));
    EXPECT_THAT(selectionOf(rows()), ElementsAre(file("three.lsp")));
    press(NSUpArrowFunctionKey, NSCommandKeyMask); // what the toolkit takes the left Alt key for
    press(NSUpArrowFunctionKey, NSAlternateKeyMask);
    EXPECT_THAT(order(), ElementsAre(file("three.lsp"), file("one.lsp"), file("two.lsp"), file("four.lsp")));
    press(NSDownArrowFunctionKey, NSAlternateKeyMask);
    EXPECT_THAT(order(), ElementsAre(file("one.lsp"), file("three.lsp"), file("two.lsp"), file("four.lsp")));
    EXPECT_THAT(selectionOf(rows()), ElementsAre(file("three.lsp")));
}

TEST_F(StartupSuiteOrder, ChangesForSeveralRowsAtOnce)
{
    select(table(), {0, 2});
    press(NSDownArrowFunctionKey, NSAlternateKeyMask);
    EXPECT_THAT(order(), ElementsAre(file("two.lsp"), file("one.lsp"), file("four.lsp"), file("three.lsp")));
    EXPECT_THAT(selectionOf(rows()), ElementsAre(file("one.lsp"), file("three.lsp")));
}

TEST_F(StartupSuiteOrder, ChangesByTheMenuOfARow)
{
    select(table(), {3});
    [mSuite perform:ModrigUtils::TableAction::kMoveUp inTable:table()];
    EXPECT_THAT(order(), ElementsAre(file("one.lsp"), file("two.lsp"), file("four.lsp"), file("three.lsp")));
}

TEST_F(StartupSuiteOrder, StaysWhenARowIsRemovedByAKey)
{
    select(table(), {1});
    press(NSDeleteFunctionKey, 0);
    EXPECT_THAT(order(), ElementsAre(file("one.lsp"), file("three.lsp"), file("four.lsp")));
}
