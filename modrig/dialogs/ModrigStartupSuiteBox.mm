#import "modrig/dialogs/ModrigStartupSuiteBox.h"

#import "modrig/dialogs/ModrigController.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

namespace
{
constexpr CGFloat kRingWidth = 2;
constexpr CGFloat kRingCorner = 6;

NSColor* acceptingColor()
{
    return [NSColor keyboardFocusIndicatorColor];
}
} // namespace

// Lies over the box as long as it would take what is dragged over it.
@interface ModrigDropSign : NSView
@end

@implementation ModrigDropSign

- (void)drawRect:(NSRect)dirty
{
    NSBezierPath* ring =
        [NSBezierPath bezierPathWithRoundedRect:NSInsetRect([self bounds], kRingWidth, kRingWidth)
                                        xRadius:kRingCorner
                                        yRadius:kRingCorner];
    [[acceptingColor() colorWithAlphaComponent:0.12] set];
    [ring fill];
    [acceptingColor() set];
    [ring setLineWidth:kRingWidth];
    [ring stroke];
}

// Clicks and drags go to what lies below.
- (NSView*)hitTest:(NSPoint)point
{
    return nil;
}

@end

@implementation ModrigStartupSuiteBox

- (ModrigDropSign*)dropSign
{
    NSView* last = [[[self superview] subviews] lastObject];
    return [last isKindOfClass:[ModrigDropSign class]] ? (ModrigDropSign*)last : nil;
}

- (void)showDropSign
{
    if ([self dropSign])
        return;
    ModrigDropSign* sign = [[[ModrigDropSign alloc] initWithFrame:[self frame]] autorelease];
    [sign setAutoresizingMask:[self autoresizingMask]];
    [[self superview] addSubview:sign];
    [sign setNeedsDisplay:YES];
}

- (void)hideDropSign
{
    ModrigDropSign* sign = [self dropSign];
    [sign setHidden:YES]; // what lay below it is drawn again
    [sign removeFromSuperview];
}

- (NSDragOperation)draggingEntered:(id<NSDraggingInfo>)sender
{
    const NSDragOperation operation =
        [[TsOCModrigUtil getModrigController] draggingEnteredStartupSuite:sender];
    if (operation != NSDragOperationNone)
        [self showDropSign];
    return operation;
}

- (void)draggingExited:(id<NSDraggingInfo>)sender
{
    [self hideDropSign];
}

- (BOOL)performDragOperation:(id<NSDraggingInfo>)sender
{
    [self hideDropSign];
    return [[TsOCModrigUtil getModrigController] performDragOperationToStartupSuite:sender];
}

@end
