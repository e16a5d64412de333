#include "host/ui/platform/gnustep/Theme.h"

#include "host/ui/platform/gnustep/Appearance.h"
#include "host/ui/platform/gnustep/TesselTheme.h"
#include "host/ui/platform/gnustep/ThemeButtons.h"
#include "host/ui/platform/gnustep/ThemeFocus.h"
#include "host/ui/platform/gnustep/ThemePictures.h"

namespace tessel::windowing
{
namespace
{
// The theme for light desktops, or the one for dark ones beside it.
NSBundle* chosenTheme(NSString* lightTheme)
{
    NSString* setting = [[NSUserDefaults standardUserDefaults] stringForKey:@"TesselAppearance"];
    const bool isDark = chosenAppearance(setting ? [setting UTF8String] : "") == Appearance::kDark;
    NSString* beside = [lightTheme stringByDeletingLastPathComponent];
    return [NSBundle
        bundleWithPath:isDark ? [beside stringByAppendingPathComponent:@"TesselDark.theme"] : lightTheme];
}

// Low four bits: no rounding of how far letters stand apart. Rounded for one pixel a point, they would run
// into each other on a screen of two. The next four: no other change of their shapes.
constexpr int kFontHinting = 0x11;

void registerDefault(id value, NSString* key)
{
    [[NSUserDefaults standardUserDefaults] registerDefaults:[NSDictionary dictionaryWithObject:value
                                                                                        forKey:key]];
}

void use(NSBundle* bundle)
{
    GSTheme* theme = [[[TesselTheme alloc] initWithBundle:bundle] autorelease];
    [GSTheme setTheme:theme];
    // Whenever a user default changes, the toolkit goes back to the theme that the defaults name.
    registerDefault([theme name], @"GSTheme");
    NSString* resources = [bundle resourcePath];
    sharpenControls(resources);
    useFileIcons(resources);
    [NSApp setApplicationIconImage:pictureIn(resources, @"Tessel")];
}
} // namespace

void useTheme(NSString* folder)
{
    NSBundle* bundle = folder ? chosenTheme(folder) : nil;
    if (!bundle)
        return;
    registerDefault([NSNumber numberWithInt:kFontHinting], @"GSFontHinting");
    use(bundle);
    completeButtons();
    completePopUps();
    completeTables();
    completeToolTips();
    showWhereTheKeyboardIs();
}
} // namespace tessel::windowing
