// What the person has set for all programs of the toolkit counts here too, but is only read: what this
// program remembers lies in the profile.
#include "host/ui/platform/gnustep/Settings.h"

#include <fstream>
#include <string>

#include "host/platform/ToolkitPlaces.h"

namespace tessel::windowing
{
namespace
{
NSString* const kSettingsOfAllPrograms = @"NSGlobalDomain.plist";

constexpr std::streamoff kLongestLog = 1 << 20;

NSDictionary* gPersonalSettings;
NSString* gLog;

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
    const std::string personal = keepToolkitFilesIn([folder fileSystemRepresentation]);
    NSString* file = [[NSString stringWithUTF8String:personal.c_str()]
        stringByAppendingPathComponent:kSettingsOfAllPrograms];
    gPersonalSettings = [[NSDictionary alloc] initWithContentsOfFile:file];
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

void insistOnSetting(NSString* name, NSString* value)
{
    NSUserDefaults* defaults = [NSUserDefaults standardUserDefaults];
    NSMutableDictionary* session = [NSMutableDictionary dictionaryWithObject:value forKey:name];
    NSDictionary* arguments = [defaults volatileDomainForName:NSArgumentDomain];
    if (arguments)
        [session addEntriesFromDictionary:arguments];
    [defaults removeVolatileDomainForName:NSArgumentDomain];
    [defaults setVolatileDomain:session forName:NSArgumentDomain];
}
} // namespace tessel::windowing
