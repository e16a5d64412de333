// The toolkit's tab views take clicks only.
#include "host/ui/platform/gnustep/TabKeys.h"

#include "host/platform/gnustep/StandIn.h"

namespace tessel::windowing
{
namespace
{
using KeyDown = void (*)(id, SEL, NSEvent*);
KeyDown toolkitKeyDown;

BOOL takesKeys(id, SEL)
{
    return YES;
}

NSInteger stepOf(NSEvent* event)
{
    NSString* characters = [event charactersIgnoringModifiers];
    const unichar key = [characters length] ? [characters characterAtIndex:0] : 0;
    if (key == NSRightArrowFunctionKey)
        return 1;
    return key == NSLeftArrowFunctionKey ? -1 : 0;
}

void keyDown(id tabs, SEL selector, NSEvent* event)
{
    const NSInteger step = stepOf(event);
    if (step == 0)
        return toolkitKeyDown(tabs, selector, event);
    const NSInteger index = [tabs indexOfTabViewItem:[tabs selectedTabViewItem]] + step;
    if (index >= 0 && index < [tabs numberOfTabViewItems])
        selectTab(tabs, index);
}
} // namespace

// What the selection is bound to is set, which the toolkit does for clicks only; the tabs follow it.
void selectTab(NSTabView* tabs, NSInteger index)
{
    NSDictionary* binding = [tabs infoForBinding:NSSelectedIndexBinding];
    if (!binding)
        return [tabs selectTabViewItemAtIndex:index];
    [[binding objectForKey:NSObservedObjectKey] setValue:[NSNumber numberWithInteger:index]
                                              forKeyPath:[binding objectForKey:NSObservedKeyPathKey]];
}

void letTabsHaveTheKeyboard()
{
    if (toolkitKeyDown)
        return;
    overrideIn("NSTabView", @selector(acceptsFirstResponder), takesKeys);
    toolkitKeyDown = overrideIn("NSTabView", @selector(keyDown:), keyDown);
}
} // namespace tessel::windowing
