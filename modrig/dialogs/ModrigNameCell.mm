#import "modrig/dialogs/ModrigNameCell.h"

#import "modrig/dialogs/ModrigTableView.h"

#include "modrig/dialogs/Paths.h"
#include "modrig/dialogs/model/RowLook.h"
#include "modrig/dialogs/platform/Desktop.h"

namespace
{
constexpr CGFloat kMargin = 8; // what a cell leaves free around its text
}

@implementation ModrigNameCell

- (NSString*)textIn:(CGFloat)width
{
    NSDictionary* font = [NSDictionary dictionaryWithObject:[self font] forKey:NSFontAttributeName];
    const auto fits = [=](const CStdStr& text)
    { return [ModrigUtils::StringFromPath(text) sizeWithAttributes:font].width <= width - kMargin; };
    return ModrigUtils::StringFromPath(
        ModrigUtils::Shortened(ModrigUtils::PathFromString([self stringValue]), fits));
}

- (void)drawInteriorWithFrame:(NSRect)frame inView:(NSView*)view
{
    auto* table = (ModrigTableView*)view;
    [self setTextColor:[table textColorOfRow:[table rowAtPoint:NSMakePoint(NSMidX(frame), NSMidY(frame))]]];
    if (ModrigPlatform::TablesShortenTexts())
        return [super drawInteriorWithFrame:frame inView:view];
    NSString* whole = [[[self stringValue] copy] autorelease];
    [self setStringValue:[self textIn:NSWidth(frame)]];
    [super drawInteriorWithFrame:frame inView:view];
    [self setStringValue:whole];
}

@end
