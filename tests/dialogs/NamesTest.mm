// Files whose names are in other scripts, or hold what is rarely seen in a name.
#include "tests/dialogs/support/DialogTest.h"
#include "tests/dialogs/support/Pictures.h"

#include "host/ui/platform/gnustep/FontCoverage.h"
#include "host/ui/platform/gnustep/VisualOrder.h"
#include "modrig/messages/MessageLine.h"

#import "modrig/dialogs/ModrigFilePath.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
// The pixels of a text in a place that has room for one word beside another.
NSData* lookOfText(NSString* text)
{
    NSWindow* window = [[[NSWindow alloc] initWithContentRect:NSMakeRect(0, 0, 100, 80)
                                                    styleMask:NSBorderlessWindowMask
                                                      backing:NSBackingStoreBuffered
                                                        defer:NO] autorelease];
    [window setReleasedWhenClosed:NO];
    NSTextField* field = [[[NSTextField alloc] initWithFrame:NSMakeRect(0, 0, 100, 80)] autorelease];
    [[field cell] setWraps:YES];
    [field setStringValue:text];
    [[window contentView] addSubview:field];
    [window orderFront:nil];
    [window display];
    NSData* picture = pictureOf(field);
    [window orderOut:nil];
    return picture;
}

class Names : public OpenDialogTest
{
protected:
    // The pixels of the row's name, but for its extension.
    NSData* lookOf(NSInteger row)
    {
        const NSRect place = [historyTable() frameOfCellAtColumn:0 row:row];
        return pictureOf(historyTable(), NSMakeRect(NSMinX(place), NSMinY(place), 60, NSHeight(place)));
    }
    std::wstring shownName(NSInteger row)
    {
        return wide([[historyTable() dataSource] tableView:historyTable()
                                 objectValueForTableColumn:[[historyTable() tableColumns] objectAtIndex:0]
                                                       row:row]);
    }
};
} // namespace

// Where a font lacks a letter, all of them look like one question mark.
TEST_F(Names, ThatDifferLookDifferentInEveryScript)
{
    openHistory({"first.lsp", "second.lsp", "אב.lsp", "גד.lsp", "با.lsp", "سج.lsp", "日本.lsp", "語中.lsp",
                 "🎉🌙.lsp", "🌙🎉.lsp"});
    for (NSInteger row = 0; row < 10; row += 2)
        EXPECT_FALSE([lookOf(row) isEqual:lookOf(row + 1)]) << "rows " << row << " and " << row + 1;
}

TEST_F(Names, AreDrawnFromRightToLeftWhereTheyAreWrittenSo)
{
    using tessel::windowing::visualOrder;
    EXPECT_EQ(u"tool.lsp", visualOrder(u"tool.lsp"));
    EXPECT_EQ(u"םולש.lsp", visualOrder(u"שלום.lsp"));
    EXPECT_EQ(u"a םולש b", visualOrder(u"a שלום b"));
}

TEST_F(Names, ThatTakeSeveralLinesAreTurnedRoundLineByLine)
{
    using tessel::windowing::visualLines;
    EXPECT_EQ(u"םולש \nםלוע tool", visualLines(u"שלום עולם tool", {0, 5}));
    EXPECT_EQ(u"םולש\nםלוע", visualLines(u"שלום\nעולם", {0, 5}));
    EXPECT_EQ(u"a.lsp", visualLines(u"a.lsp", {0}));
}

// The first words stand in the first line, as if the line were ended there.
TEST_F(Names, ThatTakeSeveralLinesBeginInTheFirst)
{
    for (NSArray* words : {[NSArray arrayWithObjects:@"firstword", @"secondword", nil],
                           [NSArray arrayWithObjects:@"שלוםשלום", @"עולםעולם", nil],
                           [NSArray arrayWithObjects:@"مرحبامرحبا", @"العالمالعالم", nil]})
        EXPECT_TRUE([lookOfText([words componentsJoinedByString:@" "])
            isEqual:lookOfText([words componentsJoinedByString:@"\n"])])
            << [[words objectAtIndex:0] UTF8String];
}

TEST_F(Names, InArabicHaveTheirLettersJoined)
{
    // beh and alef: the beginning form and the end form, the end first on the screen.
    EXPECT_EQ(u"\uFE8E\uFE91.lsp", tessel::windowing::visualOrder(u"\u0628\u0627.lsp"));
}

TEST_F(Names, HaveAFontForTheirLettersWhenOneIsInstalled)
{
    for (const char32_t letter : {U'ש', U'م', U'日', U'🎉'})
        EXPECT_NE("", tessel::windowing::fontWith(letter, false)) << static_cast<unsigned>(letter);
    EXPECT_EQ("", tessel::windowing::fontWith(0x10FFFD, false));
}

TEST_F(Names, MayHoldABackslash)
{
    openHistory({"back\\slash.lsp"});
    EXPECT_EQ(L"back\\slash.lsp", shownName(0));
    select(historyTable(), {0});
    [mController onLoadFromHistory:nil];
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("back\\slash.lsp")));
}

TEST_F(Names, MayHoldALineBreakWhichIsShownInTheLine)
{
    openHistory({"new\nline.zmb"});
    EXPECT_EQ(L"new\\nline.zmb", shownName(0));
    select(historyTable(), {0});
    [mController onLoadFromHistory:nil];
    EXPECT_TRUE(host().linker.isLoaded(file("new\nline.zmb")));
    ModrigUtils::SetDialogMessage(CStdStr(L"new\nline.zmb was loaded."));
    EXPECT_EQ(L"new\\nline.zmb was loaded.", message());
}
