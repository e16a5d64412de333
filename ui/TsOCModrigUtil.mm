#import "ui/TsOCModrigUtil.h"

#import <tesselui/TsOCFileFilter.h>
#include <tesselui/tsuieach.h>
#include <wincompat/winfile.h>
#include <wincompat/winstring.h>

#import "ui/ModrigController.h"
#import "ui/ModrigFilePath.h"

#include "types/FileValidation.h"

namespace
{
ModrigController* gModrigController = nil;

// Each has a description under the key, and extensions under the key followed by "_EXT".
NSString* const kFilterKeys[] = {@"IDS_MODRIG_TESSEL_APPS", @"IDS_MODRIG_QMB_APPS", @"IDS_MODRIG_ZMB_APPS",
                                 @"IDS_MODRIG_LSP_APPS",    @"IDS_MODRIG_OMP_APPS", @"IDS_MODRIG_QBC_APPS"};

CStdStr wide(NSString* text)
{
    return CStdStr(NSStringToWstring(text));
}

// What is equal for the user is equal here.
NSString* identity(NSString* path)
{
    return [path lowercaseString];
}

NSMutableSet* identitiesOfRows(NSArrayController* controller)
{
    NSMutableSet* identities = [NSMutableSet set];
    for (ModrigFilePath* row : tsuiEach<ModrigFilePath*>([controller arrangedObjects]))
        if ([row filePathName])
            [identities addObject:identity([row filePathName])];
    return identities;
}
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
    [self addPathNames:[NSArray arrayWithObject:path] toArrayController:controller];
}

+ (void)addPathNames:(NSArray*)paths toArrayController:(NSArrayController*)controller
{
    NSMutableSet* known = identitiesOfRows(controller);
    NSMutableArray* rows = [NSMutableArray array];
    for (NSString* path : tsuiEach<NSString*>(paths))
    {
        NSString* resolved = [path stringByResolvingSymlinksInPath];
        NSString* key = identity(resolved);
        if ([known containsObject:key])
            continue;
        [known addObject:key];
        ModrigFilePath* row = [[ModrigFilePath alloc] initWithResolvedPath:resolved];
        [rows addObject:row];
        [row release];
    }
    if ([rows count])
        [controller addObjects:rows];
}

+ (NSString*)modrigLoadString:(NSString*)key
{
    NSBundle* bundle = [NSBundle bundleForClass:[TsOCModrigUtil class]];
    return [bundle localizedStringForKey:key value:@"" table:nil];
}

+ (void)populateModrigFileFilter:(NSMutableArray*)filters
{
    for (NSString* key : kFilterKeys)
    {
        NSString* description = [self modrigLoadString:key];
        NSString* extensions = [self modrigLoadString:[key stringByAppendingString:@"_EXT"]];
        [filters addObject:[[[TsOCFileFilter alloc] initWithDescription:description
                                                           extensionStr:extensions] autorelease]];
    }
}

+ (BOOL)isValidFileForModrig:(NSString*)path
{
    return ModrigUtils::IsValidFileForModrig(wide(path));
}

+ (NSString*)validateFileExists:(NSString*)path
{
    CStdStr found = wide(path);
    if (ModrigUtils::ValidateFileExists(found) == INVALID_FILE_ATTRIBUTES)
        return nil;
    return wcharToNSString(found.c_str());
}

+ (BOOL)isTempInternetFile:(NSString*)path
{
    return ModrigUtils::IsTempInternetFile(wide(path));
}

@end
