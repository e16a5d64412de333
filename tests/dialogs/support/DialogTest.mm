#include "tests/dialogs/support/DialogTest.h"

#include <tesselui/tsuieach.h>
#include <tesselui/tsuierrors.h>
#include <tesselui/tsuifilepanel.h>
#include <wincompat/winstring.h>

#include <algorithm>
#include <cstdlib>
#include <iostream>

#include "host/text/Unicode.h"
#include "host/ui/MessageBoxAlert.h"
#include "modrig/module/DialogBridge.h"
#include "tests/dialogs/support/Events.h"

#import "modrig/dialogs/ModrigFilePath.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

namespace
{
NSArray* const kStepModes = [[NSArray alloc]
    initWithObjects:NSModalPanelRunLoopMode, NSDefaultRunLoopMode, NSEventTrackingRunLoopMode, nil];

constexpr int kMostTries = 400;

std::vector<std::wstring> pathsOf(NSArray* rows)
{
    std::vector<std::wstring> paths;
    for (NSUInteger index = 0; index < [rows count]; ++index)
        paths.push_back(wide([[rows objectAtIndex:index] filePathName]));
    return paths;
}

struct OpeningDialog
{
    ModrigController* controller;
    NSOpenPanel* panel;
};

void setUp(void* opening)
{
    [static_cast<OpeningDialog*>(opening)->controller
        setupOpenPanel:static_cast<OpeningDialog*>(opening)->panel];
}
} // namespace

std::wstring wide(NSString* text)
{
    return NSStringToWstring(text);
}

NSString* text(const std::wstring& wide)
{
    return wcharToNSString(wide.c_str());
}

std::vector<std::wstring> rowsOf(NSArrayController* rows)
{
    return pathsOf([rows arrangedObjects]);
}

std::vector<std::wstring> selectionOf(NSArrayController* rows)
{
    return pathsOf([rows selectedObjects]);
}

void DialogTest::SetUp()
{
    ModuleTest::SetUp();
    mPool = [[NSAutoreleasePool alloc] init];
    host().files.useRealFileSystem();
}

void DialogTest::TearDown()
{
    EXPECT_EQ(nil, [TsOCModrigUtil getModrigController]) << "a dialog is still open";
    [mPool drain];
    ModuleTest::TearDown();
}

std::wstring DialogTest::file(const std::string& name)
{
    const auto file = mFolder / name;
    if (!std::filesystem::exists(file))
        mFolder.write(name, "");
    return tessel::toWide(file.string());
}

NSString* DialogTest::path(const std::string& name)
{
    return text(file(name));
}

NSArray* DialogTest::paths(std::initializer_list<std::string> names)
{
    NSMutableArray* paths = [NSMutableArray array];
    for (const std::string& name : names)
        [paths addObject:path(name)];
    return paths;
}

std::wstring DialogTest::loadedModule(const std::string& name)
{
    const std::wstring path = file(name);
    host().linker.setLoaded(path);
    return path;
}

void DialogTest::fill(CStringList& list, std::initializer_list<std::string> names)
{
    for (const std::string& name : names)
        list.AddTail(CStdStr(file(name)));
}

void DialogTest::fillWithMany(CStringList& list)
{
    for (int index = 0; index < kMany; ++index)
        fill(list, {"tool" + std::to_string(index) + ".lsp"});
}

void OpenDialogTest::open()
{
    openWith([[ModrigController alloc] init]);
}

void OpenDialogTest::openWith(ModrigController* controller)
{
    mController = controller;
    mPanel = [tsuiMakeFilePanel() retain];
    OpeningDialog opening = {mController, mPanel};
    if (NSString* error = tsuiErrorOf(setUp, &opening))
        FAIL() << [error UTF8String];
}

void OpenDialogTest::close()
{
    if (!mController)
        return;
    [mPanel orderOut:nil]; // a test may have shown it
    [mController cleanOpenPanel:mPanel];
    [mController release];
    mController = nil;
    [mPanel release];
    mPanel = nil;
}

void OpenDialogTest::show()
{
    [mPanel makeKeyAndOrderFront:nil];
    static_cast<void>([mPanel filenames]); // who asks what is chosen has the folder listed first
    events::pump();
}

void OpenDialogTest::openHistory(std::initializer_list<std::string> names)
{
    fill(gHistoryList, names);
    open();
    [mController setTabViewSelectedIndex:kHistoryTab];
    show();
}

void OpenDialogTest::runDialog(std::vector<ModalStep> steps)
{
    steps.insert(steps.begin(), ModalStep(
                                    [this]
                                    {
                                        mController = [[TsOCModrigUtil getModrigController] retain];
                                        mPanel = runningPanel();
                                    }));
    steps.push_back(ModalStep([this] { [mPanel cancel:nil]; }));
    {
        const ModalSteps running(std::move(steps));
        ModrigUtils::RunModrigDialog();
    }
    [mController release];
    mController = nil;
    mPanel = nil;
}

void OpenDialogTest::TearDown()
{
    close();
    DialogTest::TearDown();
}

std::vector<std::wstring> OpenDialogTest::selectedFiles()
{
    return pathsOf([mController selectedFiles]);
}

void OpenDialogTest::select(NSTableView* table, std::initializer_list<NSUInteger> rows)
{
    NSMutableIndexSet* indexes = [NSMutableIndexSet indexSet];
    for (const NSUInteger row : rows)
        [indexes addIndex:row];
    [table selectRowIndexes:indexes byExtendingSelection:NO];
}

void OpenDialogTest::selectFiles(std::initializer_list<std::string> names)
{
    NSMutableArray* files = [NSMutableArray array];
    for (const std::string& name : names)
        [files addObject:[[[ModrigFilePath alloc] initWithFilePathName:path(name)] autorelease]];
    [[mController selectedFiles] setArray:files];
}

void OpenDialogTest::load(std::initializer_list<std::string> names)
{
    selectFiles(names);
    [mController onLoad:nil];
}

void OpenDialogTest::chooseFileType(NSUInteger place)
{
    [fileTypes() setSelectionIndex:place];
    [mController onFileTypesChanged:fileTypes()];
}

void OpenDialogTest::lookAtMessageBox(const wchar_t* text, const wchar_t* detail,
                                      std::function<void(NSView* box)> look)
{
    const ModalSteps steps({[=] { tsuiShowMessageBox(text, detail, 0, nullptr); },
                            [=, this]
                            {
                                EXPECT_NE(mPanel, [NSApp modalWindow]);
                                look([[NSApp modalWindow] contentView]);
                                [NSApp stopModal];
                            },
                            // The box's run has to be over before its window's can end.
                            [this]
                            {
                                if ([NSApp modalWindow] != mPanel)
                                    return false;
                                [NSApp stopModal];
                                return true;
                            }});
    [NSApp runModalForWindow:mPanel];
}

@interface StepRunner : NSObject
{
@public
    const std::vector<ModalStep>* steps;
    std::size_t next;
    int tries;
}
- (void)schedule;
@end

@implementation StepRunner

- (void)schedule
{
    [NSObject cancelPreviousPerformRequestsWithTarget:self];
    [self performSelector:@selector(runStep) withObject:nil afterDelay:0.05 inModes:kStepModes];
}

- (void)giveUp
{
    std::cerr << "Step " << next << " of a modal run never got ready.\n";
    std::_Exit(EXIT_FAILURE);
}

// A modal loop looks whether it is over only when an event has come, and a step is none.
- (void)wakeLoop
{
    [NSApp postEvent:[NSEvent otherEventWithType:NSApplicationDefined
                                        location:NSZeroPoint
                                   modifierFlags:0
                                       timestamp:0
                                    windowNumber:0
                                         context:nil
                                         subtype:0
                                           data1:0
                                           data2:0]
             atStart:NO];
}

- (void)runStep
{
    if (next >= steps->size())
        return;
    const std::size_t step = next++;
    if (++tries > kMostTries)
        [self giveUp];
    // Scheduled first: a step may open another modal run, which goes on with the steps after it. And once
    // more: a step that lets the loop go on, as a click does, may have used that up, and the event alone
    // wakes nobody.
    [self schedule];
    if (!(*steps)[step].run())
        next = step;
    else
        tries = 0;
    [self schedule];
    [self wakeLoop];
}

@end

ModalSteps::ModalSteps(std::vector<ModalStep> steps) : mSteps(std::move(steps))
{
    StepRunner* runner = [[StepRunner alloc] init];
    runner->steps = &mSteps;
    [runner schedule];
    mRunner = runner;
}

ModalSteps::~ModalSteps()
{
    StepRunner* runner = mRunner;
    EXPECT_EQ(mSteps.size(), runner->next) << "the modal run ended before all steps were done";
    [NSObject cancelPreviousPerformRequestsWithTarget:runner];
    [runner release];
}

NSOpenPanel* runningPanel()
{
    return [[TsOCModrigUtil getModrigController] valueForKey:@"mOpenPanel"];
}

namespace
{
// The first view of that class that is not in the panel's accessory view.
NSView* partOf(NSView* view, Class wanted, NSView* accessory)
{
    if ([view isKindOfClass:wanted])
        return view;
    for (NSView* inner : tsuiEach<NSView*>([view subviews]))
        if (inner != accessory)
            if (NSView* found = partOf(inner, wanted, accessory))
                return found;
    return nil;
}

bool isEditable(NSView* view)
{
    return [view isKindOfClass:[NSTextField class]] && [(NSTextField*)view isEditable];
}

NSView* editableIn(NSView* view, NSView* accessory)
{
    if (isEditable(view))
        return view;
    for (NSView* inner : tsuiEach<NSView*>([view subviews]))
        if (inner != accessory)
            if (NSView* found = editableIn(inner, accessory))
                return found;
    return nil;
}
} // namespace

NSTableView* fileTable(NSOpenPanel* panel)
{
    return (NSTableView*)partOf([panel contentView], [NSTableView class], [panel accessoryView]);
}

NSTextField* nameField(NSOpenPanel* panel)
{
    return (NSTextField*)editableIn([panel contentView], [panel accessoryView]);
}

std::vector<std::wstring> filesShownIn(NSOpenPanel* panel)
{
    std::vector<std::wstring> names;
    NSTableView* table = fileTable(panel);
    NSTableColumn* column = [[table tableColumns] objectAtIndex:0];
    for (NSInteger row = 0; row < [table numberOfRows]; ++row)
        names.push_back(wide([[table dataSource] tableView:table objectValueForTableColumn:column row:row]));
    return names;
}

void selectFilesIn(NSOpenPanel* panel, std::initializer_list<const wchar_t*> names)
{
    const auto shown = filesShownIn(panel);
    NSMutableIndexSet* rows = [NSMutableIndexSet indexSet];
    for (const wchar_t* name : names)
    {
        const auto found = std::ranges::find(shown, name);
        if (found == shown.end())
            ADD_FAILURE() << "not shown: " << tessel::toUtf8(name);
        else
            [rows addIndex:static_cast<NSUInteger>(found - shown.begin())];
    }
    [panel makeFirstResponder:fileTable(panel)];
    [fileTable(panel) selectRowIndexes:rows byExtendingSelection:NO];
}

void typeNameInto(NSOpenPanel* panel, NSString* name)
{
    [panel makeFirstResponder:nil];
    [nameField(panel) selectText:nil];
    [(NSTextView*)[nameField(panel) currentEditor] insertText:name];
}

void clickRow(NSTableView* table, NSInteger row, NSUInteger modifiers, NSInteger clicks)
{
    events::postClick(table, events::placeOnRow(table, row), static_cast<unsigned>(modifiers),
                      static_cast<int>(clicks));
}

void pressKey(NSWindow* window, NSString* characters, NSUInteger modifiers)
{
    events::postKey(window, characters, static_cast<unsigned>(modifiers));
}

// What stands for something of the toolkit's that has files.
@interface HoldsFiles : NSObject
{
    NSArray* mPaths;
}
- (id)initWithPaths:(NSArray*)paths;
@end

@implementation HoldsFiles

- (id)initWithPaths:(NSArray*)paths
{
    if ((self = [super init]))
        mPaths = [paths copy];
    return self;
}

- (void)dealloc
{
    [mPaths release];
    [super dealloc];
}

@end

// What a panel answers about its selection.
@interface ChoosingPanel : HoldsFiles
@end

@implementation ChoosingPanel

- (NSArray*)URLs
{
    NSMutableArray* urls = [NSMutableArray array];
    for (NSString* path : tsuiEach<NSString*>(mPaths))
        [urls addObject:[NSURL fileURLWithPath:path]];
    return urls;
}

@end

// Stands for the pasteboard and the drag itself; answers what the drop targets ask.
@interface FileDrag : HoldsFiles
{
    NSPoint mPlace;
}
- (void)setPlace:(NSPoint)place;
@end

@implementation FileDrag

- (void)setPlace:(NSPoint)place
{
    mPlace = place;
}

- (NSDragOperation)draggingSourceOperationMask
{
    return NSDragOperationCopy;
}

- (id)draggingSource
{
    return nil; // another program
}

- (NSPoint)draggingLocation
{
    return mPlace;
}

- (id)draggingPasteboard
{
    return self;
}

- (NSArray*)types
{
    return mPaths ? [NSArray arrayWithObject:NSFilenamesPboardType] : [NSArray array];
}

- (id)propertyListForType:(NSString*)type
{
    return [type isEqual:NSFilenamesPboardType] ? mPaths : nil;
}

@end

id panelWithSelected(NSArray* paths)
{
    return [[[ChoosingPanel alloc] initWithPaths:paths] autorelease];
}

id<NSDraggingInfo> dragOver(NSView* view, NSPoint place, NSArray* paths)
{
    FileDrag* drag = [[[FileDrag alloc] initWithPaths:paths] autorelease];
    [drag setPlace:[view convertPoint:place toView:nil]];
    return (id<NSDraggingInfo>)drag;
}

id<NSDraggingInfo> dragOf(NSArray* paths)
{
    return (id<NSDraggingInfo>)[[[FileDrag alloc] initWithPaths:paths] autorelease];
}
