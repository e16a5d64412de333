#include "host/ui/platform/gnustep/ThemePictures.h"

#include <tesselui/tsuieach.h>

#include "host/platform/gnustep/StandIn.h"

namespace tessel::windowing
{
namespace
{
using IconForFile = NSImage* (*)(id, SEL, NSString*);
IconForFile toolkitIconForFile;

NSDictionary* gFileIcons = nil; // by the extension in lower case

NSString* const kSharper[] = {@"@2x", @"@3x"};

void addSharper(NSImage* picture, NSString* folder, NSString* name)
{
    for (NSString* suffix : kSharper)
    {
        NSString* file = [[name stringByAppendingString:suffix] stringByAppendingPathExtension:@"png"];
        NSImageRep* sharper =
            [NSImageRep imageRepWithContentsOfFile:[folder stringByAppendingPathComponent:file]];
        [sharper setSize:[picture size]];
        if (sharper)
            [picture addRepresentation:sharper];
    }
}

// The names of the pictures in the folder.
NSArray* picturesIn(NSString* folder)
{
    NSMutableArray* names = [NSMutableArray array];
    for (NSString* file :
         tsuiEach<NSString*>([[NSFileManager defaultManager] contentsOfDirectoryAtPath:folder error:nullptr]))
    {
        NSString* name = [file stringByDeletingPathExtension];
        if ([name rangeOfString:@"@"].location == NSNotFound)
            [names addObject:name];
    }
    return names;
}

NSImage* iconForFile(id workspace, SEL selector, NSString* path)
{
    BOOL isFolder = NO;
    const bool exists = [[NSFileManager defaultManager] fileExistsAtPath:path isDirectory:&isFolder];
    NSImage* icon = exists ? iconOfFile(path, isFolder) : nil;
    return icon ? icon : toolkitIconForFile(workspace, selector, path);
}
} // namespace

NSImage* pictureIn(NSString* folder, NSString* name)
{
    NSString* file = [folder stringByAppendingPathComponent:[name stringByAppendingPathExtension:@"png"]];
    NSImage* picture = [[[NSImage alloc] initWithContentsOfFile:file] autorelease];
    if (picture)
        addSharper(picture, folder, name);
    return picture;
}

void sharpenControls(NSString* themeResources)
{
    NSString* folder = [themeResources stringByAppendingPathComponent:@"ThemeImages"];
    for (NSString* name : tsuiEach<NSString*>(picturesIn(folder)))
        addSharper([NSImage imageNamed:name], folder, name);
}

void useFileIcons(NSString* themeResources)
{
    NSString* folder = [themeResources stringByAppendingPathComponent:@"FileIcons"];
    NSMutableDictionary* icons = [NSMutableDictionary dictionary];
    for (NSString* name : tsuiEach<NSString*>(picturesIn(folder)))
        [icons setObject:pictureIn(folder, name) forKey:name];
    [gFileIcons release];
    gFileIcons = [icons copy];
    if (!toolkitIconForFile)
        toolkitIconForFile = standInFor<IconForFile>("NSWorkspace", @selector(iconForFile:), iconForFile);
}

NSImage* iconOfFile(NSString* path, bool isFolder)
{
    NSImage* icon = [gFileIcons objectForKey:[[path pathExtension] lowercaseString]];
    return icon ? icon : [gFileIcons objectForKey:isFolder ? @"folder" : @"unknown"];
}
} // namespace tessel::windowing
