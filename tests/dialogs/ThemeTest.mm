// What the windows look like, as far as a test can see it.
#include "tests/dialogs/support/DialogTest.h"
#include "tests/dialogs/support/Pictures.h"

#include <tesselui/tsuieach.h>

#include "host/ui/platform/Windowing.h"
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
void addOtherFont(id owner, NSFont* font, std::vector<std::string>& others)
{
    if (font && ![[font familyName] isEqual:[[NSFont systemFontOfSize:13] familyName]])
        others.push_back(std::string([[owner description] UTF8String]) + ": " + [[font fontName] UTF8String]);
}

// What is written in the view in another font than the dialogs'.
void addOtherFonts(NSView* view, std::vector<std::string>& others)
{
    // A table writes in the fonts of its columns, and scrollers write nothing.
    if ([view isKindOfClass:[NSControl class]] && ![view isKindOfClass:[NSScroller class]] &&
        ![view isKindOfClass:[NSTableView class]])
        addOtherFont(view, [(NSControl*)view font], others);
    if ([view isKindOfClass:[NSBox class]])
        addOtherFont(view, [(NSBox*)view titleFont], others);
    if ([view isKindOfClass:[NSTabView class]])
        addOtherFont(view, [(NSTabView*)view font], others);
    if ([view isKindOfClass:[NSTableView class]])
        for (NSTableColumn* column : tsuiEach<NSTableColumn*>([(NSTableView*)view tableColumns]))
        {
            addOtherFont(column, [[column headerCell] font], others);
            addOtherFont(column, [[column dataCell] font], others);
        }
    for (NSView* part : tsuiEach<NSView*>([view subviews]))
        addOtherFonts(part, others);
}

std::vector<std::string> otherFontsIn(NSWindow* window)
{
    std::vector<std::string> others;
    addOtherFonts([window contentView], others);
    return others;
}

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

TEST_F(Theme, WritesEverythingInOneFont)
{
    show();
    for (const NSInteger tab : {0, 1})
    {
        [mController setTabViewSelectedIndex:tab];
        EXPECT_THAT(otherFontsIn(mPanel), testing::IsEmpty());
    }
    std::vector<std::string> inBox;
    const ModalSteps steps({[&]
                            {
                                inBox = otherFontsIn([NSApp modalWindow]);
                                [NSApp stopModal];
                            }});
    tessel::windowing::runMessage(@"It failed.", @"There is no such file.", true);
    EXPECT_THAT(inBox, testing::IsEmpty());
}

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
