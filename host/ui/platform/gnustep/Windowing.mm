#include "host/ui/platform/Windowing.h"

#import <GNUstepGUI/GSDisplayServer.h>

#include <dlfcn.h>

#include "host/ui/platform/gnustep/Behaviour.h"
#include "host/ui/platform/gnustep/DisplayProbe.h"
#include "host/ui/platform/gnustep/Languages.h"
#include "host/ui/platform/gnustep/Mnemonics.h"
#include "host/ui/platform/gnustep/Settings.h"
#include "host/ui/platform/gnustep/TabKeys.h"
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

// The colours and pictures of the host's theme, in the resources of the host that this library lies in.
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

NSString* const kScale = @"GSScaleFactor";

NSString* asSetting(double number)
{
    return [NSString stringWithFormat:@"%g", number];
}

NSString* const kPlainFontRoles[] = {@"NSFont",        @"NSUserFont",    @"NSControlContentFont",
                                     @"NSLabelFont",   @"NSMenuFont",    @"NSMessageFont",
                                     @"NSPaletteFont", @"NSToolTipsFont"};
NSString* const kBoldFontRoles[] = {@"NSBoldFont", @"NSTitleBarFont"};
} // namespace

bool displayIsReachable()
{
    return probeDisplay().reachable;
}

void prepareToolkit(NSString* folder)
{
    keepSettingsIn(folder);
    keepComplaintsIn(folder);
    keepHelperProgramsToTheSession();
    takePersonsLanguages();
}

void chooseLook()
{
    NSMutableDictionary* look = [NSMutableDictionary dictionary];
    [look setObject:@"YES" forKey:@"GSSuppressAppIcon"]; // no tile on the desktop
    [look setObject:@"NO" forKey:@"GSWorkspaceAppIcon"];
    [look setObject:@"NSWindows95InterfaceStyle" forKey:@"NSMenuInterfaceStyle"];
    [look setObject:@"NSMacintoshInterfaceStyle"
             forKey:@"NSScrollViewInterfaceStyle"]; // scrollers on the right
    // Without a window manager nobody else draws title bars, and the toolkit would wait for what never comes.
    const DisplayFacts display = probeDisplay();
    if (!display.hasWindowManager)
        [look setObject:@"NO" forKey:@"GSBackHandlesWindowDecorations"];
    [look setObject:asSetting(scaleFor(display.dotsPerInch)) forKey:kScale];
    suggestSettings(look);
    if ([[NSUserDefaults standardUserDefaults] doubleForKey:kScale] > largestScaleOn(display))
        insistOnSetting(kScale, asSetting(largestScaleOn(display)));
}

void completeBehaviour()
{
    acceptFileDrops();
    takeInputInItsOrder();
    makeWindowsClosable();
    letNewWindowsHaveTheKeyboard();
    keepModalWindowsInFront();
    keepScrollersSteady();
    showWhereDropsLandInTables();
    letEscapeCloseMenus();
    drawWholePixels();
    placeContentsOfWindows();
    letTabsHaveTheKeyboard();
    giveControlsMnemonics();
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
    suggestSettings(choice);
}

void showAccessoryView(NSOpenPanel* panel, NSView* view)
{
    [panel setAccessoryView:view];
}

void showFolder(NSOpenPanel* panel, NSString* folder)
{
    [panel setDirectory:folder];
}

void comeToFront()
{
    [NSApp activateIgnoringOtherApps:YES];
}

// The display gives the keyboard on by itself.
void leaveScreen()
{
    completeRequests([GSCurrentServer() serverDevice]);
}
} // namespace tessel::windowing
