#import "modrig/dialogs/TsOCModrigUtil.h"

#import <tesselui/TsOCFileFilter.h>
#include <tesselui/tsuitexts.h>
#include <wincompat/winfile.h>

#include <vector>

#import "modrig/dialogs/ModrigController.h"

#include "modrig/dialogs/Paths.h"
#include "modrig/dialogs/TableRows.h"
#include "modrig/types/FileFilters.h"
#include "modrig/types/FileValidation.h"

namespace
{
ModrigController* gModrigController = nil;
} // namespace

@implementation TsOCModrigUtil

+ (void)setModrigController:(ModrigController*)controller
{
    [controller retain];
    [gModrigController release];
    gModrigController = controller;
}

+ (ModrigController*)getModrigController
{
    return gModrigController;
}

+ (void)addPathName:(NSString*)path toArrayController:(NSArrayController*)controller
{
    ModrigUtils::AddRows(controller, std::vector<CStdStr>{ModrigUtils::PathFromString(path)});
}

+ (NSString*)modrigLoadString:(NSString*)key
{
    return tsuiTextOf([NSBundle bundleForClass:[TsOCModrigUtil class]], key, nil);
}

+ (void)populateModrigFileFilter:(NSMutableArray*)filters
{
    for (const char* name : ModrigUtils::FileFilterKeys())
    {
        NSString* key = [NSString stringWithUTF8String:name];
        NSString* description = [self modrigLoadString:key];
        NSString* extensions = [self modrigLoadString:[key stringByAppendingString:@"_EXT"]];
        [filters addObject:[[[TsOCFileFilter alloc] initWithDescription:description
                                                           extensionStr:extensions] autorelease]];
    }
}

+ (BOOL)isValidFileForModrig:(NSString*)path
{
    return ModrigUtils::IsValidFileForModrig(ModrigUtils::PathFromString(path));
}

+ (NSString*)validateFileExists:(NSString*)path
{
    CStdStr found = ModrigUtils::PathFromString(path);
    if (ModrigUtils::ValidateFileExists(found) == INVALID_FILE_ATTRIBUTES)
        return nil;
    return ModrigUtils::StringFromPath(found);
}

+ (BOOL)isTempInternetFile:(NSString*)path
{
    return ModrigUtils::IsTempInternetFile(ModrigUtils::PathFromString(path));
}

@end
