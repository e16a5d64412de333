#include "host/ui/platform/Windowing.h"

#import <GNUstepGUI/GSDisplayServer.h>

#include <tesselui/tsuieach.h>
#include <tesselui/tsuierrors.h>

#include <dlfcn.h>

#include "host/ui/platform/gnustep/DisplayProbe.h"
#include "host/ui/platform/gnustep/Theme.h"

namespace tessel::windowing
{
namespace
{
NSString* absolute(NSString* path)
{
    NSString* folder = [[NSFileManager defaultManager] currentDirectoryPath];
    NSString* whole = [path isAbsolutePath] ? path : [folder stringByAppendingPathComponent:path];
    return [whole stringByStandardizingPath];
}

// The host's theme: colours only, in the resources of the host that this library lies in.
NSString* themePath()
{
    Dl_info info;
    if (!dladdr(reinterpret_cast<const void*>(&themePath), &info) || !info.dli_fname)
        return nil;
    NSString* library = absolute([NSString stringWithUTF8String:info.dli_fname]);
    NSString* theme = [[library stringByDeletingLastPathComponent]
        stringByAppendingPathComponent:@"Resources/Tessel.theme"];
    return [[NSFileManager defaultManager] fileExistsAtPath:theme] ? theme : nil;
}

NSString* const kPlainFontRoles[] = {@"NSFont",        @"NSUserFont",    @"NSControlContentFont",
                                     @"NSLabelFont",   @"NSMenuFont",    @"NSMessageFont",
                                     @"NSPaletteFont", @"NSToolTipsFont"};
NSString* const kBoldFontRoles[] = {@"NSBoldFont", @"NSTitleBarFont"};

void setDefaults(NSDictionary* defaults)
{
    [[NSUserDefaults standardUserDefaults] registerDefaults:defaults];
}
// The browser raises an exception when a folder that it shows, /tmp, say, changes under it. It has the new
// state the next time. What still does not work then shows on the screen.
constexpr int kMostTries = 5;

void persist(void (*change)(void*), void* argument)
{
    for (int tries = 0; tries < kMostTries && tsuiErrorOf(change, argument); ++tries)
        ;
}

struct PanelFolder
{
    NSOpenPanel* panel;
    NSString* folder;
};

void openFolder(void* wanted)
{
    const auto* place = static_cast<PanelFolder*>(wanted);
    [place->panel setCanChooseDirectories:NO];
    if (place->folder)
        [place->panel setDirectory:place->folder];
}
} // namespace

bool displayIsReachable()
{
    return probeDisplay().reachable;
}

void chooseLook()
{
    NSMutableDictionary* look = [NSMutableDictionary dictionary];
    [look setObject:@"YES" forKey:@"GSSuppressAppIcon"]; // no tile on the desktop
    [look setObject:@"NO" forKey:@"GSWorkspaceAppIcon"];
    [look setObject:@"NSWindows95InterfaceStyle" forKey:@"NSMenuInterfaceStyle"];
    [look setObject:@"NSMacintoshInterfaceStyle"
             forKey:@"NSScrollViewInterfaceStyle"]; // scrollers on the right
    [look setObject:@"NSMacintoshInterfaceStyle" forKey:@"NSBrowserInterfaceStyle"];
    // Without a window manager nobody else draws title bars, and the toolkit would wait for what never comes.
    if (!probeDisplay().hasWindowManager)
        [look setObject:@"NO" forKey:@"GSBackHandlesWindowDecorations"];
    setDefaults(look);
}

void completeLook()
{
    useTheme(themePath());
    NSArray* fonts = [[NSFontManager sharedFontManager] availableFonts];
    if (![fonts containsObject:@"Inter-Regular"] || ![fonts containsObject:@"Inter-Bold"])
        return;
    NSMutableDictionary* choice = [NSMutableDictionary dictionaryWithObject:@"13" forKey:@"NSFontSize"];
    for (NSString* role : kPlainFontRoles)
        [choice setObject:@"Inter-Regular" forKey:role];
    for (NSString* role : kBoldFontRoles)
        [choice setObject:@"Inter-Bold" forKey:role];
    setDefaults(choice);
}

void flushScreen()
{
    completeRequests([GSCurrentServer() serverDevice]);
}

NSOpenPanel* makeOpenPanel()
{
    // +openPanel answers one object for the whole program, which may be open already.
    return [[[NSOpenPanel alloc] init] autorelease];
}

void showFilesOf(NSOpenPanel* panel, NSString* folder)
{
    PanelFolder wanted = {panel, folder};
    persist(openFolder, &wanted);
}
} // namespace tessel::windowing

// The panel's own idea of its folder does not follow the browser, which is asked instead.
@interface NSSavePanel (TsBrowser)
- (NSString*)tsShownFolder;
- (NSArray*)tsChosenPaths;
- (void)tsFilterAnew;
@end

@implementation NSSavePanel (TsBrowser)

- (NSString*)tsShownFolder
{
    return [[_browser pathToColumn:[_browser lastColumn]] stringByStandardizingPath];
}

- (NSArray*)tsChosenPaths
{
    NSMutableArray* paths = [NSMutableArray array];
    for (NSBrowserCell* cell : tsuiEach<NSBrowserCell*>([_browser selectedCells]))
        if ([cell isLeaf])
            [paths addObject:[[self tsShownFolder] stringByAppendingPathComponent:[cell stringValue]]];
    return paths;
}

// -validateVisibleColumns would empty the columns of the browser.
- (void)tsFilterAnew
{
    NSString* folder = [[[self tsShownFolder] retain] autorelease];
    [_browser loadColumnZero];
    [_browser setPath:folder];
    [_okButton setEnabled:NO];
}

@end

NSArray* tessel::windowing::chosenPaths(NSOpenPanel* panel)
{
    return [panel tsChosenPaths];
}

void tessel::windowing::filterAnew(NSOpenPanel* panel)
{
    persist([](void* shown) { [static_cast<NSOpenPanel*>(shown) tsFilterAnew]; }, panel);
}
