#include "bench/ShownWindow.h"

#import <AppKit/AppKit.h>
#import <GNUstepGUI/GSDisplayServer.h>

#include <X11/Xlib.h>

#include "bench/PeerWindow.h"
#include "bench/ProcessorTime.h"
#include "modrig/dialogs/Paths.h"
#include "modrig/dialogs/TableRows.h"
#include "modrig/lists/ListMembership.h"
#include "modrig/module/DialogBridge.h"

#import "modrig/dialogs/ModrigArrayController.h"

namespace
{
bool isMapped(Display* display, NSWindow* window)
{
    const auto device = reinterpret_cast<Window>(
        [GSServerForWindow(window) windowDevice:static_cast<int>([window windowNumber])]);
    XWindowAttributes attributes = {};
    return XGetWindowAttributes(display, device, &attributes) && attributes.map_state == IsViewable;
}

// The display answers when it has done what came before, and what it has to tell is then there to be read.
bool isShown(NSWindow* window)
{
    if (!window || ![window isVisible] || [window viewsNeedDisplay])
        return false;
    auto* display = static_cast<Display*>([GSServerForWindow(window) serverDevice]);
    if (!isMapped(display, window))
        return false;
    XSync(display, False);
    return XEventsQueued(display, QueuedAfterReading) == 0;
}
} // namespace

// Looks whenever the dialog's loop has nothing else to do, until the window is shown.
@interface WindowWatcher : NSObject
{
@public
    pid_t display;
    double shown; // in processor time; 0 until then
}
- (void)lookAgain;
@end

@implementation WindowWatcher

- (void)lookAgain
{
    [self performSelector:@selector(look)
               withObject:nil
               afterDelay:0.001
                  inModes:[NSArray arrayWithObject:NSModalPanelRunLoopMode]];
}

- (void)look
{
    NSWindow* window = [NSApp modalWindow];
    if (!isShown(window))
        return [self lookAgain];
    shown = bench::processorSeconds(display);
    [(NSOpenPanel*)window cancel:nil];
}

@end

// What the table asks, as it asks the dialog's controller.
@interface ListSource : NSObject
{
@public
    NSArrayController* rows;
}
@end

@implementation ListSource

- (NSInteger)numberOfRowsInTableView:(NSTableView*)table
{
    return static_cast<NSInteger>([[rows arrangedObjects] count]);
}

- (id)tableView:(NSTableView*)table objectValueForTableColumn:(NSTableColumn*)column row:(NSInteger)row
{
    return ModrigUtils::ValueInRow(rows, column, row);
}

@end

namespace
{
const NSRect kFrame = {{100, 100}, {bench::kPeerWidth, bench::kPeerHeight}};

NSWindow* windowWith(NSView* view)
{
    NSWindow* window = [[[NSWindow alloc] initWithContentRect:kFrame
                                                    styleMask:NSTitledWindowMask
                                                      backing:NSBackingStoreBuffered
                                                        defer:YES] autorelease];
    [window setReleasedWhenClosed:NO];
    NSScrollView* scrolled = [[[NSScrollView alloc] initWithFrame:[[window contentView] bounds]] autorelease];
    [scrolled setHasVerticalScroller:YES];
    [scrolled setDocumentView:view];
    [[window contentView] addSubview:scrolled];
    return window;
}

NSTableView* tableOf(ListSource* source)
{
    NSTableView* table = [[[NSTableView alloc] initWithFrame:kFrame] autorelease];
    NSTableColumn* column = [[[NSTableColumn alloc] initWithIdentifier:@"filePathName"] autorelease];
    [column setWidth:bench::kPeerWidth];
    [table addTableColumn:column];
    [table setDataSource:(id)source];
    return table;
}

void waitUntilShown(NSWindow* window)
{
    [window orderFront:nil];
    while (!isShown(window))
        [NSApp sendEvent:[NSApp nextEventMatchingMask:NSAnyEventMask
                                            untilDate:[NSDate dateWithTimeIntervalSinceNow:0.001]
                                               inMode:NSDefaultRunLoopMode
                                              dequeue:YES]];
}
} // namespace

namespace bench
{
double secondsUntilListShown(pid_t display)
{
    const double start = processorSeconds(display);
    ListSource* source = [[[ListSource alloc] init] autorelease];
    ModrigArrayController* rows =
        [[[ModrigArrayController alloc] initWithContent:[NSMutableArray array]] autorelease];
    source->rows = rows;
    NSTableView* table = tableOf(source);
    [rows setTable:table];
    ModrigUtils::FillTable(rows, ModrigUtils::HistoryFiles());
    NSWindow* window = windowWith(table);
    waitUntilShown(window);
    const double seconds = processorSeconds(display) - start;
    const bool all = static_cast<std::size_t>([table numberOfRows]) == ModrigUtils::HistoryFiles().GetCount();
    [window orderOut:nil];
    [table setDataSource:nil];
    return all ? seconds : -1;
}

double secondsUntilShown(pid_t display)
{
    WindowWatcher* watcher = [[[WindowWatcher alloc] init] autorelease];
    watcher->display = display;
    [watcher lookAgain];
    const double start = processorSeconds(display);
    ModrigUtils::RunModrigDialog();
    return watcher->shown > 0 ? watcher->shown - start : -1;
}
} // namespace bench
