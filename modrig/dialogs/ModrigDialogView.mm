#import "modrig/dialogs/ModrigDialogView.h"

#include <algorithm>
#include <cmath>
#include <optional>

#import "modrig/dialogs/ModrigController.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

#include "modrig/dialogs/model/ShownTab.h"
#include "modrig/dialogs/platform/Desktop.h"

namespace
{
constexpr CGFloat kSmallestHeight = 280; // a table of four rows, and the whole text of the Startup Suite box
constexpr CGFloat kGap = 6;
constexpr CGFloat kRightMargin = 14;
constexpr CGFloat kChoicePlace = 104; // in line with the panel's name field

std::optional<long> tabOf(NSEvent* event)
{
    NSString* characters = [event charactersIgnoringModifiers];
    if (!ModrigPlatform::IsForTabs(event) || [characters length] != 1)
        return std::nullopt;
    return ModrigUtils::TabForKey([characters characterAtIndex:0]);
}
} // namespace

@implementation ModrigDialogView

- (CGFloat)tsuiSmallestHeight
{
    return kSmallestHeight;
}

// The choice of file types gets what its label leaves, whose text is longer in some languages than in others.
- (void)placeFileTypes
{
    const CGFloat width = std::ceil([[fileTypesLabel cell] cellSize].width);
    NSRect label = [fileTypesLabel frame];
    NSRect choice = [fileTypesChoice frame];
    const CGFloat right = NSMaxX(choice);
    label.size.width = width;
    choice.origin.x = std::max(kChoicePlace, NSMaxX(label) + kGap);
    choice.size.width = right - NSMinX(choice);
    [fileTypesLabel setFrame:label];
    [fileTypesChoice setFrame:choice];
}

- (void)awakeFromNib
{
    [self placeFileTypes];
}

- (void)resizeSubviewsWithOldSize:(NSSize)size
{
    [super resizeSubviewsWithOldSize:size];
    [self placeFileTypes];
}

- (void)keepHelpButton:(NSButton*)button
{
    NSRect help = [button frame];
    NSRect line = [messageLine frame];
    help.origin.x = NSMaxX([self bounds]) - kRightMargin - NSWidth(help);
    line.size.width = NSMinX(help) - kGap - NSMinX(line);
    [button setFrame:help];
    [button setAutoresizingMask:NSViewMinXMargin | NSViewMaxYMargin];
    [messageLine setFrame:line];
}

- (BOOL)performKeyEquivalent:(NSEvent*)event
{
    const std::optional<long> tab = tabOf(event);
    if (!tab)
        return [super performKeyEquivalent:event];
    [[TsOCModrigUtil getModrigController] setTabViewSelectedIndex:*tab];
    return YES;
}

@end
