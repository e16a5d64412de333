// What the windows look like, as far as a test can see it.
#include "tests/dialogs/support/DialogTest.h"
#include "tests/dialogs/support/Pictures.h"

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

namespace
{
NSString* const kThemes[] = {@"Tessel", @"TesselDark"};

NSString* resourcesOf(NSString* theme)
{
    return [[[NSBundle mainBundle] resourcePath]
        stringByAppendingPathComponent:[theme stringByAppendingString:@".theme/Resources"]];
}

NSArray* colourNames(NSString* theme, NSString* list)
{
    NSString* file = [resourcesOf(theme) stringByAppendingPathComponent:list];
    NSColorList* colours = [[[NSColorList alloc] initWithName:list fromFile:file] autorelease];
    return [[colours allKeys] sortedArrayUsingSelector:@selector(compare:)];
}
} // namespace

TEST_F(Theme, HasTheSameColoursForLightAndForDarkDesktops)
{
    for (NSString* list : {@"ThemeColors.clr", @"ThemeExtraColors.clr", @"ThemeExtraHighlightedColors.clr"})
    {
        EXPECT_GT([colourNames(@"Tessel", list) count], 1u);
        EXPECT_TRUE([colourNames(@"Tessel", list) isEqual:colourNames(@"TesselDark", list)]);
    }
}

TEST_F(Theme, HasAnIconOfItsOwnForEveryKindOfApplicationAtThreeResolutions)
{
    using tessel::windowing::pictureIn;
    for (NSString* theme : kThemes)
    {
        NSMutableSet* pictures = [NSMutableSet set];
        for (NSString* kind :
             {@"bundle", @"zmb", @"omp", @"lsp", @"qbc", @"rpk", @"mcp", @"app", @"folder", @"unknown"})
        {
            NSImage* icon = pictureIn([resourcesOf(theme) stringByAppendingPathComponent:@"FileIcons"], kind);
            ASSERT_EQ(3u, [[icon representations] count]) << [kind UTF8String];
            for (NSUInteger index = 0; index < 3; ++index)
            {
                NSImageRep* picture = [[icon representations] objectAtIndex:index];
                EXPECT_EQ(16 * static_cast<NSInteger>(index + 1), [picture pixelsWide]);
                EXPECT_EQ(16, [picture size].width);
            }
            [pictures addObject:[icon TIFFRepresentation]];
        }
        EXPECT_EQ(10u, [pictures count]);
    }
}

TEST_F(Theme, ShowsFilesByTheirKindWhateverTheCaseOfTheirNames)
{
    using tessel::windowing::iconOfFile;
    EXPECT_EQ(iconOfFile(@"/a/one.lsp", false), iconOfFile(@"/a/TWO.LSP", false));
    EXPECT_NE(iconOfFile(@"/a/one.lsp", false), iconOfFile(@"/a/one.qbc", false));
    EXPECT_EQ(iconOfFile(@"/a/one.bundle", true), iconOfFile(@"/a/one.bundle", false));
    EXPECT_NE(iconOfFile(@"/a/one", true), iconOfFile(@"/a/one", false));
    EXPECT_EQ(iconOfFile(@"/a/one", false), iconOfFile(@"/a/one.txt", false));
}

TEST_F(Theme, GivesTheIconsToWhoeverAsksTheSystemForThem)
{
    NSWorkspace* workspace = [NSWorkspace sharedWorkspace];
    EXPECT_EQ(tessel::windowing::iconOfFile(@"one.lsp", false), [workspace iconForFile:path("one.lsp")]);
}

TEST_F(Theme, LeavesScrollersNoButtonsThatAreNotDrawn)
{
    NSScroller* scroller = [[[NSScroller alloc] initWithFrame:NSMakeRect(0, 0, 16, 200)] autorelease];
    [scroller setEnabled:YES];
    [scroller setKnobProportion:0.5];
    EXPECT_EQ(NSScrollerArrowsNone, [scroller arrowsPosition]);
    EXPECT_TRUE(NSIsEmptyRect([scroller rectForPart:NSScrollerIncrementLine]));
    open();
    EXPECT_EQ(NSScrollerArrowsNone, [[[loadedTable() enclosingScrollView] verticalScroller] arrowsPosition]);
}
