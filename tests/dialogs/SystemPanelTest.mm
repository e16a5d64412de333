// The dialog in a panel that keeps its buttons to itself, as the system's on macOS does, and what is done for
// a panel that moves later than it is told to. The host's own panel stands for it, without its handles.
#include "tests/dialogs/support/DialogTest.h"

#include <tesselui/tsuierrors.h>
#include <tesselui/tsuifilepanel.h>

#import <objc/runtime.h>

#include "modrig/messages/MessageIds.h"
#include "modrig/module/DialogBridge.h"

#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/NSSavePanel+ModrigRuntime.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
int gHeldPaths = 0;
} // namespace

// The path of the host's folder, which is counted.
@interface CountedHostPath : NSString
@end

@implementation CountedHostPath

- (id)init
{
    ++gHeldPaths;
    return [super init];
}

- (NSUInteger)length
{
    return [[[NSBundle mainBundle] bundlePath] length];
}

- (unichar)characterAtIndex:(NSUInteger)index
{
    return [[[NSBundle mainBundle] bundlePath] characterAtIndex:index];
}

- (NSString*)stringByResolvingSymlinksInPath
{
    return self;
}

- (id)copyWithZone:(NSZone*)zone
{
    return [self retain];
}

- (void)dealloc
{
    --gHeldPaths;
    [super dealloc];
}

@end

// Tells of a new selection at once when it moves.
@interface HastyPanel : NSObject
{
@public
    ModrigController* controller;
    int heldWhenMoved;
}
@end

@implementation HastyPanel

- (NSArray*)URLs
{
    return [NSArray array];
}

- (void)setDirectory:(NSString*)folder
{
    [controller panelSelectionDidChange:self];
    [controller panel:self didChangeToDirectoryURL:[NSURL fileURLWithPath:@"/"]];
    heldWhenMoved = gHeldPaths;
}

@end

// Tells of what is chosen in it whenever it filters again.
@interface PanelThatTells : NSObject
{
@public
    ModrigController* controller;
    id chosen;
}
@end

@implementation PanelThatTells

- (NSArray*)URLs
{
    return [chosen URLs];
}

- (void)validateVisibleColumns
{
    [controller panelSelectionDidChange:self];
}

- (NSURL*)directoryURL
{
    return [NSURL fileURLWithPath:@"/"];
}

- (void)setDirectoryURL:(NSURL*)folder
{
}

@end

// Fails when it is closed.
@interface DialogThatFailsToClose : ModrigController
@end

@implementation DialogThatFailsToClose

- (void)onFinish
{
    [super onFinish];
    [NSException raise:NSGenericException format:@"not now, %%s"];
}

@end

namespace
{
NSButton* noButton(id, SEL)
{
    return nil;
}

// As long as it lives no panel has handles of its buttons. The methods are taken over by the class that
// panels have: the toolkit's runtime does not tell a class in use of what its parents get.
class PanelsWithoutHandles
{
public:
    PanelsWithoutHandles()
    {
        for (std::size_t index = 0; index < std::size(mNames); ++index)
        {
            Method inherited = class_getInstanceMethod(mClass, mNames[index]);
            mBefore[index] = method_getImplementation(inherited);
            class_addMethod(mClass, mNames[index], mBefore[index], method_getTypeEncoding(inherited));
            set(mNames[index], IMP(noButton));
        }
    }
    ~PanelsWithoutHandles()
    {
        for (std::size_t index = 0; index < std::size(mNames); ++index)
            set(mNames[index], mBefore[index]);
    }
    PanelsWithoutHandles(const PanelsWithoutHandles&) = delete;
    PanelsWithoutHandles& operator=(const PanelsWithoutHandles&) = delete;

private:
    void set(SEL name, IMP code) { method_setImplementation(class_getInstanceMethod(mClass, name), code); }

    Class mClass = [tsuiMakeFilePanel() class];
    SEL mNames[3] = {@selector(okButton), @selector(cancelButton), @selector(hideExtensionButton)};
    IMP mBefore[3] = {};
};

const std::wstring kSettingsOfPanel = L"Software\\Tessel\\R21\\Profiles\\Default\\DialogSettings\\Modrig";

void showDialog(void* dialog)
{
    [static_cast<ModrigController*>(dialog) showModrigDialog];
}

class SystemPanel : public OpenDialogTest
{
protected:
    void runIn(const std::filesystem::path& folder, std::vector<ModalStep> steps)
    {
        host().registry.setValue(kSettingsOfPanel, L"InitialPath", folder.wstring());
        runDialog(std::move(steps));
    }
    NSButton* defaultButton() { return [[mPanel contentView] viewWithTag:kTsUIFilePanelDefaultButton]; }
    BOOL enables(const std::filesystem::path& path)
    {
        return [mController panel:mPanel shouldEnableURL:[NSURL fileURLWithPath:text(path.wstring())]];
    }
    std::wstring shownFolder() { return wide([mController shownFolder]); }
    // The dialog asks that one, and not its own.
    void usePanel(id panel)
    {
        object_setIvar(mController, class_getInstanceVariable([ModrigController class], "mOpenPanel"), panel);
    }
    // Asks about one of its files, as when its button is pressed.
    BOOL asks(id panel, const char* name)
    {
        return [mController panel:panel validateURL:[NSURL fileURLWithPath:path(name)] error:nullptr];
    }
    // As the panel tells it.
    void choose(std::initializer_list<std::string> names)
    {
        [mController panelSelectionDidChange:panelWithSelected(paths(names))];
    }
    // The same, in a panel that goes on answering so until the dialog has its own again.
    void chooseForLong(std::initializer_list<std::string> names)
    {
        PanelThatTells* panel = [[[PanelThatTells alloc] init] autorelease];
        panel->controller = mController;
        panel->chosen = panelWithSelected(paths(names));
        usePanel(panel);
        choose(names);
    }
    void tellOfFolder(NSString* path)
    {
        [mController panel:mPanel didChangeToDirectoryURL:[NSURL fileURLWithPath:path]];
    }
};
} // namespace

TEST_F(SystemPanel, GetsTheTextForLoadOnItsOwnButton)
{
    const PanelsWithoutHandles panels;
    open();
    EXPECT_EQ(L"Load", wide([mPanel prompt]));
    EXPECT_FALSE([defaultButton() isHidden]);
    EXPECT_EQ(mPanel, [defaultButton() target]);
}

TEST_F(SystemPanel, LeavesTheHelpButtonInTheView)
{
    const PanelsWithoutHandles panels;
    open();
    NSView* view = [mController view];
    NSButton* help = [mController valueForKey:@"helpButton"];
    NSTextField* line = [view valueForKey:@"messageLine"];
    EXPECT_EQ(view, [help superview]);
    EXPECT_EQ(NSMaxX([view bounds]) - 14, NSMaxX([help frame]));
    EXPECT_EQ(NSMinX([help frame]) - 6, NSMaxX([line frame]));
    const NSSize size = [view frame].size;
    [view setFrameSize:NSMakeSize(size.width + 200, size.height + 50)];
    EXPECT_EQ(NSMaxX([view bounds]) - 14, NSMaxX([help frame]));
    EXPECT_EQ(NSMinX([help frame]) - 6, NSMaxX([line frame]));
    EXPECT_EQ(6, NSMinY([help frame]));
}

TEST_F(SystemPanel, LoadsWithItsOwnButtonAndStays)
{
    file("one.zmb");
    const PanelsWithoutHandles panels;
    runIn(mFolder.path(),
          {[this] { selectFilesIn(mPanel, {L"one.zmb"}); }, [this] { pressKey(mPanel, @"\r"); },
           [this] { return host().linker.isLoaded(file("one.zmb")); },
           [this] { EXPECT_TRUE([mPanel isVisible]); }});
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneLoaded, L"one.zmb")));
}

TEST_F(SystemPanel, IsRefusedEveryFileOnceThatIsLoaded)
{
    file("one.zmb");
    open();
    id panel = panelWithSelected(paths({"one.zmb"}));
    NSError* error = nil;
    EXPECT_FALSE([mController panel:panel validateURL:[NSURL fileURLWithPath:path("one.zmb")] error:&error]);
    EXPECT_TRUE(host().linker.isLoaded(file("one.zmb")));
    EXPECT_EQ(wide(NSCocoaErrorDomain), wide([error domain]));
    EXPECT_EQ(NSUserCancelledError, [error code]);
}

TEST_F(SystemPanel, LoadsAllThatIsChosenAtTheFirstOfItsQuestionsAndNothingAtTheOthers)
{
    open();
    id panel = panelWithSelected(paths({"a.lsp", "b.lsp", "c.lsp"}));
    const auto press = [=, this]
    {
        for (const char* name : {"a.lsp", "b.lsp", "c.lsp"})
            EXPECT_FALSE(asks(panel, name));
    };
    for (const char* name : {"a.lsp", "b.lsp", "c.lsp"})
        file(name);
    press();
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyLoaded, L"3")));
    press();
    EXPECT_EQ(2u, lines().size());
}

TEST_F(SystemPanel, LoadsAtEveryPressThoughItAsksNoMoreOnceItIsRefused)
{
    for (const char* name : {"a.lsp", "b.lsp"})
        file(name);
    open();
    asks(panelWithSelected(paths({"a.lsp", "b.lsp"})), "a.lsp");
    asks(panelWithSelected(paths({"a.lsp", "b.lsp"})), "a.lsp");
    EXPECT_EQ(2u, lines().size());
    asks(panelWithSelected(paths({"b.lsp"})), "b.lsp"); // though it has been waited for
    EXPECT_EQ(3u, lines().size());
}

TEST_F(SystemPanel, LoadsAnotherChoiceAlsoWhereItHasWaitedToAskAboutAFileOfIt)
{
    for (const char* name : {"a.lsp", "b.lsp", "c.lsp"})
        file(name);
    open();
    asks(panelWithSelected(paths({"a.lsp", "b.lsp"})), "a.lsp");
    choose({"b.lsp", "c.lsp"});
    asks(panelWithSelected(paths({"b.lsp", "c.lsp"})), "b.lsp");
    EXPECT_EQ(2u, lines().size());
}

TEST_F(SystemPanel, LoadsItsOwnFilesWhateverIsChosenInTheHistory)
{
    gHistoryList.AddTail(CStdStr(file("old.zmb")));
    file("one.zmb");
    open();
    select(historyTable(), {0});
    [mController panel:panelWithSelected(paths({"one.zmb"}))
           validateURL:[NSURL fileURLWithPath:path("one.zmb")]
                 error:nullptr];
    EXPECT_TRUE(host().linker.isLoaded(file("one.zmb")));
    EXPECT_FALSE(host().linker.isLoaded(file("old.zmb")));
}

TEST_F(SystemPanel, LoadsTheFileThatItAsksAboutWhenItTellsOfNone)
{
    file("one.zmb");
    open();
    [mController panel:panelWithSelected([NSArray array])
           validateURL:[NSURL fileURLWithPath:path("one.zmb")]
                 error:nullptr];
    EXPECT_TRUE(host().linker.isLoaded(file("one.zmb")));
}

TEST_F(SystemPanel, LoadsWhatWasChosenWhenItEndsWithItWhateverIsChosenInTheHistory)
{
    gHistoryList.AddTail(CStdStr(file("old.zmb")));
    file("one.zmb");
    host().registry.setValue(kSettingsOfPanel, L"InitialPath", mFolder.path().wstring());
    {
        const ModalSteps steps({[] { selectFilesIn(runningPanel(), {L"one.zmb"}); },
                                [this]
                                {
                                    ModrigController* dialog = [TsOCModrigUtil getModrigController];
                                    select([dialog valueForKey : @"historyListTableView"], { 0 });
                                },
                                [] { [NSApp stopModalWithCode:NSModalResponseOK]; }});
        ModrigUtils::RunModrigDialog();
    }
    EXPECT_TRUE(host().linker.isLoaded(file("one.zmb")));
    EXPECT_FALSE(host().linker.isLoaded(file("old.zmb")));
}

TEST_F(SystemPanel, LoadsNothingWhenItIsCancelled)
{
    file("one.zmb");
    runIn(mFolder.path(), {[this] { selectFilesIn(mPanel, {L"one.zmb"}); }});
    EXPECT_FALSE(host().linker.isLoaded(file("one.zmb")));
}

TEST_F(SystemPanel, EnablesWhatAnotherPanelShows)
{
    mFolder.write("folder/inside.txt", "");
    file("a.lsp");
    file("a.txt");
    open();
    chooseFileType(kLispFileType);
    EXPECT_TRUE(enables(mFolder / "a.lsp"));
    EXPECT_TRUE(enables(mFolder / "folder"));
    EXPECT_FALSE(enables(mFolder / "a.txt"));
    chooseFileType(kBundleFileType);
    EXPECT_FALSE(enables(mFolder / "a.lsp"));
}

TEST_F(SystemPanel, IsKnownToBeWhereItWasSentAndWhereItTells)
{
    host().registry.setValue(kSettingsOfPanel, L"InitialPath", mFolder.path().wstring());
    open();
    EXPECT_EQ(mFolder.path().wstring(), shownFolder());
    tellOfFolder(@"/");
    EXPECT_EQ(L"/", shownFolder());
    selectFiles({});
    [[mController selectedFiles]
        addObject:[[[ModrigFilePath alloc] initWithFilePathName:[[NSBundle mainBundle] bundlePath]]
                      autorelease]];
    [mController onLoad:nil];
    EXPECT_EQ(wide([[NSBundle mainBundle] bundlePath]), shownFolder());
}

TEST_F(SystemPanel, IsNotTakenAtItsWordWhenItTellsOfTheWayAround)
{
    open();
    tellOfFolder(@"/");
    // The classes of this program are at home in its own folder.
    tellOfFolder([[NSBundle bundleForClass:[ModrigController class]] bundlePath]);
    EXPECT_EQ(L"/", shownFolder());
}

TEST_F(SystemPanel, GetsAPathThatOutlivesTheRowItComesFrom)
{
    open();
    HastyPanel* panel = [[[HastyPanel alloc] init] autorelease];
    panel->controller = mController;
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    CountedHostPath* path = [[CountedHostPath alloc] init];
    ModrigFilePath* row = [[ModrigFilePath alloc] initWithFilePathName:path];
    [path release];
    [[mController selectedFiles] setArray:[NSArray arrayWithObject:row]];
    [row release];
    [pool drain];
    usePanel(panel);
    pool = [[NSAutoreleasePool alloc] init];
    const BOOL opened = [mController openTesselFolder];
    [pool drain];
    usePanel(mPanel);
    EXPECT_TRUE(opened);
    EXPECT_THAT(selectedFiles(), IsEmpty());
    EXPECT_EQ(1, panel->heldWhenMoved);
}

TEST_F(SystemPanel, HasARowForEachThatIsChosenForFoldersToo)
{
    mFolder.write("folder/inside.txt", "");
    mFolder.write("tool.bundle/tool", "");
    open();
    choose({"folder", "one.zmb", "tool.bundle"});
    EXPECT_THAT(selectedFiles(), ElementsAre(file("folder"), file("one.zmb"), file("tool.bundle")));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(SystemPanel, HasFoldersThatAreLeftOutOfALoad)
{
    mFolder.write("folder/inside.txt", "");
    mFolder.write("tool.bundle/tool", "");
    file("one.zmb");
    open();
    choose({"folder", "one.zmb", "tool.bundle"});
    [mController onLoad:nil];
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyLoaded, L"2")));
    EXPECT_THAT(rowsOf(loadedApps()), ElementsAre(file("one.zmb"), file("tool.bundle")));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(SystemPanel, SaysThatNothingIsChosenWhenAFolderIsAllThatIs)
{
    mFolder.write("folder/inside.txt", "");
    open();
    chooseForLong({"folder"});
    [mController onLoad:nil];
    usePanel(mPanel);
    EXPECT_EQ(wide([TsOCModrigUtil modrigLoadString:@"IDS_MODRIG_NOTHING_CHOSEN"]), message());
    EXPECT_THAT(boxes(), IsEmpty());
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(SystemPanel, StillHasItsFilesBesideAFolderAfterARemovalFromTheHistory)
{
    gHistoryList.AddTail(CStdStr(file("old.zmb")));
    mFolder.write("folder/inside.txt", "");
    file("one.zmb");
    open();
    select(historyTable(), {0});
    [mController onRemove:nil];
    chooseForLong({"folder", "one.zmb"});
    [[mController selectedFiles] removeAllObjects];
    [mController onLoad:nil];
    usePanel(mPanel);
    EXPECT_TRUE(host().linker.isLoaded(file("one.zmb")));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(SystemPanel, HasNoFolderThatTakesThePlaceOfTheHistoryAfterAnotherFileType)
{
    gHistoryList.AddTail(CStdStr(file("old.zmb")));
    mFolder.write("folder/inside.txt", "");
    open();
    chooseForLong({"folder"});
    select(historyTable(), {0});
    chooseFileType(kLispFileType);
    usePanel(mPanel);
    EXPECT_THAT(selectedFiles(), ElementsAre(file("old.zmb")));
}

TEST_F(SystemPanel, LoadsTheFileThatItAsksAboutWhenItTellsOfAFolder)
{
    mFolder.write("folder/inside.txt", "");
    file("one.zmb");
    open();
    [mController panel:panelWithSelected(paths({"folder"}))
           validateURL:[NSURL fileURLWithPath:path("one.zmb")]
                 error:nullptr];
    EXPECT_TRUE(host().linker.isLoaded(file("one.zmb")));
}

TEST_F(SystemPanel, LoadsNothingWhenItAsksAboutAFolder)
{
    mFolder.write("folder/inside.txt", "");
    open();
    [mController panel:panelWithSelected([NSArray array])
           validateURL:[NSURL fileURLWithPath:path("folder")]
                 error:nullptr];
    EXPECT_THAT(lines(), IsEmpty());
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(SystemPanel, IsClosedWithTheListsStoredAlsoWhenThatFails)
{
    gStartupList.AddTail(file("suite.lsp"));
    gHistoryList.AddTail(file("history.lsp"));
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    ModrigController* dialog = [[DialogThatFailsToClose alloc] init];
    const ModalSteps steps({[] { [runningPanel() cancel:nil]; }});
    EXPECT_EQ(L"NSGenericException: NSGenericException: not now, %s", wide(tsuiErrorOf(showDialog, dialog)));
    [dialog release];
    [pool drain];
    EXPECT_EQ(file("suite.lsp"), host().registry.value(host().moduleKey() + L"\\Startup", L"1Startup"));
    EXPECT_EQ(file("history.lsp"), host().registry.value(host().moduleKey() + L"\\History", L"1History"));
}
