// Whether every window can be seen, reached and read, at its smallest, its usual and a large size, in this
// language and in one whose words are half as long again. The program is run at several scales.
#include "tests/dialogs/support/DialogTest.h"
#include "tests/dialogs/support/LayoutCheck.h"

#import <tesselui/TsOCOpenFileDialog.h>
#include <tesselui/tsuieach.h>

#include "host/ui/QuestionPanel.h"

#import "modrig/dialogs/ModrigStartupSuitController.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

namespace
{
const NSSize kLarge = {1600, 1000};
const NSSize kLowScreen = {800, 600};
constexpr CGFloat kTitleBar = 24;

// Not the window: the display of the tests is small at the scales of high resolutions, and would limit it.
void resize(NSWindow* window, NSSize size)
{
    [[window contentView] setFrameSize:size];
    [[window contentView] display];
}

// A piece of a window of its own, whose faults are known.
class LayoutCheck : public testing::Test
{
protected:
    void SetUp() override
    {
        mPool = [[NSAutoreleasePool alloc] init];
        mView = [[[NSView alloc] initWithFrame:NSMakeRect(0, 0, 300, 200)] autorelease];
        mOne = addButton(@"One", NSMakeRect(10, 10, 80, 28));
        mTwo = addButton(@"Two", NSMakeRect(100, 10, 80, 28));
    }
    void TearDown() override { [mPool drain]; }

    NSButton* addButton(NSString* title, NSRect frame)
    {
        NSButton* button = [[[NSButton alloc] initWithFrame:frame] autorelease];
        [button setTitle:title];
        [button setFont:[NSFont systemFontOfSize:13]];
        [mView addSubview:button];
        return button;
    }

    NSView* mView = nil;
    NSButton* mOne = nil;
    NSButton* mTwo = nil;

private:
    NSAutoreleasePool* mPool = nil;
};

class Layout : public OpenDialogTest
{
protected:
    // Measures at the three sizes, then again with longer texts: other languages may be as much longer than
    // English, and not longer than that.
    void measure(NSWindow* window)
    {
        measureSizesOf(window, "in this language");
        if (![[[[NSBundle mainBundle] preferredLocalizations] objectAtIndex:0] isEqual:@"en"])
            return;
        lengthenTexts([window contentView]);
        measureSizesOf(window, "with longer words");
    }

    void measureTabs()
    {
        open();
        for (const NSInteger tab : {0, 1})
        {
            [mController setTabViewSelectedIndex:tab];
            SCOPED_TRACE(tab ? "History" : "Loaded Applications");
            measure(mPanel);
            close();
            open();
        }
    }

private:
    void measureSizesOf(NSWindow* window, const char* language)
    {
        const NSSize usual = [[window contentView] frame].size;
        for (const NSSize size : {kLarge, [window contentMinSize], usual})
        {
            resize(window, size);
            EXPECT_THAT(layoutFaults([window contentView]), IsEmpty())
                << language << ", " << size.width << " by " << size.height;
        }
    }
};
} // namespace

TEST_F(LayoutCheck, FindsNoFaultWhereThereIsNone)
{
    EXPECT_THAT(layoutFaults(mView), IsEmpty());
}

TEST_F(LayoutCheck, FindsAControlOverAnother)
{
    [mTwo setFrameOrigin:NSMakePoint(85, 10)];
    EXPECT_THAT(layoutFaults(mView), ElementsAre(HasSubstr("\"One\" overlaps NSButton \"Two\"")));
}

TEST_F(LayoutCheck, IgnoresWhatIsHidden)
{
    [mTwo setFrameOrigin:NSMakePoint(85, 10)];
    [mTwo setHidden:YES];
    EXPECT_THAT(layoutFaults(mView), IsEmpty());
}

TEST_F(LayoutCheck, FindsAControlThatCannotBeReached)
{
    [mTwo setFrameOrigin:NSMakePoint(230, 10)];
    EXPECT_THAT(layoutFaults(mView), ElementsAre(HasSubstr("\"Two\" stands outside of NSView")));
}

TEST_F(LayoutCheck, FindsATitleThatIsCut)
{
    [mTwo setTitle:@"Two, and what is too long for it"];
    EXPECT_THAT(layoutFaults(mView), ElementsAre(HasSubstr("needs")));
}

TEST_F(LayoutCheck, FindsATextThatNeedsMoreLinesThanThereIsRoomFor)
{
    NSTextField* label = [[[NSTextField alloc] initWithFrame:NSMakeRect(10, 60, 100, 20)] autorelease];
    [label setStringValue:@"A text of several words, which takes several lines in so narrow a place."];
    [label setEditable:NO];
    [label setSelectable:NO];
    [mView addSubview:label];
    EXPECT_THAT(layoutFaults(mView), ElementsAre(HasSubstr("needs a height of")));
}

TEST_F(LayoutCheck, FindsFaultsDeepInside)
{
    NSView* inner = [[[NSView alloc] initWithFrame:NSMakeRect(0, 60, 300, 100)] autorelease];
    [mView addSubview:inner];
    [inner addSubview:mOne];
    [inner addSubview:mTwo];
    [mTwo setFrameOrigin:NSMakePoint(85, 10)];
    EXPECT_THAT(layoutFaults(mView), ElementsAre(HasSubstr("overlaps")));
}

TEST_F(LayoutCheck, LengthensWordsByHalf)
{
    EXPECT_STREQ("LoadLo", [lengthened(@"Load") UTF8String]);
    EXPECT_STREQ("LispLi filesfil (*.lsp)", [lengthened(@"Lisp files (*.lsp)") UTF8String]);
    lengthenTexts(mView);
    EXPECT_STREQ("OneOn", [[mOne title] UTF8String]);
}

TEST_F(Layout, OfTheMainDialogHasRoomForEverything)
{
    measureTabs();
}

TEST_F(Layout, OfTheMainDialogFitsALowScreen)
{
    open();
    const NSSize smallest = [mPanel contentMinSize];
    EXPECT_LE(smallest.width, kLowScreen.width);
    EXPECT_LE(smallest.height + kTitleBar, kLowScreen.height - 48); // the desktop's own bar
}

// The list of files gives way first, then the tables.
TEST_F(Layout, OfTheMainDialogKeepsTheTablesAsLongAsTheListOfFilesCanGiveWay)
{
    open();
    const NSSize usual = {740, 728};
    resize(mPanel, usual);
    const CGFloat table = NSHeight([[loadedTable() enclosingScrollView] frame]);
    resize(mPanel, NSMakeSize(usual.width, usual.height - 150));
    EXPECT_EQ(table, NSHeight([[loadedTable() enclosingScrollView] frame]));
    resize(mPanel, [mPanel contentMinSize]);
    EXPECT_LT(NSHeight([[loadedTable() enclosingScrollView] frame]), table);
    EXPECT_GT(NSHeight([[loadedTable() enclosingScrollView] frame]), 90);
}

TEST_F(Layout, OfTheStartupSuiteHasRoomForEverything)
{
    open();
    ModrigStartupSuitController* suite = [[[ModrigStartupSuitController alloc] init] autorelease];
    ASSERT_TRUE([suite window]);
    [suite doInit];
    [[suite window] setContentMinSize:[[suite window] minSize]];
    measure([suite window]);
    [suite doClean];
}

TEST_F(Layout, OfTheAddPanelHasRoomForEverything)
{
    NSMutableArray* filters = [NSMutableArray array];
    [TsOCModrigUtil populateModrigFileFilter:filters];
    TsOCOpenFileDialog* dialog = [[[TsOCOpenFileDialog alloc] init] autorelease];
    [dialog setTitle:@"Add to Startup Suite"];
    [dialog setInitialPath:path("folder")];
    [dialog setFileFilters:filters];
    const ModalSteps steps({[&] { measure([NSApp modalWindow]); }, [] { [NSApp stopModal]; }});
    [dialog runModal];
}

TEST_F(Layout, OfAMessageBoxHasRoomForEverything)
{
    open();
    const wchar_t* text = L"/a/folder/module.bundle could not be loaded.";
    const wchar_t* detail =
        L"/a/folder/module.bundle: a library that it needs, libhorizon.so.4, is not on this "
        L"computer, or none of the folders where libraries are looked for holds it.";
    lookAtMessageBox(text, detail, [](NSView* box) { EXPECT_THAT(layoutFaults(box), IsEmpty()); });
}

namespace
{
// A question that none of its answers fits.
tessel::QuestionWindows::Asked unanswerable(const std::wstring& text)
{
    tessel::QuestionWindows::Asked asked;
    asked.title = L"moon.bundle";
    asked.question.text = text;
    asked.take = [](const std::wstring&)
    {
        return tessel::Failure{L"There is no file /a/folder/with/a/long/name/and/another/one/drawing.txt in "
                               L"any of the folders where drawings are looked for."};
    };
    asked.isInterrupted = [] { return false; };
    return asked;
}

void pressDefault()
{
    pressKey([NSApp modalWindow], @"\r");
}

class LayoutOfQuestions : public Layout
{
protected:
    // As it opens, and with the reason why an answer does not fit.
    static void measureQuestion(const tessel::QuestionWindows::Asked& asked)
    {
        const auto expectNoFaults = []
        { EXPECT_THAT(layoutFaults([[NSApp modalWindow] contentView]), IsEmpty()); };
        const ModalSteps steps({expectNoFaults, pressDefault, expectNoFaults,
                                []
                                {
                                    const NSRect screen = [[NSScreen mainScreen] visibleFrame];
                                    EXPECT_TRUE(NSContainsRect(screen, [[NSApp modalWindow] frame]));
                                    [NSApp stopModal];
                                }});
        EXPECT_FALSE(tsuiAskInWindow(asked));
    }
};

const wchar_t* const kQuestionTexts[] = {
    L"Size", L"How large are the gears to be that are drawn around the one in the middle, and how many teeth "
             L"does each of these have if nothing else is said?"};
} // namespace

TEST_F(LayoutOfQuestions, ForATextHasRoomForEverything)
{
    for (const wchar_t* text : kQuestionTexts)
        measureQuestion(unanswerable(text));
}

TEST_F(LayoutOfQuestions, ForAFileHasRoomForEverything)
{
    for (const wchar_t* text : kQuestionTexts)
    {
        auto asked = unanswerable(text);
        asked.question.file = tessel::Questions::File::kThere;
        measureQuestion(asked);
    }
}

TEST_F(LayoutOfQuestions, ForAChoiceHasRoomForEverything)
{
    for (const wchar_t* text : kQuestionTexts)
    {
        auto asked = unanswerable(text);
        asked.question.choices = {L"Yes", L"No", L"Neither of the two"};
        asked.question.byDefault = L"Yes";
        measureQuestion(asked);
    }
}

TEST_F(LayoutOfQuestions, LetsATextScrollThatIsHigherThanTheScreen)
{
    std::wstring text;
    for (int word = 0; word < 3000; ++word)
        text += L"words ";
    const auto asked = unanswerable(text);
    const ModalSteps steps(
        {[]
         { EXPECT_TRUE(NSContainsRect([[NSScreen mainScreen] visibleFrame], [[NSApp modalWindow] frame])); },
         pressDefault,
         []
         {
             NSWindow* window = [NSApp modalWindow];
             EXPECT_TRUE(NSContainsRect([[NSScreen mainScreen] visibleFrame], [window frame]));
             EXPECT_THAT(layoutFaults([window contentView]), IsEmpty());
             [NSApp stopModal];
             NSScrollView* frame = nil;
             for (NSView* part : tsuiEach<NSView*>([[window contentView] subviews]))
                 if ([part isKindOfClass:[NSScrollView class]])
                     frame = (NSScrollView*)part;
             ASSERT_TRUE(frame);
             NSView* words = [frame documentView];
             const NSRect shown = [frame documentVisibleRect];
             EXPECT_LE(NSWidth([words frame]), NSWidth(shown));
             EXPECT_NEAR([words isFlipped] ? NSMinY(shown) : NSHeight([words frame]) - NSMaxY(shown), 0, 1)
                 << "the beginning shows";
         }});
    EXPECT_FALSE(tsuiAskInWindow(asked));
}
