// What the windows look like, as far as a test can see it.
#include "tests/ui/support/DialogTest.h"
#include "tests/ui/support/Pictures.h"

#include <tesselui/tsuieach.h>

#include "host/ui/platform/gnustep/ThemePictures.h"

namespace
{
class Theme : public OpenDialogTest
{
protected:
    // The dialog on the screen.
    void show()
    {
        open();
        [mPanel orderFront:nil];
        [mPanel display];
    }
    void TearDown() override
    {
        [mPanel orderOut:nil];
        OpenDialogTest::TearDown();
    }

    NSData* look()
    {
        [mPanel display];
        return pictureOf([mPanel contentView]);
    }
};

// The stops of the Tab key.
NSArray* stopsOf(NSWindow* window)
{
    NSMutableArray* stops = [NSMutableArray array];
    [window makeFirstResponder:[window contentView]];
    for (NSView* view = [[window contentView] nextValidKeyView]; view && ![stops containsObject:view];
         view = [view nextValidKeyView])
        [stops addObject:view];
    return stops;
}
} // namespace

TEST_F(Theme, ShowsWhereTheKeyboardIsAtEveryStopOfTheTabKey)
{
    show();
    NSArray* stops = stopsOf(mPanel);
    EXPECT_GT([stops count], 5u);
    for (NSView* stop : tsuiEach<NSView*>(stops))
    {
        [mPanel makeFirstResponder:nil];
        NSData* without = look();
        ASSERT_TRUE([mPanel makeFirstResponder:stop]);
        EXPECT_FALSE([without isEqual:look()]) << [[stop description] UTF8String];
        [mPanel makeFirstResponder:nil];
        EXPECT_TRUE([without isEqual:look()]) << [[stop description] UTF8String];
    }
}
