#include "host/ui/platform/TextKeys.h"

#import <AppKit/AppKit.h>

#include "host/ui/Words.h"

namespace tessel::windowing
{
namespace
{
void addMenu(NSMenu* bar, NSMenu* menu)
{
    NSMenuItem* item = [[[NSMenuItem alloc] initWithTitle:[menu title] action:nullptr
                                            keyEquivalent:@""] autorelease];
    [item setSubmenu:menu];
    [bar addItem:item];
}
} // namespace

// Command with a letter is a matter of the Edit menu here, which a host without a menu bar has not got.
void takeTextKeys()
{
    NSMenu* edit = [[[NSMenu alloc] initWithTitle:word(@"EDIT")] autorelease];
    // Texts take this one, though no header says so.
    [edit addItemWithTitle:word(@"UNDO") action:NSSelectorFromString(@"undo:") keyEquivalent:@"z"];
    [edit addItemWithTitle:word(@"CUT") action:@selector(cut:) keyEquivalent:@"x"];
    [edit addItemWithTitle:word(@"COPY") action:@selector(copy:) keyEquivalent:@"c"];
    [edit addItemWithTitle:word(@"PASTE") action:@selector(paste:) keyEquivalent:@"v"];
    [edit addItemWithTitle:word(@"SELECT_ALL") action:@selector(selectAll:) keyEquivalent:@"a"];
    NSMenu* bar = [[[NSMenu alloc] initWithTitle:@""] autorelease];
    // Whichever comes first is taken for the program's own menu, and shows its name.
    addMenu(bar, [[[NSMenu alloc] initWithTitle:@"Tessel"] autorelease]);
    addMenu(bar, edit);
    [NSApp setMainMenu:bar];
}
} // namespace tessel::windowing
