#import "host/ui/platform/gnustep/filepanel/PathBar.h"

#include <algorithm>

#include <tesselui/tsuieach.h>

#include "host/ui/platform/gnustep/filepanel/Folders.h"
#include "host/ui/platform/gnustep/filepanel/PanelState.h"

using namespace tessel::filepanel;

namespace
{
constexpr CGFloat kStepFontSize = 12;
constexpr CGFloat kPadding = 20; // a button beyond its title
constexpr CGFloat kSmallest = 30;
constexpr CGFloat kWidest = 180;
constexpr CGFloat kGap = 2;

NSButton* makeStep(const Step& step, bool isShown)
{
    NSButton* button = [[[NSButton alloc] initWithFrame:NSZeroRect] autorelease];
    NSFont* font =
        isShown ? [NSFont boldSystemFontOfSize:kStepFontSize] : [NSFont systemFontOfSize:kStepFontSize];
    NSString* title = string(shownName(step.title));
    [button setTitle:title];
    [button setFont:font];
    [button setBezelStyle:NSRoundedBezelStyle];
    [[button cell] setLineBreakMode:NSLineBreakByTruncatingMiddle];
    [[button cell] setRepresentedObject:string(step.path)];
    [button setToolTip:string(shownName(step.path))];
    [button setRefusesFirstResponder:YES]; // unless it is the one of them that the Tab key comes to
    const CGFloat width =
        [title sizeWithAttributes:[NSDictionary dictionaryWithObject:font forKey:NSFontAttributeName]].width;
    [button setFrameSize:NSMakeSize(std::clamp(width + kPadding, kSmallest, kWidest), 26)];
    return button;
}
} // namespace

@implementation TsPathBar

- (void)dealloc
{
    [mFolder release];
    [super dealloc];
}

- (void)setTarget:(id)target action:(SEL)action
{
    mTarget = target;
    mAction = action;
}

- (void)placeFrom:(std::size_t)first
{
    CGFloat left = 0;
    NSArray* buttons = [self subviews];
    for (NSUInteger index = 0; index < [buttons count]; ++index)
    {
        NSButton* button = [buttons objectAtIndex:index];
        [button setHidden:index < first];
        [button setFrameOrigin:NSMakePoint(left, 0)];
        left += index < first ? 0 : NSWidth([button frame]) + kGap;
    }
    [self setNeedsDisplay:YES];
}

- (void)placeButtons
{
    std::vector<double> widths;
    NSArray* buttons = [self subviews];
    for (NSUInteger index = 0; index < [buttons count]; ++index)
        widths.push_back(NSWidth([[buttons objectAtIndex:index] frame]) + kGap);
    [self placeFrom:stepsThatDoNotFit(widths, NSWidth([self bounds]))];
}

// The bar is one stop of the Tab key: this button of it.
- (void)stopAt:(NSButton*)stop
{
    for (NSButton* button : tsuiEach<NSButton*>([self subviews]))
        [button setRefusesFirstResponder:button != stop];
}

- (BOOL)hasKeyboard
{
    NSResponder* responder = [[self window] firstResponder];
    return [responder isKindOfClass:[NSView class]] && [(NSView*)responder isDescendantOf:self];
}

- (void)showFolder:(NSString*)folder
{
    if ([folder isEqual:mFolder])
        return;
    [mFolder release];
    mFolder = [folder copy];
    const bool hadKeyboard = [self hasKeyboard];
    while ([[self subviews] count])
        [[[self subviews] lastObject] removeFromSuperview];
    const std::vector<Step> steps = wayTo(bytes(folder));
    for (const Step& step : steps)
    {
        NSButton* button = makeStep(step, &step == &steps.back());
        [button setTarget:mTarget];
        [button setAction:mAction];
        [self addSubview:button];
    }
    [self placeButtons];
    [self stopAt:[[self subviews] lastObject]];
    [[self window] recalculateKeyViewLoop];
    if (hadKeyboard)
        [[self window] makeFirstResponder:[[self subviews] lastObject]];
}

// The arrows lead from one button to the next.
- (void)keyDown:(NSEvent*)event
{
    NSString* characters = [event charactersIgnoringModifiers];
    const unichar key = [characters length] ? [characters characterAtIndex:0] : 0;
    if ((key != NSLeftArrowFunctionKey && key != NSRightArrowFunctionKey) || ![self hasKeyboard])
        return [super keyDown:event];
    NSArray* buttons = [self subviews];
    const auto here = static_cast<NSInteger>([buttons indexOfObject:[[self window] firstResponder]]);
    const NSInteger next = here + (key == NSRightArrowFunctionKey ? 1 : -1);
    if (next < 0 || next >= static_cast<NSInteger>([buttons count]))
        return;
    NSButton* button = [buttons objectAtIndex:static_cast<NSUInteger>(next)];
    if ([button isHidden])
        return;
    [self stopAt:button];
    [[self window] makeFirstResponder:button];
}

- (void)setFrameSize:(NSSize)size
{
    [super setFrameSize:size];
    [self placeButtons];
}

@end
