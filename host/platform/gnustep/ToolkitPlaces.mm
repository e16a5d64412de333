// The toolkit keeps settings, and lists of what it has found, in the home of the person that the system
// knows, whatever HOME says: a trial with a profile of its own would change them for every program of the
// toolkit, and a program that was killed with their lock would keep all others waiting for it.
#import <Foundation/Foundation.h>

#include <wincompat/winstring.h>

#include "host/platform/FileNames.h"
#include "host/platform/ToolkitPlaces.h"
#include "host/platform/gnustep/ToolkitProcess.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
NSString* const kSettingsPlace = @"GNUSTEP_USER_DEFAULTS_DIR";
NSString* const kLibraryPlace = @"GNUSTEP_USER_DIR_LIBRARY";
// Ours: what the first of them was, which also says that the places have been moved. A key that the toolkit
// does not know has to stand in its list of further keys.
NSString* const kPersonalPlace = @"TESSEL_PERSONAL_DEFAULTS_DIR";
NSString* const kFurtherKeys = @"GNUSTEP_EXTRA";

NSString* withKey(NSString* keys, NSString* key)
{
    return [keys length] ? [keys stringByAppendingFormat:@",%@", key] : key;
}
} // namespace

std::string keepToolkitFilesIn(const std::string& folder)
{
    tellToolkitOfProcess(currentEnvironment());
    nameEveryFile();
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    NSMutableDictionary* places = [[GNUstepConfig(nil) mutableCopy] autorelease];
    if (![places objectForKey:kPersonalPlace])
    {
        NSString* root = wcharToNSString(toWide(folder).c_str());
        [places setObject:[places objectForKey:kSettingsPlace] forKey:kPersonalPlace];
        [places setObject:withKey([places objectForKey:kFurtherKeys], kPersonalPlace) forKey:kFurtherKeys];
        [places setObject:[root stringByAppendingPathComponent:@"Defaults"] forKey:kSettingsPlace];
        [places setObject:[root stringByAppendingPathComponent:@"Library"] forKey:kLibraryPlace];
        GNUstepConfig(places);
    }
    // Relative to the home; absolute where the system's administrator has said so.
    NSString* home = [[[NSProcessInfo processInfo] environment] objectForKey:@"HOME"];
    NSString* place = [places objectForKey:kPersonalPlace];
    if (![place isAbsolutePath])
        place = [home stringByAppendingPathComponent:place];
    const std::string personal = place ? [place fileSystemRepresentation] : "";
    [pool drain];
    return personal;
}
} // namespace tessel
