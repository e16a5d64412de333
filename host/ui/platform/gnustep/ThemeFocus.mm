#include "host/ui/platform/gnustep/ThemeFocus.h"

#include "host/platform/gnustep/StandIn.h"

namespace tessel::windowing
{
namespace
{
using Change = BOOL (*)(id, SEL);
Change toolkitTableBecomes;
Change toolkitTableResigns;
Change toolkitTabsBecome;
Change toolkitTabsResign;

using End = void (*)(id, SEL, NSNotification*);
End toolkitFieldEnds;

BOOL tableBecomes(id table, SEL selector)
{
    [[table enclosingScrollView] setNeedsDisplay:YES];
    return toolkitTableBecomes(table, selector);
}

BOOL tableResigns(id table, SEL selector)
{
    [[table enclosingScrollView] setNeedsDisplay:YES];
    return toolkitTableResigns(table, selector);
}

BOOL tabsBecome(id tabs, SEL selector)
{
    [tabs setNeedsDisplay:YES];
    return toolkitTabsBecome(tabs, selector);
}

BOOL tabsResign(id tabs, SEL selector)
{
    [tabs setNeedsDisplay:YES];
    return toolkitTabsResign(tabs, selector);
}

using SetUpEditor = NSText* (*)(id, SEL, NSText*);
SetUpEditor toolkitSetUpEditor;

// The toolkit does not draw a field again when the window's editor comes to it, so that its focus would not
// show.
NSText* setUpEditor(id cell, SEL selector, NSText* editor)
{
    [[cell controlView] setNeedsDisplay:YES];
    return toolkitSetUpEditor(cell, selector, editor);
}

// Nor does it when the editor goes, and the focus would stay.
void fieldEnds(id field, SEL selector, NSNotification* end)
{
    toolkitFieldEnds(field, selector, end);
    [field setNeedsDisplay:YES];
}

// A clip view takes keys for the list in it, which gets them from its own stop.
BOOL clipStops(id, SEL)
{
    return NO;
}

// A field is edited in the window's editor, which works for it.
id ownerOfKeys(NSWindow* window)
{
    NSResponder* responder = [window firstResponder];
    if ([responder isKindOfClass:[NSText class]] && [(NSText*)responder isFieldEditor])
        return [(NSText*)responder delegate];
    return responder;
}
} // namespace

bool hasKeyboard(NSView* view)
{
    id owner = ownerOfKeys([view window]);
    if (!owner)
        return false;
    return owner == view ||
           ([view isKindOfClass:[NSScrollView class]] && owner == [(NSScrollView*)view documentView]);
}

void showWhereTheKeyboardIs()
{
    if (toolkitTableBecomes)
        return;
    toolkitTableBecomes = overrideIn("NSTableView", @selector(becomeFirstResponder), tableBecomes);
    toolkitTableResigns = overrideIn("NSTableView", @selector(resignFirstResponder), tableResigns);
    toolkitTabsBecome = overrideIn("NSTabView", @selector(becomeFirstResponder), tabsBecome);
    toolkitTabsResign = overrideIn("NSTabView", @selector(resignFirstResponder), tabsResign);
    toolkitFieldEnds = standInFor("NSTextField", @selector(textDidEndEditing:), fieldEnds);
    toolkitSetUpEditor = standInFor("NSTextFieldCell", @selector(setUpFieldEditorAttributes:), setUpEditor);
    standInFor("NSClipView", @selector(acceptsFirstResponder), clipStops);
}
} // namespace tessel::windowing
