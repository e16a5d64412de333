// The toolkit's own alert says "Alert" in its title, leaves hardly any room around its text, and shows the
// program's icon for a warning. A message is shown in a panel of our own instead.
#import <AppKit/AppKit.h>

#include <algorithm>

#include "host/ui/Words.h"
#include "host/ui/platform/Windowing.h"
#include "host/ui/platform/gnustep/Keys.h"
#include "host/ui/platform/gnustep/TesselTheme.h"

using tessel::windowing::themeColor;

namespace
{
constexpr CGFloat kBoxMargin = 22;
constexpr CGFloat kIconSize = 44;
constexpr CGFloat kIconGap = 18;
constexpr CGFloat kWidestText = 440;
constexpr CGFloat kNarrowestText = 220;
constexpr CGFloat kTextHeightAllowed = 10000;
constexpr CGFloat kFieldPadding = 6; // of a field around its text
constexpr CGFloat kMessageFontSize = 13;
constexpr CGFloat kDetailFontSize = 11;
constexpr CGFloat kDetailGap = 10;
const NSSize kButtonSize = {88, 28};

NSBezierPath* triangleIn(NSRect frame)
{
    NSBezierPath* path = [NSBezierPath bezierPath];
    [path moveToPoint:NSMakePoint(NSMidX(frame), NSMaxY(frame))];
    [path lineToPoint:NSMakePoint(NSMaxX(frame), NSMinY(frame))];
    [path lineToPoint:NSMakePoint(NSMinX(frame), NSMinY(frame))];
    [path closePath];
    [path setLineJoinStyle:NSRoundLineJoinStyle];
    return path;
}
} // namespace

// The sign at the left: an exclamation mark for a warning, else an i.
@interface TsMessageSign : NSView
{
    BOOL mWarning;
}
- (id)initWithFrame:(NSRect)frame warning:(BOOL)warning;
@end

@implementation TsMessageSign

- (id)initWithFrame:(NSRect)frame warning:(BOOL)warning
{
    if ((self = [super initWithFrame:frame]))
        mWarning = warning;
    return self;
}

- (void)drawMark:(NSString*)mark centeredAt:(NSPoint)center
{
    NSDictionary* look = [NSDictionary
        dictionaryWithObjectsAndKeys:[NSFont boldSystemFontOfSize:24], NSFontAttributeName,
                                     themeColor(mWarning ? @"warningTextColor" : @"accentTextColor"),
                                     NSForegroundColorAttributeName, nil];
    const NSSize size = [mark sizeWithAttributes:look];
    [mark drawAtPoint:NSMakePoint(center.x - size.width / 2, center.y - size.height / 2) withAttributes:look];
}

- (void)drawRect:(NSRect)dirty
{
    const NSRect frame = NSInsetRect([self bounds], 4, 4);
    NSBezierPath* shape = mWarning ? triangleIn(frame) : [NSBezierPath bezierPathWithOvalInRect:frame];
    NSColor* fill = themeColor(mWarning ? @"warningColor" : @"accentColor");
    [fill set];
    [shape setLineWidth:5]; // rounds the corners
    [shape fill];
    [shape stroke];
    [self drawMark:mWarning ? @"!" : @"i"
        centeredAt:NSMakePoint(NSMidX(frame), NSMidY(frame) - (mWarning ? NSHeight(frame) / 8 : 0))];
}

@end

@interface TsMessagePanel : NSPanel
- (id)initWithText:(NSString*)text detail:(NSString*)detail warning:(BOOL)warning;
@end

@implementation TsMessagePanel

- (NSTextField*)fieldFor:(NSString*)text size:(CGFloat)fontSize
{
    NSTextField* field = [[[NSTextField alloc] initWithFrame:NSZeroRect] autorelease];
    [field setFont:[NSFont systemFontOfSize:fontSize]];
    [field setStringValue:text];
    [field setEditable:NO];
    [field setSelectable:NO];
    [field setBezeled:NO];
    [field setBordered:NO];
    [field setDrawsBackground:NO];
    [[field cell] setWraps:YES];
    const NSSize size = [[field attributedStringValue]
                            boundingRectWithSize:NSMakeSize(kWidestText - kFieldPadding, kTextHeightAllowed)
                                         options:NSStringDrawingUsesLineFragmentOrigin]
                            .size;
    [field setFrameSize:NSMakeSize(std::clamp(size.width + kFieldPadding, kNarrowestText, kWidestText),
                                   size.height + kFieldPadding)];
    return field;
}

// The text, with the detail under it, in a view as large as they are.
- (NSView*)wordsFor:(NSString*)text detail:(NSString*)detail
{
    NSView* words = [[[NSView alloc] initWithFrame:NSZeroRect] autorelease];
    NSTextField* first = [self fieldFor:text size:kMessageFontSize];
    NSSize size = [first frame].size;
    if ([detail length])
    {
        NSTextField* second = [self fieldFor:detail size:kDetailFontSize];
        [second setSelectable:YES];
        [words addSubview:second];
        [first setFrameOrigin:NSMakePoint(0, NSHeight([second frame]) + kDetailGap)];
        size.width = std::max(size.width, NSWidth([second frame]));
        size.height = NSMaxY([first frame]);
    }
    [words setFrameSize:size];
    [words addSubview:first];
    return words;
}

- (NSButton*)answerAt:(NSPoint)origin
{
    NSButton* button = [[[NSButton alloc]
        initWithFrame:NSMakeRect(origin.x, origin.y, kButtonSize.width, kButtonSize.height)] autorelease];
    [button setTitle:tessel::word(@"OK")];
    [button setFont:[NSFont systemFontOfSize:kMessageFontSize]];
    [button setBezelStyle:NSRoundedBezelStyle];
    [button setKeyEquivalent:@"\r"];
    [button setTarget:self];
    [button setAction:@selector(answer:)];
    return button;
}

- (id)initWithText:(NSString*)text detail:(NSString*)detail warning:(BOOL)warning
{
    NSView* words = [self wordsFor:text detail:detail];
    const NSSize size = [words frame].size;
    const CGFloat height = std::max(size.height, kIconSize);
    const NSRect content = NSMakeRect(0, 0, 2 * kBoxMargin + kIconSize + kIconGap + size.width,
                                      3 * kBoxMargin + kButtonSize.height + height);
    self = [super initWithContentRect:content
                            styleMask:NSTitledWindowMask | NSClosableWindowMask
                              backing:NSBackingStoreBuffered
                                defer:NO];
    if (!self)
        return nil;
    [self setTitle:@"Tessel"];
    [self setReleasedWhenClosed:NO];
    const CGFloat middle = 2 * kBoxMargin + kButtonSize.height + height / 2;
    [words setFrameOrigin:NSMakePoint(kBoxMargin + kIconSize + kIconGap, middle - size.height / 2)];
    NSRect sign = NSMakeRect(kBoxMargin, middle - kIconSize / 2, kIconSize, kIconSize);
    [[self contentView] addSubview:[[[TsMessageSign alloc] initWithFrame:sign warning:warning] autorelease]];
    [[self contentView] addSubview:words];
    NSButton* button =
        [self answerAt:NSMakePoint(NSWidth(content) - kBoxMargin - kButtonSize.width, kBoxMargin)];
    [[self contentView] addSubview:button];
    [self recalculateKeyViewLoop]; // the detail can be selected
    [self setInitialFirstResponder:button];
    return self;
}

- (void)answer:(id)sender
{
    [NSApp stopModal];
}

- (BOOL)windowShouldClose:(id)sender
{
    [self answer:sender];
    return NO;
}

- (void)keyDown:(NSEvent*)event
{
    NSString* characters = [event characters];
    if ([characters length] == 1 && [characters characterAtIndex:0] == tessel::kEscapeKey)
        [self answer:nil];
    else
        [super keyDown:event];
}

@end

void tessel::windowing::runMessage(NSString* text, NSString* detail, bool warning)
{
    TsMessagePanel* panel = [[TsMessagePanel alloc] initWithText:text detail:detail warning:warning];
    if (![NSApp modalWindow])
        [panel center];
    [NSApp runModalForWindow:panel];
    [panel orderOut:nil];
    [panel release];
}
