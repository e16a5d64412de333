// The keys that every text field takes.
#include "tests/dialogs/support/DialogTest.h"
#include "tests/dialogs/support/Events.h"

namespace
{
class TextKeys : public testing::Test
{
protected:
    void SetUp() override
    {
        mPool = [[NSAutoreleasePool alloc] init];
        mWindow = [[NSWindow alloc] initWithContentRect:NSMakeRect(50, 50, 300, 80)
                                              styleMask:NSTitledWindowMask
                                                backing:NSBackingStoreBuffered
                                                  defer:NO];
        mField = [[[NSTextField alloc] initWithFrame:NSMakeRect(10, 10, 250, 24)] autorelease];
        [[mWindow contentView] addSubview:mField];
        [mField setStringValue:@"moon.lsp"];
        [mWindow makeKeyAndOrderFront:nil];
        [mWindow makeFirstResponder:mField];
        events::pump();
    }
    void TearDown() override
    {
        [mWindow orderOut:nil];
        [mWindow release];
        [mPool drain];
    }
    void press(NSString* key) { events::press(mWindow, key, NSControlKeyMask); }
    std::wstring typed() { return wide([[mField currentEditor] string]); }
    void selectFirst(NSUInteger count) { [[mField currentEditor] setSelectedRange:NSMakeRange(0, count)]; }

    NSAutoreleasePool* mPool = nil;
    NSWindow* mWindow = nil;
    NSTextField* mField = nil;
};
} // namespace

TEST_F(TextKeys, SelectAllOfTheText)
{
    selectFirst(0);
    press(@"a");
    EXPECT_TRUE(NSEqualRanges(NSMakeRange(0, 8), [[mField currentEditor] selectedRange]));
    selectFirst(0);
    press(@"\001");
    EXPECT_TRUE(NSEqualRanges(NSMakeRange(0, 8), [[mField currentEditor] selectedRange]));
}

TEST_F(TextKeys, CutCopyAndPaste)
{
    selectFirst(4);
    press(@"c");
    EXPECT_EQ(L"moon.lsp", typed());
    [[mField currentEditor] setSelectedRange:NSMakeRange(8, 0)];
    press(@"v");
    EXPECT_EQ(L"moon.lspmoon", typed());
    selectFirst(4);
    press(@"x");
    EXPECT_EQ(L".lspmoon", typed());
    press(@"v");
    EXPECT_EQ(L"moon.lspmoon", typed());
}

TEST_F(TextKeys, UndoWhatWasTyped)
{
    [[mField currentEditor] setSelectedRange:NSMakeRange(8, 0)];
    events::press(mWindow, @"x");
    ASSERT_EQ(L"moon.lspx", typed());
    press(@"z");
    EXPECT_EQ(L"moon.lsp", typed());
}

TEST_F(TextKeys, TypeWithoutControl)
{
    selectFirst(4);
    events::press(mWindow, @"a");
    EXPECT_EQ(L"a.lsp", typed());
}
