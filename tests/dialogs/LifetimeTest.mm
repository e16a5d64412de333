// How the dialogs open and close, and that nothing is left of them.
#include "tests/dialogs/support/DialogTest.h"

#include <tesselui/tsuierrors.h>

#include <algorithm>

#import <objc/runtime.h>

#include "modrig/dialogs/Paths.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/messages/ResourceOverride.h"
#include "modrig/module/DialogBridge.h"
#include "modrig/module/EntryPoint.h"

#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/ModrigStartupSuitController.h"
#import "modrig/dialogs/ModrigStartupSuiteBox.h"
#import "modrig/dialogs/NSSavePanel+ModrigRuntime.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
int gDialogsGone = 0;
int gSuitesGone = 0;
int gTextsGone = 0;
} // namespace

// A text whose end is noticed. Whoever copies it keeps it itself.
@interface CountedText : NSString
@end

@implementation CountedText

- (NSUInteger)length
{
    return 4;
}

- (unichar)characterAtIndex:(NSUInteger)index
{
    return static_cast<unichar>("/a.b"[index]);
}

- (id)copyWithZone:(NSZone*)zone
{
    return [self retain];
}

// The parts of the path are this same object: a row keeps it three times, and no other text in its place.
- (NSString*)stringByResolvingSymlinksInPath
{
    return self;
}

- (NSString*)lastPathComponent
{
    return self;
}

- (NSString*)stringByDeletingLastPathComponent
{
    return self;
}

- (void)dealloc
{
    ++gTextsGone;
    [super dealloc];
}

@end

@interface CountedDialog : ModrigController
@end

@implementation CountedDialog

- (void)dealloc
{
    ++gDialogsGone;
    [super dealloc];
}

@end

// Fails when it is open already.
@interface FailingDialog : CountedDialog
@end

@implementation FailingDialog

- (void)onInit
{
    [super onInit];
    [NSException raise:NSGenericException format:@"no more"];
}

@end

// Fails before it has read its settings.
@interface EarlyFailingDialog : CountedDialog
@end

@implementation EarlyFailingDialog

- (void)populateHistoryList
{
    [NSException raise:NSGenericException format:@"too early"];
}

@end

@interface CountedSuite : ModrigStartupSuitController
@end

@implementation CountedSuite

- (void)dealloc
{
    ++gSuitesGone;
    [super dealloc];
}

@end

// Lies in the pool that is current where it is made, and writes down when that one is drained.
@interface PoolWitness : NSObject
@end

namespace
{
std::vector<std::wstring> gOrder;
bool gShowingFails = false;

IMP gInit = nullptr;
IMP gDealloc = nullptr;

// A method's code has no type of its own in the runtime.
template <class To, class From> To asCode(From function)
{
    return reinterpret_cast<To>(reinterpret_cast<void*>(function));
}

void lieInThePool()
{
    [[[PoolWitness alloc] init] autorelease];
}

id watchedInit(id self, SEL selector)
{
    lieInThePool();
    return asCode<id (*)(id, SEL)>(gInit)(self, selector);
}

void watchedShow(id, SEL)
{
    lieInThePool();
    gOrder.push_back(L"shown");
    if (gShowingFails)
        [NSException raise:NSGenericException format:@"no %%s more"];
}

void watchedDealloc(id self, SEL selector)
{
    gOrder.push_back(L"controller gone");
    asCode<void (*)(id, SEL)>(gDealloc)(self, selector);
}

// Replaces a method of the dialog's controller as long as it lives, since the command makes its own
// controller.
class ReplacedMethod
{
public:
    template <class Function>
    ReplacedMethod(SEL selector, Function replacement)
        : mMethod(class_getInstanceMethod([ModrigController class], selector)),
          mBefore(method_setImplementation(mMethod, asCode<IMP>(replacement)))
    {
    }
    ~ReplacedMethod() { method_setImplementation(mMethod, mBefore); }
    ReplacedMethod(const ReplacedMethod&) = delete;
    ReplacedMethod& operator=(const ReplacedMethod&) = delete;

    IMP before() const { return mBefore; }

private:
    Method mMethod;
    IMP mBefore;
};

// The command with a dialog that is over at once.
class WatchedCommand
{
public:
    explicit WatchedCommand(bool fails)
    {
        gOrder.clear();
        gShowingFails = fails;
        gInit = mInit.before();
        gDealloc = mDealloc.before();
    }

private:
    const ReplacedMethod mInit { @selector(init), watchedInit };
    const ReplacedMethod mShow { @selector(showModrigDialog), watchedShow };
    const ReplacedMethod mDealloc { @selector(dealloc), watchedDealloc };
};
} // namespace

@implementation PoolWitness

- (void)dealloc
{
    gOrder.push_back(L"pool drained, texts of " + recordingHost().resources.nameOf(AfxGetResourceHandle()));
    [super dealloc];
}

@end

namespace
{
const std::wstring kSettings = L"Software\\Tessel\\R21\\Profiles\\Default\\DialogSettings\\Modrig";

void showAndRelease(void* dialog)
{
    [static_cast<ModrigController*>(dialog) showModrigDialog];
}

class Lifetime : public OpenDialogTest
{
protected:
    void SetUp() override
    {
        OpenDialogTest::SetUp();
        gDialogsGone = gSuitesGone = gTextsGone = 0;
        host().loadedModules.applicationName = L"/host/PlugIns/Modrig.bundle";
    }
    // Runs the dialog in a pool of its own, so that all that is only lent to it is gone afterwards.
    static std::wstring run(ModrigController* dialog)
    {
        NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
        const std::wstring error = wide(tsuiErrorOf(showAndRelease, dialog));
        [dialog release];
        [pool drain];
        return error;
    }
    ModrigStartupSuiteBox* box() { return [mController valueForKey:@"startupSuiteBox"]; }
};
} // namespace

TEST_F(Lifetime, OfADialogEndsWithItsRun)
{
    gLoadedAppList.AddTail(loadedModule("one.zmb"));
    gHistoryList.AddTail(file("one.zmb"));
    const ModalSteps steps({[]
                            { [[TsOCModrigUtil getModrigController] setTabViewSelectedIndex:kHistoryTab]; },
                            [] { [runningPanel() cancel:nil]; }});
    EXPECT_EQ(L"", run([[CountedDialog alloc] init]));
    EXPECT_EQ(1, gDialogsGone);
}

TEST_F(Lifetime, OfADialogThatFailsEndsAsWell)
{
    gStartupList.AddTail(file("suite.lsp"));
    gHistoryList.AddTail(file("history.lsp"));
    EXPECT_EQ(L"NSGenericException: no more", run([[FailingDialog alloc] init]));
    EXPECT_EQ(nil, [TsOCModrigUtil getModrigController]);
    EXPECT_EQ(file("suite.lsp"), host().registry.value(host().moduleKey() + L"\\Startup", L"1Startup"));
    EXPECT_EQ(file("history.lsp"), host().registry.value(host().moduleKey() + L"\\History", L"1History"));
    EXPECT_EQ(1, gDialogsGone);
}

TEST_F(Lifetime, OfADialogThatFailsBeforeItReadItsSettingsLeavesThemAlone)
{
    host().registry.setValue(kSettings, L"SaveHistory", L"1");
    host().registry.setValue(kSettings, L"LastTab", L"1");
    EXPECT_EQ(L"NSGenericException: too early", run([[EarlyFailingDialog alloc] init]));
    EXPECT_EQ(L"1", host().registry.value(kSettings, L"SaveHistory"));
    EXPECT_EQ(L"1", host().registry.value(kSettings, L"LastTab"));
    EXPECT_EQ(1, gDialogsGone);
}

TEST_F(Lifetime, OfTheStartupSuiteDialogEndsWithItsRun)
{
    gStartupList.AddTail(file("one.lsp"));
    const ModalSteps steps({[] { pressKey([NSApp modalWindow], @"\033"); }});
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    CountedSuite* suite = [[CountedSuite alloc] init];
    [suite showModalWindowCenterOfParent:nil];
    [suite release];
    [pool drain];
    EXPECT_EQ(1, gSuitesGone);
}

TEST_F(Lifetime, OfARowsTextsEndsWithTheRow)
{
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    CountedText* path = [[CountedText alloc] init];
    ModrigFilePath* row = [[ModrigFilePath alloc] initWithFilePathName:path];
    EXPECT_EQ(path, [row filePathName]);
    EXPECT_EQ(path, [row fileName]);
    EXPECT_EQ(path, [row filePath]);
    [path release];
    [pool drain];
    EXPECT_EQ(0, gTextsGone);
    pool = [[NSAutoreleasePool alloc] init];
    [row release];
    [pool drain];
    EXPECT_EQ(1, gTextsGone);
}

TEST_F(Lifetime, OfRowsIsThatOfTheArrayTheyComeIn)
{
    NSArray* rows = ModrigUtils::RowsFromPaths({CStdStr(L"/none/a.zmb"), CStdStr(L"/none/b.zmb")});
    for (NSUInteger index = 0; index < 2; ++index)
        EXPECT_EQ(1u, [[rows objectAtIndex:index] retainCount]);
}

TEST_F(Lifetime, OfWhatADialogHoldsEndsWithTheDialog)
{
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    CountedDialog* dialog = [[CountedDialog alloc] init];
    TsUIPersistentStore* store = [[dialog uiPersistentStore] retain];
    NSMutableArray* files = [[dialog selectedFiles] retain];
    CountedText* message = [[CountedText alloc] init];
    [dialog setMessage:message];
    [message release];
    EXPECT_EQ(store, [dialog uiPersistentStore]);
    [dialog release];
    [pool drain];
    EXPECT_EQ(1, gDialogsGone);
    EXPECT_EQ(1, gTextsGone);
    EXPECT_EQ(1u, [store retainCount]);
    EXPECT_EQ(1u, [files retainCount]);
    [store release];
    [files release];
}

TEST_F(Lifetime, OfTheRowsEndsWithTheDialog)
{
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    gHistoryList.AddTail(file("one.zmb"));
    open();
    [mController setSaveHistory:YES];
    load({"two.zmb"});
    NSArray* rows = [[NSArray alloc] initWithArray:[historyList() arrangedObjects]];
    close();
    [pool drain];
    ASSERT_EQ(2u, [rows count]);
    for (NSUInteger index = 0; index < [rows count]; ++index)
        EXPECT_EQ(1u, [[rows objectAtIndex:index] retainCount]) << index;
    [rows release];
}

TEST_F(Lifetime, OfTheViewIsSafeBeyondThatOfTheDialog)
{
    gHistoryList.AddTail(file("one.zmb"));
    open();
    NSTableView* loaded = [[loadedTable() retain] autorelease];
    NSTableView* history = [[historyTable() retain] autorelease];
    NSButton* help = [[[mController valueForKey:@"helpButton"] retain] autorelease];
    ASSERT_EQ(mController, [loaded delegate]);
    ASSERT_EQ(mController, [history target]);
    ASSERT_EQ(mController, [help target]);
    close();
    EXPECT_EQ(nil, [loaded delegate]);
    EXPECT_EQ(nil, [history delegate]);
    EXPECT_EQ(nil, [history dataSource]);
    EXPECT_EQ(nil, [history target]);
    EXPECT_EQ(nullptr, [history doubleAction]);
    EXPECT_EQ(nil, [help target]);
}

TEST_F(Lifetime, IsWhenTheBoxTakesDropsAndTheHistoryNever)
{
    open();
    ModrigStartupSuiteBox* suiteBox = [[box() retain] autorelease];
    EXPECT_EQ(wide(NSFilenamesPboardType), wide([[suiteBox registeredDraggedTypes] lastObject]));
    EXPECT_EQ(mController, [historyTable() dataSource]);
    EXPECT_EQ(0u, [[historyTable() registeredDraggedTypes] count]);
    close();
    EXPECT_EQ(0u, [[suiteBox registeredDraggedTypes] count]);
}

TEST_F(Lifetime, EndsWithTheStartupSuiteStoredThenTheHistoryThenTheModulesRecord)
{
    gStartupList.AddTail(file("suite.lsp"));
    gHistoryList.AddTail(file("history.lsp"));
    const ModalSteps steps({[]
                            {
                                host().journal.clear();
                                [runningPanel() cancel:nil];
                            }});
    ModrigUtils::RunModrigDialog();
    const auto calls = host().journal.entries();
    const auto callWith = [&](const wchar_t* text)
    {
        return std::ranges::find_if(calls, [&](const std::wstring& call)
                                    { return call.find(text) != std::wstring::npos; });
    };
    const auto settings = callWith(L", LastTab, ");
    const auto suite = callWith(L"suite.lsp)");
    const auto history = callWith(L"history.lsp)");
    const auto record = callWith(L"writeToRegistry(TesselModrig, ");
    EXPECT_LT(settings, suite);
    EXPECT_LT(suite, history);
    EXPECT_LT(history, record);
    ASSERT_NE(calls.end(), record);
    EXPECT_EQ(L"writeToRegistry(TesselModrig, 6, false, true)", *record);
}

TEST_F(Lifetime, OfTheCommandReleasesTheControllerThenDrainsThePoolThenGivesTheTextsBack)
{
    // The texts may be there from an earlier test.
    static_cast<void>(CTemporaryResourceOverride::SetDefaultResource(0, kResourceModuleName));
    host().resources.addModule(L"other.dll", {});
    const HMODULE other = host().resources.load(L"other.dll");
    host().resources.current = other;
    const std::wstring drained = std::wstring(L"pool drained, texts of ") + kResourceModuleName;
    for (const bool fails : {false, true})
    {
        const WatchedCommand watched(fails);
        ModrigUtils::ModrigCreate();
        EXPECT_THAT(gOrder, ElementsAre(L"shown", L"controller gone", drained, drained)) << fails;
        EXPECT_EQ(other, host().resources.current);
    }
}

TEST_F(Lifetime, OfADialogThatTheToolkitEndsIsToldInATextOfTheModule)
{
    const WatchedCommand watched(true);
    ModrigUtils::RunModrigDialog();
    EXPECT_EQ(Message(ModrigMessages::kDialogFailed, L"NSGenericException: no %s more") + L"\n",
              host().output.printed);
}
