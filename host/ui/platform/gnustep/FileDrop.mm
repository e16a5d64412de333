// Makes file drops from other programs arrive. The toolkit's X backend announces a version of the protocol
// that other programs no longer speak, and never fetches their data; both are put right here, by standing in
// for two of its methods. Where a later backend has no such methods, nothing is changed.
#import <AppKit/AppKit.h>
#import <GNUstepGUI/GSDisplayServer.h>

#include <objc/runtime.h>

#include <tesselui/tsuieach.h>

#include "host/ui/platform/gnustep/Behaviour.h"
#include "host/ui/platform/gnustep/DisplayProbe.h"
#include "host/ui/platform/gnustep/DropSelection.h"
#include "host/ui/platform/gnustep/StandIn.h"

// The dragging pasteboard of a drag from another program, as far as a drop target asks it.
@interface TsDroppedFiles : NSObject
{
    NSArray* mPaths;
}
- (id)initWithUriList:(NSString*)uris;
@end

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
        if ([url isFileURL])
            [paths addObject:[url path]];
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
    (void)type;
    return nil;
}

- (NSString*)stringForType:(NSString*)type
{
    (void)type;
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
DragEntered toolkitDragEntered;
ResetDragTypes toolkitResetDragTypes;

// The backend's method for the entering of a drag, whose source may be another program.
void dragEntered(id view, SEL selector, void* event)
{
    toolkitDragEntered(view, selector, event);
    const Ivar variable = class_getInstanceVariable([view class], "dragPasteboard");
    if (!variable)
        return;
    const std::string uris = fetchDraggedUris();
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
    const auto device = reinterpret_cast<unsigned long>([display windowDevice:[window windowNumber]]);
    // The toolkit's own announcement has to be there first, or it would undo this one.
    completeRequests([display serverDevice]);
    announceDropTarget(device);
}

} // namespace

void acceptFileDrops()
{
    toolkitDragEntered = standInFor("XGDragView", @selector(setupDragInfoFromXEvent:), dragEntered);
    toolkitResetDragTypes = standInFor("XGServer", @selector(_resetDragTypesForWindow:), resetDragTypes);
}
} // namespace tessel::windowing
