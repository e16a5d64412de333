#import "host/ui/platform/gnustep/filepanel/FilePanel.h"

#include <objc/runtime.h>

#include <tesselui/tsuieach.h>
#include <tesselui/tsuifilepanel.h>

#import "host/ui/platform/gnustep/filepanel/FileTable.h"
#include "host/ui/platform/gnustep/filepanel/Folders.h"
#include "host/ui/platform/gnustep/filepanel/PanelState.h"

using namespace tessel::filepanel;

namespace
{
const NSRect kFirstFrame = {{100, 100}, {750, 480}};

// The toolkit's panel overrides these methods of a window for its own inside, which is not there.
template <class Function> Function windowMethod(SEL selector)
{
    return reinterpret_cast<Function>(
        reinterpret_cast<void*>(class_getMethodImplementation([NSPanel class], selector)));
}
} // namespace

@implementation TsUIFilePanel

// Not by the toolkit's panel, which would make its browser.
- (id)init
{
    self = [self initWithContentRect:kFirstFrame
                           styleMask:NSTitledWindowMask | NSClosableWindowMask | NSResizableWindowMask
                             backing:NSBackingStoreBuffered
                               defer:YES];
    if (!self)
        return nil;
    mState = new PanelState;
    mState->wanted = bytes(NSHomeDirectory());
    [self setReleasedWhenClosed:NO];
    [self setHidesOnDeactivate:NO];
    [self makeParts];
    [self restoreLook];
    [self updateDefaultButton];
    return self;
}

- (void)dealloc
{
    [self forgetPendingWork];
    [mTable setDataSource:nil];
    [mTable setDelegate:nil];
    [mName setDelegate:nil];
    [mAccessory release];
    delete mState;
    [super dealloc];
}

- (void)setTitle:(NSString*)title
{
    windowMethod<void (*)(id, SEL, NSString*)>(_cmd)(self, _cmd, title);
}

- (NSString*)title
{
    return windowMethod<NSString* (*)(id, SEL)>(_cmd)(self, _cmd);
}

- (id)delegate
{
    return windowMethod<id (*)(id, SEL)>(_cmd)(self, _cmd);
}

- (void)setDelegate:(id)delegate
{
    windowMethod<void (*)(id, SEL, id)>(_cmd)(self, _cmd, delegate);
    // Whoever is gone is not told what was left to be told.
    if (!delegate)
        [self forgetPendingWork];
}

- (void)setPrompt:(NSString*)prompt
{
    [mOK setTitle:prompt];
}

- (NSString*)prompt
{
    return [mOK title];
}

- (NSView*)accessoryView
{
    return mAccessory;
}

- (void)setAccessoryView:(NSView*)view
{
    if (view == mAccessory)
        return;
    [mAccessory removeFromSuperview];
    [mAccessory release];
    mAccessory = [view retain];
    mAccessoryHeight = 0;
    if (view)
        [self growFor:view];
    [self placeParts];
}

// The folder is read when somebody looks, or when the event that is being handled is over: to be sent away
// and back costs one question more to the delegate, and nothing of what shows is lost.
- (void)setDirectory:(NSString*)folder
{
    mState->wanted = nearestFolder(bytes([folder stringByStandardizingPath]));
    [self bringUpToDateSoon];
}

- (void)setDirectoryURL:(NSURL*)url
{
    [self setDirectory:[url path]];
}

- (NSString*)directory
{
    return string(mState->wanted);
}

- (NSURL*)directoryURL
{
    return [NSURL fileURLWithPath:[self directory]];
}

- (NSArray*)filenames
{
    [self bringUpToDate];
    NSMutableArray* paths = [NSMutableArray array];
    for (const std::string& path : mState->chosen)
        [paths addObject:string(path)];
    return paths;
}

- (NSString*)filename
{
    NSArray* paths = [self filenames];
    return [paths count] ? [paths objectAtIndex:0] : nil;
}

- (NSArray*)URLs
{
    NSMutableArray* urls = [NSMutableArray array];
    for (NSString* path : tsuiEach<NSString*>([self filenames]))
        [urls addObject:[NSURL fileURLWithPath:path]];
    return urls;
}

- (NSURL*)URL
{
    NSArray* urls = [self URLs];
    return [urls count] ? [urls objectAtIndex:0] : nil;
}

- (void)setAllowsMultipleSelection:(BOOL)allows
{
    mChoosesSeveral = allows;
    [mTable setAllowsMultipleSelection:allows];
}

- (BOOL)allowsMultipleSelection
{
    return mChoosesSeveral;
}

- (void)setCanChooseDirectories:(BOOL)allows
{
    mChoosesFolders = allows;
}

- (BOOL)canChooseDirectories
{
    return mChoosesFolders;
}

- (void)setTakesNewNames:(BOOL)takes
{
    mTakesNewNames = takes;
}

- (void)setTreatsFilePackagesAsDirectories:(BOOL)treats
{
    _treatsFilePackagesAsDirectories = treats;
    [self listAgain];
}

- (void)setShowsHiddenFiles:(BOOL)shows
{
    [mHidden setState:shows ? NSOnState : NSOffState];
    [self listAgain];
}

- (BOOL)showsHiddenFiles
{
    return [mHidden state] == NSOnState;
}

- (void)validateVisibleColumns
{
    [self listAgain];
    mState->isAsked = true;
    [self bringUpToDateSoon];
}

- (NSInteger)runModal
{
    [self bringUpToDate];
    [self updateDefaultButton];
    [self showRecentFolders];
    [self fitOnScreen];
    [self recalculateKeyViewLoop];
    [self makeFirstResponder:mTakesNewNames ? (NSView*)mName : mTable];
    [self startWatching];
    @try
    {
        // It comes to the front by this, and not before: only then is it known which window it belongs to.
        return [NSApp runModalForWindow:self];
    }
    @finally
    {
        [self stopWatching];
        [self rememberFolder];
        [self rememberColumns];
        [self orderOut:self];
    }
}

- (BOOL)delegateTakesChoice
{
    if (![[self delegate] respondsToSelector:@selector(panel:validateURL:error:)])
        return YES;
    for (NSURL* url : tsuiEach<NSURL*>([self URLs]))
        if (![[self delegate] panel:self validateURL:url error:nullptr])
            return NO;
    return YES;
}

- (void)ok:(id)sender
{
    [self bringUpToDate];
    if ([self goIntoFolder] || [self tellOfMissingFile] || mState->chosen.empty() ||
        ![self delegateTakesChoice])
        return;
    [NSApp stopModalWithCode:NSModalResponseOK];
}

// A window over the panel runs a modal session of its own, which is not this panel's to end.
- (void)cancel:(id)sender
{
    if ([NSApp modalWindow] == self)
        [NSApp stopModalWithCode:NSModalResponseCancel];
}

// The toolkit asks this of every key before anybody else gets it.
- (BOOL)performKeyEquivalent:(NSEvent*)event
{
    return [self takeKey:event] || [super performKeyEquivalent:event];
}

@end

NSOpenPanel* tsuiMakeFilePanel()
{
    return [[[TsUIFilePanel alloc] init] autorelease];
}

bool tsuiTellOfMissingFile(NSOpenPanel* panel)
{
    return [panel isKindOfClass:[TsUIFilePanel class]] && [(TsUIFilePanel*)panel tellOfMissingFile];
}
