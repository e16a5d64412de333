// Makes file drops from other programs arrive. The toolkit's X backend announces a version of the protocol
// that other programs no longer speak, and never fetches their data; both are put right here, by standing in
// for some of its methods. Where a later backend has no such methods, nothing is changed.
#import <AppKit/AppKit.h>
#import <GNUstepGUI/GSDisplayServer.h>

#include <objc/runtime.h>

#include <tesselui/tsuieach.h>
#include <wincompat/winstring.h>

#include "host/platform/gnustep/StandIn.h"
#include "host/text/Unicode.h"
#include "host/ui/platform/gnustep/Behaviour.h"
#include "host/ui/platform/gnustep/DisplayProbe.h"
#include "host/ui/platform/gnustep/DropSelection.h"
#include "host/ui/platform/gnustep/WindowDevice.h"

// The dragging pasteboard of a drag from another program, as far as a drop target asks it.
@interface TsDroppedFiles : NSObject
{
    NSArray* mPaths;
}
- (id)initWithUriList:(NSString*)uris;
@end

namespace
{
// The toolkit has no path for a name that is no text. Escapes are bytes, and so are the characters of
// Latin-1.
NSString* pathOf(NSURL* url)
{
    if ([url path])
        return [url path];
    NSString* place = [url resourceSpecifier];
    if ([place hasPrefix:@"//"]) // a name of this computer comes first
        place = [place substringFromIndex:[[url host] length] + 2];
    NSString* characters = [place stringByReplacingPercentEscapesUsingEncoding:NSISOLatin1StringEncoding];
    const char* bytes = [characters cStringUsingEncoding:NSISOLatin1StringEncoding];
    return bytes ? wcharToNSString(tessel::toWide(bytes).c_str()) : nil;
}
} // namespace

@implementation TsDroppedFiles

- (id)initWithUriList:(NSString*)uris
{
    if (!(self = [super init]))
        return nil;
    NSMutableArray* paths = [NSMutableArray array];
    for (NSString* line : tsuiEach<NSString*>(
             [uris componentsSeparatedByCharactersInSet:[NSCharacterSet newlineCharacterSet]]))
    {
        NSURL* url = [line length] ? [NSURL URLWithString:line] : nil;
        NSString* path = [url isFileURL] ? pathOf(url) : nil;
        if (path)
            [paths addObject:path];
    }
    mPaths = [paths copy];
    return self;
}

- (void)dealloc
{
    [mPaths release];
    [super dealloc];
}

- (NSArray*)types
{
    return [mPaths count] ? [NSArray arrayWithObject:NSFilenamesPboardType] : [NSArray array];
}

- (NSString*)availableTypeFromArray:(NSArray*)types
{
    return [[self types] firstObjectCommonWithArray:types];
}

- (id)propertyListForType:(NSString*)type
{
    return [[self types] containsObject:type] ? mPaths : nil;
}

- (NSData*)dataForType:(NSString*)type
{
    return nil;
}

- (NSString*)stringForType:(NSString*)type
{
    return nil;
}

- (NSString*)name
{
    return NSDragPboard;
}

- (NSInteger)changeCount
{
    return 1;
}

@end

namespace tessel::windowing
{
namespace
{
using DragEntered = void (*)(id, SEL, void*);
using ResetDragTypes = void (*)(id, SEL, id);
using SendEvent = void (*)(id, SEL, NSEvent*);
using PostDragEvent = void (*)(id, SEL, NSEvent*);
DragEntered toolkitDragEntered;
ResetDragTypes toolkitResetDragTypes;
SendEvent toolkitSendEvent;
PostDragEvent toolkitPostDragEvent;

// While what was dropped is dealt with, its source has heard that all is done.
bool gSourceIsDismissed = false;

// A window behind the one that waits for an answer takes nothing.
bool isOutOfReach(unsigned long window)
{
    NSWindow* modal = [NSApp modalWindow];
    return modal && deviceOf(modal) != window;
}

// The backend's method for the entering of a drag, whose source may be another program.
void dragEntered(id view, SEL selector, void* event)
{
    toolkitDragEntered(view, selector, event);
    const Ivar variable = class_getInstanceVariable([view class], "dragPasteboard");
    if (!variable)
        return;
    const std::string uris = isOutOfReach(windowEntered(event)) ? std::string() : fetchDraggedUris();
    id dropped = [[TsDroppedFiles alloc] initWithUriList:[NSString stringWithUTF8String:uris.c_str()]];
    [object_getIvar(view, variable) release];
    object_setIvar(view, variable, dropped);
}

// The backend's method that announces what a window accepts.
void resetDragTypes(id server, SEL selector, id window)
{
    toolkitResetDragTypes(server, selector, window);
    GSDisplayServer* display = GSServerForWindow(window);
    if (!display)
        return;
    // The toolkit's own announcement has to be there first, or it would undo this one.
    completeRequests([display serverDevice]);
    announceDropTarget(deviceOf(window));
}

bool isDragEvent(NSEvent* event, short kind)
{
    return [event type] == NSAppKitDefined && [event subtype] == kind;
}

// The answer to the source that its drop has been dealt with.
NSEvent* finishedEvent(NSEvent* drop)
{
    return [NSEvent otherEventWithType:NSAppKitDefined
                              location:[drop locationInWindow]
                         modifierFlags:0
                             timestamp:0
                          windowNumber:[drop windowNumber]
                               context:[drop context]
                               subtype:GSAppKitDraggingFinished
                                 data1:[drop data1]
                                 data2:0];
}

// The names of the files have been fetched when the drag came, and nothing else is wanted of its source. It
// is answered before the files are loaded: that may end in a message box, and a program that waits for an
// answer to its drop holds the mouse of the whole desktop.
void sendEvent(id window, SEL selector, NSEvent* event)
{
    id dragged = isDragEvent(event, GSAppKitDraggingDrop) ? [GSServerForWindow(window) dragInfo] : nil;
    if (![[dragged draggingPasteboard] isKindOfClass:[TsDroppedFiles class]])
        return toolkitSendEvent(window, selector, event);
    toolkitPostDragEvent(dragged, @selector(postDragEvent:), finishedEvent(event));
    gSourceIsDismissed = true;
    @try
    {
        toolkitSendEvent(window, selector, event);
    }
    @finally
    {
        gSourceIsDismissed = false;
    }
}

void postDragEvent(id dragged, SEL selector, NSEvent* event)
{
    if (!gSourceIsDismissed || !isDragEvent(event, GSAppKitDraggingFinished))
        toolkitPostDragEvent(dragged, selector, event);
}

} // namespace

void acceptFileDrops()
{
    toolkitDragEntered = standInFor("XGDragView", @selector(setupDragInfoFromXEvent:), dragEntered);
    toolkitSendEvent = standInFor("NSWindow", @selector(sendEvent:), sendEvent);
    toolkitPostDragEvent = standInFor("XGDragView", @selector(postDragEvent:), postDragEvent);
    toolkitResetDragTypes = standInFor("XGServer", @selector(_resetDragTypesForWindow:), resetDragTypes);
}
} // namespace tessel::windowing
