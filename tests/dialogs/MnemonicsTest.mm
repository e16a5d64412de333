// Letters that stand for controls, with Alt. That the keys reach them is tried in the real program.
#include "tests/dialogs/support/DialogTest.h"
#include "tests/dialogs/support/Pictures.h"

#include "host/ui/platform/gnustep/Mnemonics.h"

using namespace tessel::windowing;

namespace
{
// The place of the letter that is underlined for the control, or -1.
NSInteger placeOf(NSView* control, NSString* text)
{
    NSAttributedString* shown =
        withMnemonic([[[NSAttributedString alloc] initWithString:text] autorelease], control);
    for (NSUInteger place = 0; place < [shown length]; ++place)
        if ([shown attribute:NSUnderlineStyleAttributeName atIndex:place effectiveRange:nullptr])
            return static_cast<NSInteger>(place);
    return -1;
}

class Mnemonics : public DialogTest
{
protected:
    void SetUp() override
    {
        DialogTest::SetUp();
        mWindow = [[[NSWindow alloc] initWithContentRect:NSMakeRect(0, 0, 300, 200)
                                               styleMask:NSBorderlessWindowMask
                                                 backing:NSBackingStoreBuffered
                                                   defer:NO] autorelease];
        [mWindow setReleasedWhenClosed:NO];
        [mWindow orderFront:nil];
    }
    void TearDown() override
    {
        [mWindow orderOut:nil];
        DialogTest::TearDown();
    }

    NSButton* addButton(NSString* title, CGFloat left, NSButtonType type = NSMomentaryPushInButton)
    {
        NSButton* button = [[[NSButton alloc] initWithFrame:NSMakeRect(left, 0, 90, 30)] autorelease];
        [button setButtonType:type];
        [button setTitle:title];
        [[mWindow contentView] addSubview:button];
        return button;
    }
    NSTextField* addField(NSString* text, CGFloat left, bool editable)
    {
        NSTextField* field = [[[NSTextField alloc] initWithFrame:NSMakeRect(left, 50, 60, 24)] autorelease];
        [field setEditable:editable];
        [field setBezeled:editable];
        [field setStringValue:text];
        [[mWindow contentView] addSubview:field];
        return field;
    }
    NSPopUpButton* addMenu(NSString* title, CGFloat left, BOOL ofActions)
    {
        NSPopUpButton* menu = [[[NSPopUpButton alloc] initWithFrame:NSMakeRect(left, 100, 90, 26)
                                                          pullsDown:ofActions] autorelease];
        [menu addItemWithTitle:title];
        [[mWindow contentView] addSubview:menu];
        return menu;
    }

    // Whether the first of two that are alike, which alone has a letter, looks otherwise than the second.
    bool isDrawn(NSView* first, NSView* second)
    {
        [mWindow display];
        return ![pictureOf(first) isEqual:pictureOf(second)];
    }

    NSWindow* mWindow = nil;
};
} // namespace

TEST_F(Mnemonics, AreUnderlinedInButtonsAndSwitches)
{
    NSButton* button = addButton(@"A", 0);
    EXPECT_TRUE(isDrawn(button, addButton(@"A", 100)));
    NSButton* box = addButton(@"B", 0, NSSwitchButton);
    EXPECT_TRUE(isDrawn(box, addButton(@"B", 100, NSSwitchButton)));
}

TEST_F(Mnemonics, AreUnderlinedInLabels)
{
    NSTextField* label = addField(@"A:", 0, false);
    addField(@"", 70, true);
    EXPECT_TRUE(isDrawn(label, addField(@"A:", 140, false)));
    EXPECT_EQ(-1, placeOf(addField(@"Z", 200, false), @"Z")) << "what names nothing";
}

TEST_F(Mnemonics, AreUnderlinedInMenusOfActionsOnly)
{
    NSPopUpButton* actions = addMenu(@"Go", 0, YES);
    EXPECT_EQ(0, placeOf(actions, @"Go"));
    NSPopUpButton* second = addMenu(@"o", 100, YES);
    EXPECT_TRUE(isDrawn(second, addMenu(@"o", 200, YES)));
    EXPECT_EQ(-1, placeOf(addMenu(@"One", 200, NO), @"One"));
}

TEST_F(Mnemonics, AreLeftToWhatShows)
{
    NSButton* hidden = addButton(@"A", 0);
    NSButton* shown = addButton(@"A", 100);
    EXPECT_EQ(0, placeOf(hidden, @"A"));
    EXPECT_EQ(-1, placeOf(shown, @"A"));
    [hidden setHidden:YES];
    EXPECT_EQ(-1, placeOf(hidden, @"A"));
    EXPECT_EQ(0, placeOf(shown, @"A"));
}
