#import "host/ui/platform/gnustep/filepanel/FileDrag.h"

#include <string>

#include "host/ui/Words.h"
#include "host/ui/platform/gnustep/Keys.h"
#include "host/ui/platform/gnustep/filepanel/PanelState.h"

using namespace tessel::filepanel;
using tessel::wordWith;

namespace
{
constexpr CGFloat kLabelHeight = 22;
constexpr CGFloat kLabelPadding = 8;
constexpr CGFloat kBesideMouse = 12;

NSString* labelOf(NSArray* paths)
{
    if ([paths count] == 1)
        return string(shownName(bytes([[paths objectAtIndex:0] lastPathComponent])));
    return wordWith(@"DRAGGED_FILES", string(std::to_string([paths count])));
}

NSTextField* makeText(NSString* title)
{
    NSTextField* text = [[[NSTextField alloc] initWithFrame:NSZeroRect] autorelease];
    [text setStringValue:title];
    [text setFont:[NSFont systemFontOfSize:12]];
    [text setEditable:NO];
    [text setSelectable:NO];
    [text setBezeled:NO];
    [text setBordered:YES];
    [text setBackgroundColor:[NSColor controlBackgroundColor]];
    [text sizeToFit];
    [text setFrame:NSMakeRect(0, 0, NSWidth([text frame]) + 2 * kLabelPadding, kLabelHeight)];
    [text setAlignment:NSCenterTextAlignment];
    return text;
}

NSWindow* makeDragLabel(NSString* title)
{
    NSTextField* text = makeText(title);
    NSWindow* label = [[NSWindow alloc] initWithContentRect:[text frame]
                                                  styleMask:NSBorderlessWindowMask
                                                    backing:NSBackingStoreBuffered
                                                      defer:NO];
    [label setReleasedWhenClosed:NO];
    [label setLevel:NSPopUpMenuWindowLevel];
    [label setIgnoresMouseEvents:YES];
    [[label contentView] addSubview:text];
    return label;
}

bool takesFiles(NSView* view)
{
    return [[view registeredDraggedTypes] containsObject:NSFilenamesPboardType];
}

NSView* viewThatTakesFiles(NSWindow* window, NSPoint place)
{
    NSView* view = [[window contentView] hitTest:place];
    while (view && !takesFiles(view))
        view = [view superview];
    return view;
}
} // namespace

@implementation TsFileDrag

- (id)initWithPaths:(NSArray*)paths from:(NSView*)source
{
    if (!(self = [super init]))
        return nil;
    mPaths = [paths copy];
    mSource = source;
    mLabel = makeDragLabel(labelOf(paths));
    return self;
}

- (void)dealloc
{
    [mPaths release];
    [mLabel release];
    [super dealloc];
}

- (void)leave
{
    if ([mDestination respondsToSelector:@selector(draggingExited:)])
        [mDestination draggingExited:(id)self];
    mDestination = nil;
    mOperation = NSDragOperationNone;
}

- (void)moveTo:(NSPoint)place
{
    NSWindow* window = [mSource window];
    mPlace = place;
    const NSPoint onScreen = [window convertBaseToScreen:place];
    [mLabel setFrameOrigin:NSMakePoint(onScreen.x + kBesideMouse, onScreen.y - kLabelHeight - kBesideMouse)];
    [mLabel orderFront:nil];
    [mLabel display];
    NSView* view = viewThatTakesFiles(window, place);
    if (view != mDestination)
    {
        [self leave];
        mDestination = view;
        if ([view respondsToSelector:@selector(draggingEntered:)])
            mOperation = [view draggingEntered:(id)self];
    }
    else if ([view respondsToSelector:@selector(draggingUpdated:)])
        mOperation = [view draggingUpdated:(id)self];
    [mLabel setAlphaValue:mOperation == NSDragOperationNone ? 0.5 : 1];
}

- (void)drop
{
    [mLabel orderOut:nil];
    NSView* view = mDestination;
    if (mOperation == NSDragOperationNone)
        return [self leave];
    if ([view respondsToSelector:@selector(prepareForDragOperation:)] &&
        ![view prepareForDragOperation:(id)self])
        return;
    if ([view performDragOperation:(id)self] && [view respondsToSelector:@selector(concludeDragOperation:)])
        [view concludeDragOperation:(id)self];
    [view setNeedsDisplay:YES]; // without what showed where the files would land
}

- (void)run
{
    const NSUInteger mask = NSLeftMouseUpMask | NSLeftMouseDraggedMask | NSKeyDownMask;
    for (;;)
    {
        NSEvent* event = [[mSource window] nextEventMatchingMask:mask];
        if ([event type] == NSLeftMouseUp)
            return [self drop];
        if ([event type] == NSLeftMouseDragged)
            [self moveTo:[event locationInWindow]];
        else if ([[event characters] length] && [[event characters] characterAtIndex:0] == tessel::kEscapeKey)
            break;
    }
    [mLabel orderOut:nil];
    [self leave];
}

- (id)draggingPasteboard
{
    return self;
}

- (NSPoint)draggingLocation
{
    return mPlace;
}

- (NSPoint)draggedImageLocation
{
    return mPlace;
}

- (NSImage*)draggedImage
{
    return nil;
}

- (NSWindow*)draggingDestinationWindow
{
    return [mSource window];
}

- (id)draggingSource
{
    return mSource;
}

- (NSDragOperation)draggingSourceOperationMask
{
    return NSDragOperationCopy;
}

- (NSInteger)draggingSequenceNumber
{
    return reinterpret_cast<NSInteger>(self);
}

- (NSArray*)types
{
    return [NSArray arrayWithObject:NSFilenamesPboardType];
}

- (NSString*)availableTypeFromArray:(NSArray*)types
{
    return [[self types] firstObjectCommonWithArray:types];
}

- (id)propertyListForType:(NSString*)type
{
    return [type isEqual:NSFilenamesPboardType] ? mPaths : nil;
}

@end
