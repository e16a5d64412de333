#include "modrig/dialogs/platform/Desktop.h"

namespace ModrigPlatform
{
namespace
{
// A key that takes the place of another.
NSUInteger exchanged(NSUInteger flags, NSUInteger one, NSUInteger other)
{
    const NSUInteger rest = flags & ~(one | other);
    return rest | (flags & one ? other : 0) | (flags & other ? one : 0);
}
} // namespace

bool IsCommand(NSEvent* event)
{
    return [event modifierFlags] & NSControlKeyMask;
}

// The toolkit takes the left Alt key for its command key.
bool IsAlternate(NSEvent* event)
{
    return [event modifierFlags] & (NSAlternateKeyMask | NSCommandKeyMask);
}

bool IsForTabs(NSEvent* event)
{
    return [event modifierFlags] & NSCommandKeyMask;
}

// Its tables take a range with Control and single rows with Shift: the other way round.
NSEvent* ClickOnTable(NSEvent* event)
{
    return [NSEvent mouseEventWithType:[event type]
                              location:[event locationInWindow]
                         modifierFlags:exchanged([event modifierFlags], NSShiftKeyMask, NSControlKeyMask)
                             timestamp:[event timestamp]
                          windowNumber:[event windowNumber]
                               context:[event context]
                           eventNumber:[event eventNumber]
                            clickCount:[event clickCount]
                              pressure:[event pressure]];
}

// The desktop's own choice of a program; it gets the folder, since not every one can point at a file.
void ShowInFolder(NSString* path)
{
    NSArray* arguments =
        [NSArray arrayWithObjects:@"xdg-open", [path stringByDeletingLastPathComponent], nil];
    [NSTask launchedTaskWithLaunchPath:@"/usr/bin/env" arguments:arguments];
}

bool TablesShortenTexts()
{
    return false;
}
} // namespace ModrigPlatform
