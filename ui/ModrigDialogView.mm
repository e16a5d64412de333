#import "ui/ModrigDialogView.h"

#import "ui/ModrigController.h"
#import "ui/TsOCModrigUtil.h"

namespace
{
constexpr NSInteger kTabs = 2;

// The tab that the key stands for, or -1.
NSInteger tabOf(NSEvent* event)
{
    NSString* characters = [event charactersIgnoringModifiers];
    if (!([event modifierFlags] & NSCommandKeyMask) || [characters length] != 1)
        return -1;
    const NSInteger tab = [characters characterAtIndex:0] - '1';
    return tab < kTabs ? tab : -1;
}
} // namespace

@implementation ModrigDialogView

- (BOOL)performKeyEquivalent:(NSEvent*)event
{
    const NSInteger tab = tabOf(event);
    if (tab < 0)
        return [super performKeyEquivalent:event];
    [[TsOCModrigUtil getModrigController] setTabViewSelectedIndex:tab];
    return YES;
}

@end
