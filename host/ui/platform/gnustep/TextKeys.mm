// The toolkit knows these keys as equivalents of menu items only, and of the Alt key; the host has no menu.
#include "host/ui/platform/TextKeys.h"

#import <AppKit/AppKit.h>

#include "host/platform/gnustep/StandIn.h"

namespace tessel::windowing
{
namespace
{
using KeyDown = void (*)(id, SEL, NSEvent*);
using BecomeFirstResponder = BOOL (*)(id, SEL);
KeyDown toolkitTextKeyDown;
BecomeFirstResponder toolkitBecomeFirstResponder;

// The letter that is pressed together with Control and no other key; 0 for everything else.
unichar controlledLetter(NSEvent* event)
{
    constexpr unichar kLastControlCharacter = 0x1A;
    constexpr NSUInteger kOthers = NSAlternateKeyMask | NSCommandKeyMask | NSShiftKeyMask;
    NSString* characters = [event charactersIgnoringModifiers];
    const NSUInteger flags = [event modifierFlags];
    if (!(flags & NSControlKeyMask) || (flags & kOthers) || [characters length] != 1)
        return 0;
    const unichar character = [characters characterAtIndex:0];
    // Displays send either the letter or the control character that it makes.
    return character <= kLastControlCharacter ? static_cast<unichar>(character + 'a' - 1) : character;
}

SEL actionFor(unichar letter)
{
    switch (letter)
    {
    case 'a':
        return @selector(selectAll:);
    case 'c':
        return @selector(copy:);
    case 'v':
        return @selector(paste:);
    case 'x':
        return @selector(cut:);
    default:
        return nullptr;
    }
}

// All fields of a window share one editor: what was typed in another one is not to be undone in this.
BOOL becomeFirstResponder(NSTextView* text, SEL selector)
{
    [text setAllowsUndo:YES];
    [[text undoManager] removeAllActions];
    return toolkitBecomeFirstResponder(text, selector);
}

void undoIn(NSTextView* text)
{
    if ([[text undoManager] canUndo])
        [[text undoManager] undo];
    else
        NSBeep();
}

void textKeyDown(NSTextView* text, SEL selector, NSEvent* event)
{
    const unichar letter = controlledLetter(event);
    if (letter == 'z')
        return undoIn(text);
    if (const SEL action = actionFor(letter))
        [text performSelector:action withObject:nil];
    else
        toolkitTextKeyDown(text, selector, event);
}
} // namespace

void takeTextKeys()
{
    toolkitTextKeyDown = standInFor("NSTextView", @selector(keyDown:), textKeyDown);
    toolkitBecomeFirstResponder =
        standInFor("NSTextView", @selector(becomeFirstResponder), becomeFirstResponder);
}
} // namespace tessel::windowing
