// The classes that the host offers for windows, as far as they need no user.
#include "tests/dialogs/support/DialogTest.h"
#include "tests/dialogs/support/Pictures.h"

#import <tesselui/TsOCFileFilter.h>
#import <tesselui/TsUIPersistentStore.h>
#include <tesselui/tsuidisplay.h>
#include <tesselui/tsuieach.h>
#include <tesselui/tsuierrors.h>

#include "host/ui/MessageBoxAlert.h"
#include "host/ui/platform/Windowing.h"
#include "host/ui/platform/gnustep/ThemeButtons.h"

using testing::ElementsAre;

namespace
{
int failures = 0;
}

// A window in whose events the toolkit fails.
@interface FailingWindow : NSWindow
@end

@implementation FailingWindow
- (void)sendEvent:(NSEvent*)event
{
    ++failures;
    [NSException raise:NSInternalInconsistencyException format:@"the display went away"];
}
@end

namespace
{
class FileFilter : public DialogTest
{
};

class Segments : public DialogTest
{
};

class FinishedWindows : public DialogTest
{
};

class MessageBoxes : public DialogTest
{
};

class PersistentStore : public DialogTest
{
protected:
    void SetUp() override
    {
        DialogTest::SetUp();
        mStore = [[TsUIPersistentStore alloc] init];
    }
    void TearDown() override
    {
        [mStore release];
        DialogTest::TearDown();
    }
    TsUIPersistentStore* mStore = nil;
};

void raise(void*)
{
    [NSException raise:NSRangeException format:@"beyond the last row"];
}

void returnQuietly(void*)
{
}
} // namespace

TEST_F(FileFilter, TakesExtensionsWithAndWithoutWildcards)
{
    TsOCFileFilter* filter = [[[TsOCFileFilter alloc] initWithDescription:@"Lisp"
                                                             extensionStr:@"lsp;*.qbc; .rpk;;"] autorelease];
    EXPECT_EQ(L"Lisp", wide([filter description]));
    ASSERT_EQ(3u, [[filter fileExtensions] count]);
    EXPECT_EQ(L"lsp", wide([[filter fileExtensions] objectAtIndex:0]));
    EXPECT_EQ(L"qbc", wide([[filter fileExtensions] objectAtIndex:1]));
    EXPECT_EQ(L"rpk", wide([[filter fileExtensions] objectAtIndex:2]));
}

TEST_F(FileFilter, HasNoExtensionsForAnEmptyText)
{
    TsOCFileFilter* filter = [[[TsOCFileFilter alloc] initWithDescription:@"" extensionStr:@""] autorelease];
    EXPECT_EQ(0u, [[filter fileExtensions] count]);
}

TEST_F(PersistentStore, AnswersNothingForWhatIsNotStored)
{
    EXPECT_EQ(0, [mStore getControlState:@"Group" control:@"Box"]);
    EXPECT_EQ(0, [mStore getControlInt:@"Group" control:@"Number"]);
    EXPECT_EQ(nil, [mStore getControlString:@"Group" control:@"Text"]);
}

TEST_F(PersistentStore, AnswersWhatWasStored)
{
    [mStore putControlState:@"Group" control:@"Box" state:1];
    [mStore putControlInt:@"Group" control:@"Number" value:-42];
    [mStore putControlString:@"Group" control:@"Text" value:@"/Ångström/a \"b\" %s"];
    EXPECT_EQ(1, [mStore getControlState:@"Group" control:@"Box"]);
    EXPECT_EQ(-42, [mStore getControlInt:@"Group" control:@"Number"]);
    EXPECT_EQ(L"/Ångström/a \"b\" %s", wide([mStore getControlString:@"Group" control:@"Text"]));
    EXPECT_EQ(nil, [mStore getControlString:@"Other" control:@"Text"]);
}

TEST_F(PersistentStore, KeepsLongTexts)
{
    NSString* text = [@"" stringByPaddingToLength:5000 withString:@"folder/" startingAtIndex:0];
    [mStore putControlString:@"Group" control:@"Text" value:text];
    EXPECT_EQ(wide(text), wide([mStore getControlString:@"Group" control:@"Text"]));
}

TEST_F(PersistentStore, ForgetsATextThatIsSetToNil)
{
    [mStore putControlString:@"Group" control:@"Text" value:@"text"];
    [mStore putControlString:@"Group" control:@"Text" value:nil];
    EXPECT_EQ(nil, [mStore getControlString:@"Group" control:@"Text"]);
}

TEST_F(PersistentStore, KeepsTheSettingsOfEveryProfile)
{
    [mStore putControlInt:@"Group" control:@"Number" value:1];
    host().setProfile(L"Other");
    EXPECT_EQ(0, [mStore getControlInt:@"Group" control:@"Number"]);
    [mStore putControlInt:@"Group" control:@"Number" value:2];
    host().setProfile(L"Default");
    EXPECT_EQ(1, [mStore getControlInt:@"Group" control:@"Number"]);
}

TEST(ToolkitErrors, AreAnsweredAsText)
{
    EXPECT_EQ(L"NSRangeException: beyond the last row", wide(tsuiErrorOf(raise, nullptr)));
    EXPECT_EQ(nil, tsuiErrorOf(returnQuietly, nullptr));
}

namespace
{
class Waiting : public DialogTest
{
protected:
    static void stop() { [NSApp stopModal]; }

    // Runs a window modally, until a step stops it; what the host was told at each wait, up to its end.
    std::vector<bool> waitsOf(const std::vector<ModalStep>& actions)
    {
        NSWindow* window = [[[NSWindow alloc] initWithContentRect:NSMakeRect(0, 0, 100, 40)
                                                        styleMask:NSTitledWindowMask
                                                          backing:NSBackingStoreBuffered
                                                            defer:NO] autorelease];
        [window setReleasedWhenClosed:NO];
        const ModalSteps steps(actions);
        [NSApp runModalForWindow:window];
        [window orderOut:nil];
        return host().session.waits;
    }
};
} // namespace

TEST_F(Waiting, OfAModalWindowEndsTheActionBefore)
{
    std::vector<bool> before;
    const auto waits = waitsOf({[&] { before = host().session.waits; }, stop});
    EXPECT_THAT(before, testing::Each(true));
    EXPECT_GE(before.size(), 1u) << "before the first action";
    EXPECT_GT(waits.size(), before.size()) << "after it";
    EXPECT_THAT(waits, testing::Each(true));
}

TEST_F(Waiting, OfAMessageBoxIsWithinAnAction)
{
    std::vector<bool> inBox;
    const auto waits = waitsOf({[&]
                                {
                                    host().session.waits.clear();
                                    tsuiShowMessageBox(L"A question.", L"", 0, nullptr);
                                },
                                [&]
                                {
                                    inBox = host().session.waits;
                                    stop();
                                },
                                [] {}, stop});
    EXPECT_THAT(inBox, testing::Each(false));
    EXPECT_GE(inBox.size(), 1u);
    EXPECT_TRUE(waits.back()) << "the box has been answered, and the action is over";
}

TEST_F(MessageBoxes, SayWhyInSmallerTypeThatCanBeSelected)
{
    std::vector<NSTextField*> fields;
    const ModalSteps steps({[&]
                            {
                                NSView* words =
                                    [[[[NSApp modalWindow] contentView] subviews] objectAtIndex:1];
                                for (NSTextField* field : tsuiEach<NSTextField*>([words subviews]))
                                    fields.push_back([[field retain] autorelease]);
                                [NSApp stopModal];
                            }});
    tessel::windowing::runMessage(@"It failed.", @"There is no such file.", true);
    ASSERT_EQ(2u, fields.size());
    EXPECT_EQ(L"There is no such file.", wide([fields[0] stringValue]));
    EXPECT_EQ(L"It failed.", wide([fields[1] stringValue]));
    EXPECT_LT([[fields[0] font] pointSize], [[fields[1] font] pointSize]);
    EXPECT_TRUE([fields[0] isSelectable]);
    EXPECT_LE(NSMaxY([fields[0] frame]), NSMinY([fields[1] frame]));
}

TEST_F(Waiting, OutsideOfModalWindowsTellsTheHostNothing)
{
    host().session.waits.clear();
    tsuiFinishWindows();
    EXPECT_THAT(host().session.waits, testing::IsEmpty());
}

TEST_F(FinishedWindows, DoNotEndTheCommandWhoseEventsTheToolkitFailsOver)
{
    NSWindow* window = [[[FailingWindow alloc] initWithContentRect:NSMakeRect(0, 0, 100, 40)
                                                         styleMask:NSBorderlessWindowMask
                                                           backing:NSBackingStoreBuffered
                                                             defer:NO] autorelease];
    [window setReleasedWhenClosed:NO];
    [NSApp postEvent:[NSEvent otherEventWithType:NSApplicationDefined
                                        location:NSZeroPoint
                                   modifierFlags:0
                                       timestamp:0
                                    windowNumber:[window windowNumber]
                                         context:nil
                                         subtype:0
                                           data1:0
                                           data2:0]
             atStart:YES];
    failures = 0;
    const auto finish = [](void*) { tsuiFinishWindows(); };
    EXPECT_EQ(nil, tsuiErrorOf(finish, nullptr));
    EXPECT_EQ(1, failures);
}

TEST_F(Segments, LookDisabledWhenTheyAre)
{
    tessel::windowing::completeButtons();
    NSWindow* window = [[[NSWindow alloc] initWithContentRect:NSMakeRect(0, 0, 100, 40)
                                                    styleMask:NSBorderlessWindowMask
                                                      backing:NSBackingStoreBuffered
                                                        defer:NO] autorelease];
    [window setReleasedWhenClosed:NO];
    NSSegmentedControl* segments =
        [[[NSSegmentedControl alloc] initWithFrame:NSMakeRect(10, 10, 72, 24)] autorelease];
    [segments setSegmentCount:2];
    [segments setLabel:@"+" forSegment:0];
    [segments setLabel:@"-" forSegment:1];
    [[window contentView] addSubview:segments];
    [window orderFront:nil];
    [window display];
    NSData* enabled = pictureOf(segments);
    EXPECT_TRUE([enabled isEqual:pictureOf(segments)]);
    [segments setEnabled:NO forSegment:1];
    [window display];
    EXPECT_FALSE([enabled isEqual:pictureOf(segments)]);
    [segments setEnabled:YES forSegment:1];
    [window display];
    EXPECT_TRUE([enabled isEqual:pictureOf(segments)]);
    [window orderOut:nil];
}
