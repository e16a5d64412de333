#include "host/ui/platform/TextKeys.h"

#import <AppKit/AppKit.h>

namespace tessel::windowing
{
// Command with a letter is a matter of the Edit menu here, which a host without a menu bar has not got.
void takeTextKeys()
{
    NSMenu* edit = [[[NSMenu alloc] initWithTitle:@"Edit"] autorelease];
    // Texts take this one, though no header says so.
    [edit addItemWithTitle:@"Undo" action:NSSelectorFromString(@"undo:") keyEquivalent:@"z"];
    [edit addItemWithTitle:@"Cut" action:@selector(cut:) keyEquivalent:@"x"];
    [edit addItemWithTitle:@"Copy" action:@selector(copy:) keyEquivalent:@"c"];
    [edit addItemWithTitle:@"Paste" action:@selector(paste:) keyEquivalent:@"v"];
    [edit addItemWithTitle:@"Select All" action:@selector(selectAll:) keyEquivalent:@"a"];
    NSMenuItem* item = [[[NSMenuItem alloc] initWithTitle:@"Edit" action:nullptr
                                            keyEquivalent:@""] autorelease];
    [item setSubmenu:edit];
    NSMenu* bar = [[[NSMenu alloc] initWithTitle:@""] autorelease];
    [bar addItem:item];
    [NSApp setMainMenu:bar];
}
} // namespace tessel::windowing
