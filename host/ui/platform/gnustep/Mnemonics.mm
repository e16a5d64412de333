// The toolkit knows mnemonics in menus of one platform only. Here every control has one that has a text. The
// letters are chosen again whenever they are asked for, so that they fit the words of any language; the
// controls of a window are few.
#include "host/ui/platform/gnustep/Mnemonics.h"

#include <algorithm>
#include <optional>
#include <vector>

#include <tesselui/tsuieach.h>
#include <wincompat/winstring.h>

#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/MnemonicLetters.h"
#include "host/ui/platform/gnustep/TabKeys.h"
#import "host/ui/platform/gnustep/filepanel/PathBar.h"

namespace tessel::windowing
{
namespace
{
// What has a text of its own: a button, a label beside what it names, one of the tabs of a view.
struct Holder
{
    id object = nil;
    NSString* text = nil;
    NSTabView* tabs = nil;            // of a tab
    std::optional<std::size_t> place; // of its letter
};
using Holders = std::vector<Holder>;

bool isLabel(NSView* view)
{
    return [view isKindOfClass:[NSTextField class]] && ![(NSTextField*)view isEditable] &&
           [[(NSTextField*)view stringValue] hasSuffix:@":"];
}

bool takesChoice(NSView* view)
{
    return [view isKindOfClass:[NSPopUpButton class]] ||
           ([view isKindOfClass:[NSTextField class]] && [(NSTextField*)view isEditable]);
}

// What the label stands before: the control that begins nearest to its right edge, in its row.
NSView* namedBy(NSTextField* label)
{
    NSView* nearest = nil;
    const NSRect frame = [label frame];
    for (NSView* view : tsuiEach<NSView*>([[label superview] subviews]))
        if (takesChoice(view) && NSMinX([view frame]) > NSMinX(frame) &&
            NSMinY([view frame]) < NSMidY(frame) && NSMidY(frame) < NSMaxY([view frame]) &&
            (!nearest || NSMinX([view frame]) < NSMinX([nearest frame])))
            nearest = view;
    return nearest;
}

// A pop-up button whose title is what is chosen is named by its label.
bool hasOwnText(NSView* view)
{
    if (![view isKindOfClass:[NSButton class]])
        return isLabel(view);
    return ![view isKindOfClass:[NSPopUpButton class]] || [(NSPopUpButton*)view pullsDown];
}

NSString* textOf(NSView* view)
{
    return isLabel(view) ? [(NSTextField*)view stringValue] : [(NSButton*)view title];
}

// Names of folders are not the window's to underline, and lists have keys of their own.
bool isClosed(NSView* view)
{
    return [view isKindOfClass:[NSScrollView class]] || [view isKindOfClass:[TsPathBar class]];
}

// What a window holds, apart from the tab that shows, whose letters are chosen last: those of the others stay
// when another shows.
struct Parts
{
    Holders lasting;
    Holders ofTab;
};

void addTabs(NSTabView* tabs, Holders& holders)
{
    for (NSTabViewItem* item : tsuiEach<NSTabViewItem*>([tabs tabViewItems]))
        holders.push_back({item, [item label], tabs, std::nullopt});
}

void addHolders(NSView* view, Holders& holders, Parts& parts)
{
    if ([view isHidden] || isClosed(view))
        return;
    const bool hasTabs = [view isKindOfClass:[NSTabView class]];
    if (hasTabs)
        addTabs((NSTabView*)view, holders);
    else if (hasOwnText(view))
        holders.push_back({view, textOf(view), nil, std::nullopt});
    for (NSView* part : tsuiEach<NSView*>([view subviews]))
        addHolders(part, hasTabs ? parts.ofTab : holders, parts);
}

std::vector<std::wstring> textsOf(const Holders& holders)
{
    std::vector<std::wstring> texts;
    for (const Holder& holder : holders)
        texts.push_back(NSStringToWstring(holder.text));
    return texts;
}

// Gives them their letters; answers which these are.
std::wstring choose(Holders& holders, const std::wstring& taken)
{
    const auto texts = textsOf(holders);
    const MnemonicPlaces places = chooseMnemonics(texts, taken);
    std::wstring letters;
    for (std::size_t index = 0; index < holders.size(); ++index)
    {
        holders[index].place = places[index];
        if (places[index])
            letters += texts[index][*places[index]];
    }
    return letters;
}

Holders holdersIn(NSWindow* window)
{
    Parts parts;
    addHolders([window contentView], parts.lasting, parts);
    choose(parts.ofTab, choose(parts.lasting, {}));
    Holders all = parts.lasting;
    all.insert(all.end(), parts.ofTab.begin(), parts.ofTab.end());
    return all;
}

std::optional<std::size_t> placeOf(id object, NSWindow* window)
{
    const Holders holders = holdersIn(window);
    const auto found =
        std::ranges::find_if(holders, [=](const Holder& holder) { return holder.object == object; });
    return found == holders.end() ? std::nullopt : found->place;
}

// A text that is cut, or is not that of the control any more, has its letter elsewhere.
NSAttributedString* underlined(NSAttributedString* text, std::optional<std::size_t> place)
{
    if (!place || *place >= [text length])
        return text;
    NSMutableAttributedString* result = [[text mutableCopy] autorelease];
    [result addAttribute:NSUnderlineStyleAttributeName
                   value:[NSNumber numberWithInteger:NSUnderlineStyleSingle]
                   range:NSMakeRange(*place, 1)];
    return result;
}

void use(NSView* control)
{
    [[control window] makeFirstResponder:control];
    if ([control isKindOfClass:[NSTextField class]])
        [(NSTextField*)control selectText:nil];
    else if (![control isKindOfClass:[NSPopUpButton class]])
        [(NSButton*)control performClick:nil];
}

bool isEnabled(NSView* control)
{
    return
        [control window] && (![control isKindOfClass:[NSControl class]] || [(NSControl*)control isEnabled]);
}

void use(const Holder& holder)
{
    if (holder.tabs)
        return selectTab(holder.tabs, [holder.tabs indexOfTabViewItem:holder.object]);
    NSView* control = isLabel(holder.object) ? namedBy(holder.object) : holder.object;
    if (isEnabled(control))
        use(control);
    else
        NSBeep();
}

// The letter that was typed with Alt, which the toolkit calls the command key; 0 for other keys.
wchar_t typedLetter(NSEvent* event)
{
    const NSUInteger flags = [event modifierFlags];
    NSString* characters = [event charactersIgnoringModifiers];
    if (!(flags & (NSCommandKeyMask | NSAlternateKeyMask)) || (flags & NSControlKeyMask) ||
        [characters length] != 1)
        return 0;
    return [characters characterAtIndex:0];
}

bool useMnemonic(NSWindow* window, wchar_t letter)
{
    for (const Holder& holder : holdersIn(window))
        if (holder.place && isMnemonic([holder.text characterAtIndex:*holder.place], letter))
            return use(holder), true;
    return false;
}

using KeyEquivalent = BOOL (*)(id, SEL, NSEvent*);
KeyEquivalent toolkitKeyEquivalent;

BOOL keyEquivalent(id window, SEL selector, NSEvent* event)
{
    if (toolkitKeyEquivalent(window, selector, event))
        return YES;
    const wchar_t letter = typedLetter(event);
    return letter && useMnemonic(window, letter);
}

using DrawTitle = NSRect (*)(id, SEL, NSAttributedString*, NSRect, NSView*);
DrawTitle toolkitDrawTitle;

NSRect drawTitle(id cell, SEL selector, NSAttributedString* title, NSRect frame, NSView* view)
{
    return toolkitDrawTitle(cell, selector, withMnemonic(title, view), frame, view);
}

using Text = NSAttributedString* (*)(id, SEL);
Text toolkitText;

NSAttributedString* textOfField(id cell, SEL selector)
{
    NSAttributedString* text = toolkitText(cell, selector);
    NSView* view = [cell controlView];
    return [view isKindOfClass:[NSTextField class]] && isLabel(view) ? withMnemonic(text, view) : text;
}
} // namespace

NSAttributedString* withMnemonic(NSAttributedString* text, NSView* control)
{
    return underlined(text, placeOf(control, [control window]));
}

NSAttributedString* labelOfTab(NSTabViewItem* item, NSDictionary* look)
{
    NSAttributedString* label = [[[NSAttributedString alloc] initWithString:[item label]
                                                                 attributes:look] autorelease];
    return underlined(label, placeOf(item, [[item tabView] window]));
}

void giveControlsMnemonics()
{
    if (toolkitKeyEquivalent)
        return;
    toolkitKeyEquivalent = standInFor("NSWindow", @selector(performKeyEquivalent:), keyEquivalent);
    toolkitDrawTitle = standInFor("NSButtonCell", @selector(drawTitle:withFrame:inView:), drawTitle);
    toolkitText = standInFor("NSTextFieldCell", NSSelectorFromString(@"_drawAttributedString"), textOfField);
}
} // namespace tessel::windowing
