#import <tesselui/TsOCOpenFileDialog.h>

#import <tesselui/TsOCFileFilter.h>

#include <tesselui/tsuieach.h>
#include <tesselui/tsuifilepanel.h>

#include "host/ui/Label.h"
#include "host/ui/Words.h"
#include "host/ui/platform/Windowing.h"

namespace
{
const NSRect kFilterBar = {{0, 0}, {420, 44}};
const NSRect kFilterLabel = {{16, 14}, {72, 18}}; // in line with the panel's name field
const NSRect kFilterChoice = {{104, 10}, {308, 26}};
} // namespace

// Shows the files of the chosen type: the panel's delegate while it runs.
@interface TsOCFileTypeChooser : NSObject
{
    NSOpenPanel* mPanel;
    NSArray* mFilters;
    NSUInteger mChosen;
}
- (id)initWithPanel:(NSOpenPanel*)panel filters:(NSArray*)filters;
- (NSView*)view;
@end

@implementation TsOCFileTypeChooser

- (id)initWithPanel:(NSOpenPanel*)panel filters:(NSArray*)filters
{
    if ((self = [super init]))
    {
        mPanel = panel;
        mFilters = [filters copy];
    }
    return self;
}

- (void)dealloc
{
    [mFilters release];
    [super dealloc];
}

- (NSView*)view
{
    NSPopUpButton* choice = [[[NSPopUpButton alloc] initWithFrame:kFilterChoice pullsDown:NO] autorelease];
    [choice setFont:[NSFont systemFontOfSize:tessel::windowing::kControlFontSize]];
    for (TsOCFileFilter* filter : tsuiEach<TsOCFileFilter*>(mFilters))
        [choice addItemWithTitle:[filter description]];
    [choice setTarget:self];
    [choice setAction:@selector(onChoice:)];
    [choice setAutoresizingMask:NSViewWidthSizable];
    NSView* bar = [[[NSView alloc] initWithFrame:kFilterBar] autorelease];
    [bar addSubview:tessel::windowing::makeLabel(tessel::word(@"SHOW"), kFilterLabel)];
    [bar addSubview:choice];
    [bar setAutoresizingMask:NSViewWidthSizable];
    return bar;
}

- (void)onChoice:(id)sender
{
    mChosen = static_cast<NSUInteger>([sender indexOfSelectedItem]);
    [mPanel validateVisibleColumns];
}

// A folder, or the host's own package, where the applications are that come with it. Other packages are
// files.
- (BOOL)isWalkedThrough:(NSString*)path
{
    BOOL folder = NO;
    if (![[NSFileManager defaultManager] fileExistsAtPath:path isDirectory:&folder] || !folder)
        return NO;
    return ![[NSWorkspace sharedWorkspace] isFilePackageAtPath:path] ||
           [path caseInsensitiveCompare:[[NSBundle mainBundle] bundlePath]] == NSOrderedSame;
}

- (BOOL)panel:(id)sender shouldShowFilename:(NSString*)path
{
    if ([mFilters count] == 0)
        return YES;
    for (NSString* extension : tsuiEach<NSString*>([[mFilters objectAtIndex:mChosen] fileExtensions]))
        if ([[path pathExtension] caseInsensitiveCompare:extension] == NSOrderedSame)
            return YES;
    return [self isWalkedThrough:path];
}

// The system's panel on macOS asks this instead.
- (BOOL)panel:(id)sender shouldEnableURL:(NSURL*)url
{
    return [self panel:sender shouldShowFilename:[url path]];
}

@end

@implementation TsOCOpenFileDialog

- (void)dealloc
{
    [mTitle release];
    [mInitialPath release];
    [mFileFilters release];
    [mSelectedPathes release];
    [super dealloc];
}

- (void)setTitle:(NSString*)title
{
    [mTitle autorelease];
    mTitle = [title copy];
}

- (void)setInitialPath:(NSString*)path
{
    [mInitialPath autorelease];
    mInitialPath = [path copy];
}

- (void)setAllowsMultipleSelection:(BOOL)allows
{
    mAllowsMultipleSelection = allows;
}

- (void)setFileFilters:(NSArray*)filters
{
    [mFileFilters autorelease];
    mFileFilters = [filters copy];
}

- (NSArray*)selectedPathes
{
    return mSelectedPathes;
}

- (void)prepare:(NSOpenPanel*)panel
{
    if (mTitle)
        [panel setTitle:mTitle];
    [panel setAllowsMultipleSelection:mAllowsMultipleSelection];
    [panel setCanChooseDirectories:NO];
    if (mInitialPath)
        tessel::windowing::showFolder(panel, mInitialPath);
}

- (NSInteger)runModal
{
    NSOpenPanel* panel = tsuiMakeFilePanel();
    [self prepare:panel];
    TsOCFileTypeChooser* chooser = [[[TsOCFileTypeChooser alloc] initWithPanel:panel
                                                                       filters:mFileFilters] autorelease];
    [panel setDelegate:(id)chooser];
    if ([mFileFilters count])
        tessel::windowing::showAccessoryView(panel, [chooser view]);
    const bool chosen = [panel runModal] == NSModalResponseOK;
    [mSelectedPathes release];
    mSelectedPathes = [(chosen ? [[panel URLs] valueForKey:@"path"] : [NSArray array]) copy];
    [panel setDelegate:nil];
    [panel setAccessoryView:nil];
    return chosen ? NSModalResponseOK : 0;
}

@end
