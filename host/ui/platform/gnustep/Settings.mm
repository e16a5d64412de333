// The toolkit keeps settings, and lists of what it has found, in the home of the person that the system
// knows, whatever HOME says: a trial with a profile of its own would change them for every program of the
// toolkit. Here they lie in the profile. What the person has set for all programs counts as before, but is
// only read.
#include "host/ui/platform/gnustep/Settings.h"

#include <fstream>

namespace tessel::windowing
{
namespace
{
NSString* const kSettingsPlace = @"GNUSTEP_USER_DEFAULTS_DIR";
NSString* const kLibraryPlace = @"GNUSTEP_USER_DIR_LIBRARY";
NSString* const kSettingsOfAllPrograms = @"NSGlobalDomain.plist";

constexpr std::streamoff kLongestLog = 1 << 20;

NSDictionary* gPersonalSettings;
NSString* gLog;

NSDictionary* readPersonalSettings(NSDictionary* places)
{
    NSString* home = [[[NSProcessInfo processInfo] environment] objectForKey:@"HOME"];
    NSString* folder = [home stringByAppendingPathComponent:[places objectForKey:kSettingsPlace]];
    return [NSDictionary
        dictionaryWithContentsOfFile:[folder stringByAppendingPathComponent:kSettingsOfAllPrograms]];
}

void writeToLog(NSString* message)
{
    [[NSFileManager defaultManager] createDirectoryAtPath:[gLog stringByDeletingLastPathComponent]
                              withIntermediateDirectories:YES
                                               attributes:nil
                                                    error:nullptr];
    std::ofstream log([gLog fileSystemRepresentation], std::ios::app);
    if (log.tellp() < kLongestLog)
        log << [message UTF8String];
}
} // namespace

void keepSettingsIn(NSString* folder)
{
    NSMutableDictionary* places = [[GNUstepConfig(nil) mutableCopy] autorelease];
    gPersonalSettings = [readPersonalSettings(places) retain];
    [places setObject:[folder stringByAppendingPathComponent:@"Defaults"] forKey:kSettingsPlace];
    [places setObject:[folder stringByAppendingPathComponent:@"Library"] forKey:kLibraryPlace];
    GNUstepConfig(places);
    [NSUserDefaults resetStandardUserDefaults]; // where somebody has asked them already
}

// Nothing of it is for the person at the prompt, who did not ask and cannot answer.
void keepComplaintsIn(NSString* folder)
{
    gLog = [[folder stringByAppendingPathComponent:@"log.txt"] copy];
    _NSLog_printf_handler = writeToLog;
}

void suggestSettings(NSDictionary* settings)
{
    NSUserDefaults* defaults = [NSUserDefaults standardUserDefaults];
    [defaults registerDefaults:settings];
    if (gPersonalSettings)
        [defaults registerDefaults:gPersonalSettings];
}
} // namespace tessel::windowing
