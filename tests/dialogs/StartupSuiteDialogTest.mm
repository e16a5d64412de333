#include "tests/dialogs/support/DialogTest.h"

#include "modrig/messages/MessageIds.h"
#include "modrig/module/DialogBridge.h"

#import <tesselui/TsOCFileFilter.h>

#import "modrig/dialogs/ModrigStartupSuitController.h"
#import "modrig/dialogs/NSSavePanel+ModrigRuntime.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
constexpr NSInteger kAdd = 0;
constexpr NSInteger kRemove = 1;

// Whether Tab comes to the view from the window's name field.
bool isReachedByTab(NSView* wanted, NSWindow* window)
{
    constexpr int kMostStops = 50;
    NSView* view = nameField((NSOpenPanel*)window);
    for (int stop = 0; stop < kMostStops && view && view != wanted; ++stop)
        view = [view nextValidKeyView];
    return view == wanted;
}

class StartupSuiteDialog : public OpenDialogTest
{
protected:
    void TearDown() override
    {
        [mSuite doClean];
        [mSuite release];
        OpenDialogTest::TearDown();
    }
    void openSuite()
    {
        mSuite = [[ModrigStartupSuitController alloc] init];
        ASSERT_TRUE([mSuite window]);
        [mSuite doInit];
    }
    NSArrayController* rows() { return [mSuite valueForKey:@"startupApps"]; }
    NSTableView* table() { return [mSuite valueForKey:@"startupTableView"]; }
    NSSegmentedControl* segments() { return [mSuite valueForKey:@"segmentedControl"]; }
    void clickSegment(NSInteger segment)
    {
        [segments() setSelectedSegment:segment];
        [mSuite onSegmentedButton:segments()];
    }

    ModrigStartupSuitController* mSuite = nil;
};

// Presses the close button of the window that is modal, when it is the one of that title.
bool closeWindow(NSString* title)
{
    NSWindow* window = [NSApp modalWindow];
    if (![[window title] isEqual:title])
        return false;
    [window performClose:nil];
    // The modal run ends at the next event.
    pressKey(window, @"x");
    return true;
}

bool cancelMainDialog()
{
    if (![NSApp modalWindow] || [NSApp modalWindow] != runningPanel())
        return false;
    [runningPanel() cancel:nil];
    return true;
}
} // namespace

TEST_F(StartupSuiteDialog, IsEmptyWithRemoveDisabledForAnEmptySuite)
{
    openSuite();
    EXPECT_EQ(L"ModrigStartupSuit", wide([mSuite windowNibName]));
    EXPECT_EQ(0, [table() numberOfRows]);
    EXPECT_TRUE([segments() isEnabledForSegment:kAdd]);
    EXPECT_FALSE([segments() isEnabledForSegment:kRemove]);
}

TEST_F(StartupSuiteDialog, ListsTheSuiteInItsOrderWithNothingSelected)
{
    gStartupList.AddTail(file("one.lsp"));
    gStartupList.AddTail(file("two.zmb"));
    openSuite();
    EXPECT_THAT(rowsOf(rows()), ElementsAre(file("one.lsp"), file("two.zmb")));
    EXPECT_EQ(2, [table() numberOfRows]);
    EXPECT_THAT(selectionOf(rows()), IsEmpty());
    EXPECT_FALSE([segments() isEnabledForSegment:kRemove]);
}

TEST_F(StartupSuiteDialog, EnablesRemoveWithASelection)
{
    gStartupList.AddTail(file("one.lsp"));
    openSuite();
    [segments() setNeedsDisplay:NO];
    select(table(), {0});
    EXPECT_TRUE([segments() isEnabledForSegment:kRemove]);
    EXPECT_TRUE([segments() needsDisplay]);
    [table() deselectAll:nil];
    EXPECT_FALSE([segments() isEnabledForSegment:kRemove]);
}

TEST_F(StartupSuiteDialog, IgnoresTheSelectionOfAnyOtherTable)
{
    gStartupList.AddTail(file("one.lsp"));
    openSuite();
    [rows() setSelectionIndex:0];
    [segments() setEnabled:NO forSegment:kRemove];
    NSTableView* other = [[[NSTableView alloc] init] autorelease];
    [mSuite tableViewSelectionDidChange:[NSNotification notificationWithName:@"selection" object:other]];
    EXPECT_FALSE([segments() isEnabledForSegment:kRemove]);
}

TEST_F(StartupSuiteDialog, RemovesSelectedRowsFromTheSuiteWithoutAMessage)
{
    for (const char* name : {"one.lsp", "two.lsp", "three.lsp"})
        gStartupList.AddTail(file(name));
    openSuite();
    select(table(), {0, 2});
    clickSegment(kRemove);
    EXPECT_THAT(rowsOf(rows()), ElementsAre(file("two.lsp")));
    EXPECT_THAT(Texts(gStartupList), ElementsAre(file("two.lsp")));
    EXPECT_THAT(lines(), IsEmpty());
    EXPECT_FALSE([segments() isEnabledForSegment:kRemove]);
}

TEST_F(StartupSuiteDialog, RemovesNothingWithoutASelection)
{
    gStartupList.AddTail(file("one.lsp"));
    openSuite();
    [mSuite onRemove];
    EXPECT_EQ(1u, gStartupList.GetCount());
}

TEST_F(StartupSuiteDialog, LoadsNewFilesThroughTheMainDialogAndAddsThem)
{
    open();
    openSuite();
    [mSuite addFiles:paths({"one.zmb", "two.lsp"})];
    EXPECT_THAT(rowsOf(rows()), ElementsAre(file("one.zmb"), file("two.lsp")));
    EXPECT_THAT(Texts(gStartupList), ElementsAre(file("one.zmb"), file("two.lsp")));
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("one.zmb"), file("two.lsp")));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyLoaded, L"2")));
}

TEST_F(StartupSuiteDialog, AddsAFileThatIsLoadedAlready)
{
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    open();
    openSuite();
    [mSuite addFiles:paths({"one.zmb"})];
    EXPECT_THAT(rowsOf(rows()), ElementsAre(file("one.zmb")));
    EXPECT_THAT(Texts(gStartupList), ElementsAre(file("one.zmb")));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kAlreadyLoaded, L"one.zmb")));
}

TEST_F(StartupSuiteDialog, PassesOverAFileOfTheSuiteSilently)
{
    gStartupList.AddTail(file("one.zmb"));
    open();
    openSuite();
    [mSuite addFiles:paths({"one.zmb"})];
    EXPECT_FALSE(host().linker.isLoaded(file("one.zmb")));
    EXPECT_THAT(rowsOf(rows()), ElementsAre(file("one.zmb")));
    EXPECT_EQ(1u, gStartupList.GetCount());
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(StartupSuiteDialog, DropsBadAndMissingFilesSilently)
{
    open();
    openSuite();
    NSArray* files = [paths({"a.txt"}) arrayByAddingObject:@"/gone/missing.lsp"];
    [mSuite addFiles:files];
    EXPECT_THAT(rowsOf(rows()), IsEmpty());
    EXPECT_THAT(lines(), IsEmpty());
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(StartupSuiteDialog, AddsWhatWasLoadedBeforeAFailure)
{
    open();
    openSuite();
    host().linker.refuseToLoad(file("bad.zmb"));
    [mSuite addFiles:paths({"one.zmb", "bad.zmb", "two.zmb"})];
    EXPECT_THAT(rowsOf(rows()), ElementsAre(file("one.zmb")));
    EXPECT_THAT(Texts(gStartupList), ElementsAre(file("one.zmb")));
}

TEST_F(StartupSuiteDialog, KeepsTemporaryInternetFilesOut)
{
    open();
    openSuite();
    host().internet.urlsOfLocalFiles[file("net.zmb")] = L"http://example.org/net.zmb";
    [mSuite addFiles:paths({"net.zmb", "one.zmb"})];
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kTemporaryInternetFile, file("net.zmb"))));
    EXPECT_THAT(rowsOf(rows()), ElementsAre(file("one.zmb")));
    EXPECT_THAT(Texts(gStartupList), ElementsAre(file("one.zmb")));
}

TEST_F(StartupSuiteDialog, LoadsAllOfALispFile)
{
    open();
    openSuite();
    [mSuite addFiles:paths({"two.lsp"})];
    ASSERT_EQ(3u, host().lisp.queued.size());
    EXPECT_EQ(L"(progn (_INTERNAL-LOAD-ALL-FILE \"" + file("two.lsp") + L"\" nil T T nil)(princ))",
              host().lisp.queued[0]);
}

TEST_F(StartupSuiteDialog, PassesOverAFileThatHasARowBeforeItAsksWhereItCameFrom)
{
    gStartupList.AddTail(file("net.zmb"));
    open();
    openSuite();
    std::filesystem::create_symlink(mFolder / "net.zmb", mFolder / "link.zmb");
    host().internet.urlsOfLocalFiles[file("net.zmb")] = L"http://example.org/net.zmb";
    [mSuite addFiles:paths({"link.zmb"})];
    EXPECT_TRUE(host().linker.isLoaded(file("net.zmb")));
    EXPECT_THAT(boxes(), IsEmpty());
    EXPECT_THAT(rowsOf(rows()), ElementsAre(file("net.zmb")));
    EXPECT_THAT(Texts(gStartupList), ElementsAre(file("net.zmb")));
}

TEST_F(StartupSuiteDialog, ScrollsNowhereWhenNothingWasAdded)
{
    fillWithMany(gStartupList);
    open();
    openSuite();
    host().internet.urlsOfLocalFiles[file("net.zmb")] = L"http://example.org/net.zmb";
    [mSuite addFiles:paths({"net.zmb"})];
    EXPECT_TRUE(NSLocationInRange(0, [table() rowsInRect:[table() visibleRect]]));
    EXPECT_FALSE(NSLocationInRange(kMany - 1, [table() rowsInRect:[table() visibleRect]]));
}

TEST_F(StartupSuiteDialog, RefusesFiftyOneFiles)
{
    open();
    openSuite();
    NSMutableArray* files = [NSMutableArray array];
    for (int index = 0; index < 51; ++index)
        [files addObject:path("tool" + std::to_string(index) + ".zmb")];
    [mSuite addFiles:files];
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kTooManyFiles, L"50")));
    EXPECT_THAT(rowsOf(rows()), IsEmpty());
    [files removeLastObject];
    [mSuite addFiles:files];
    EXPECT_EQ(50u, gStartupList.GetCount());
}

TEST_F(StartupSuiteDialog, AddsNothingWhenNoMainDialogIsOpen)
{
    openSuite();
    [mSuite addFiles:paths({"one.zmb"})];
    EXPECT_FALSE(host().linker.isLoaded(file("one.zmb")));
    EXPECT_THAT(rowsOf(rows()), IsEmpty());
    EXPECT_TRUE(gStartupList.IsEmpty());
}

TEST_F(StartupSuiteDialog, ScrollsToTheNewRow)
{
    fillWithMany(gStartupList);
    open();
    openSuite();
    [mSuite addFiles:paths({"last.zmb"})];
    EXPECT_TRUE(NSContainsRect([table() visibleRect], [table() rectOfRow:kMany]));
}

TEST_F(StartupSuiteDialog, OpensItsHelpPage)
{
    openSuite();
    [mSuite help:nil];
    ASSERT_EQ(1u, host().output.helpCalls.size());
    EXPECT_EQ(L"startup_suite_dialog", host().output.helpCalls[0].topic);
}

TEST_F(StartupSuiteDialog, RunsOverTheMainDialogAndStoresTheShortenedSuiteWhenBothAreClosed)
{
    for (const char* name : {"one.lsp", "two.lsp"})
        gStartupList.AddTail(file(name));
    NSWindow* suite = nil;
    const ModalSteps steps({[] { [[TsOCModrigUtil getModrigController] onStartupSuits:nil]; },
                            [&]
                            {
                                suite = [NSApp modalWindow];
                                ASSERT_EQ(L"Startup Suite", wide([suite title]));
                                mSuite = [(ModrigStartupSuitController*)[suite delegate] retain];
                                const NSRect inner = [suite frame];
                                const NSRect outer = [runningPanel() frame];
                                EXPECT_NEAR(NSMidX(outer), NSMidX(inner), 1);
                                EXPECT_NEAR(NSMidY(outer), NSMidY(inner), 1);
                                select(table(), {0});
                                clickSegment(kRemove);
                            },
                            [&] { pressKey(suite, @"\033"); },
                            [&]
                            {
                                if ([suite isVisible])
                                    return false;

                                if ([NSApp modalWindow] != runningPanel())
                                    return false;
                                [[runningPanel() cancelButton] performClick:nil];
                                return true;
                            }});
    ModrigUtils::RunModrigDialog();
    EXPECT_EQ(L"1", host().registry.value(host().moduleKey() + L"\\Startup", L"NumStartup"));
    EXPECT_EQ(file("two.lsp"), host().registry.value(host().moduleKey() + L"\\Startup", L"1Startup"));
    EXPECT_EQ(1u, [mSuite retainCount]); // the test's own
}

TEST_F(StartupSuiteDialog, ChoosesFilesInTheHostsFolderWhateverTheOtherDialogRemembers)
{
    host().registry.setValue(L"Software\\Tessel\\R21\\Profiles\\Default\\DialogSettings\\Modrig",
                             L"InitialPath", mFolder.path().wstring());
    openSuite();
    const ModalSteps steps({[]
                            {
                                NSOpenPanel* dialog = (NSOpenPanel*)[NSApp modalWindow];
                                EXPECT_EQ(wide([[NSBundle mainBundle] bundlePath]), wide([dialog directory]));
                                EXPECT_TRUE([dialog allowsMultipleSelection]);
                                NSPopUpButton* types = [[[dialog accessoryView] subviews] lastObject];
                                NSMutableArray* filters = [NSMutableArray array];
                                [TsOCModrigUtil populateModrigFileFilter:filters];
                                EXPECT_EQ(6u, [filters count]);
                                EXPECT_TRUE(
                                    [[types itemTitles] isEqual:[filters valueForKey:@"description"]]);
                                EXPECT_TRUE(isReachedByTab(types, dialog));
                                [dialog cancel:nil];
                            }});
    clickSegment(kAdd);
}

TEST_F(StartupSuiteDialog, DoesNothingForAnyOtherSegment)
{
    gStartupList.AddTail(file("one.lsp"));
    openSuite();
    select(table(), {0});
    [segments() setSegmentCount:3];
    clickSegment(2);
    EXPECT_EQ(1u, gStartupList.GetCount());
    [mSuite onSegmentedButton:segments()];
    EXPECT_EQ(1u, gStartupList.GetCount());
}

TEST_F(StartupSuiteDialog, AddsWithTheInsertKey)
{
    bool asked = false;
    const unichar insert = NSInsertFunctionKey;
    NSString* key = [NSString stringWithCharacters:&insert length:1];
    const ModalSteps steps({[] { [[TsOCModrigUtil getModrigController] onStartupSuits:nil]; },
                            [&] { pressKey([NSApp modalWindow], key); },
                            [&]
                            {
                                if (![[NSApp modalWindow] isKindOfClass:[NSOpenPanel class]])
                                    return false;
                                asked = [NSApp modalWindow] != runningPanel();
                                [(NSOpenPanel*)[NSApp modalWindow] cancel:nil];
                                return true;
                            },
                            [] { return closeWindow(@"Startup Suite"); }, [] { return cancelMainDialog(); }});
    ModrigUtils::RunModrigDialog();
    EXPECT_TRUE(asked);
}

TEST_F(StartupSuiteDialog, EndsWithTheCloseButtonOfItsWindow)
{
    const ModalSteps steps({[] { [[TsOCModrigUtil getModrigController] onStartupSuits:nil]; },
                            [] { return closeWindow(@"Startup Suite"); }, [] { return cancelMainDialog(); }});
    ModrigUtils::RunModrigDialog();
    EXPECT_EQ(nil, [NSApp modalWindow]);
}

TEST_F(StartupSuiteDialog, SelectsWhatIsAddedOnceItIsFilled)
{
    gStartupList.AddTail(file("one.lsp"));
    open();
    openSuite();
    EXPECT_TRUE([rows() selectsInsertedObjects]);
    [mSuite addFiles:paths({"two.zmb"})];
    EXPECT_THAT(selectionOf(rows()), ElementsAre(file("two.zmb")));
    EXPECT_TRUE([segments() isEnabledForSegment:kRemove]);
}

TEST_F(StartupSuiteDialog, ChangesNothingWhenTheFileDialogIsCancelled)
{
    gStartupList.AddTail(file("one.lsp"));
    openSuite();
    const ModalSteps steps({[]
                            {
                                NSWindow* dialog = [NSApp modalWindow];
                                EXPECT_EQ(L"Add", wide([dialog title]));
                                [(NSOpenPanel*)dialog cancel:nil];
                            }});
    clickSegment(kAdd);
    EXPECT_THAT(rowsOf(rows()), ElementsAre(file("one.lsp")));
    EXPECT_EQ(1u, gStartupList.GetCount());
}
