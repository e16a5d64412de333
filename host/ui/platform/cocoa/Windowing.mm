#include "host/ui/platform/Windowing.h"

#include <CoreFoundation/CoreFoundation.h>
#include <CoreGraphics/CoreGraphics.h>

#include <tesselui/tsuifilepanel.h>

namespace tessel::windowing
{
bool displayIsReachable()
{
    // A process outside of a login session has no window server to talk to.
    NSDictionary* session = [(NSDictionary*)CGSessionCopyCurrentDictionary() autorelease];
    return session != nil;
}

// A program of the platform has its settings by its bundle identifier, and its log, where the system keeps
// them.
void prepareToolkit(NSString*)
{
}

// The platform's own look and behaviour.
void chooseLook()
{
}

void completeLook()
{
    [NSApp setActivationPolicy:NSApplicationActivationPolicyRegular];
}

void completeBehaviour()
{
}

void runMessage(NSString* text, NSString* detail, bool warning)
{
    NSAlert* alert = [[[NSAlert alloc] init] autorelease];
    // The system sets the second text in smaller type, and lets it be selected.
    [alert setMessageText:[detail length] ? text : @"Tessel"];
    [alert setInformativeText:[detail length] ? detail : text];
    [alert setAlertStyle:warning ? NSAlertStyleWarning : NSAlertStyleInformational];
    [alert addButtonWithTitle:@"OK"];
    [alert runModal];
}

// The system asks by itself before a file that is there is to be replaced.
NSString* chooseFile(NSString* folder, NSString* name, bool mayBeNew)
{
    NSSavePanel* panel = mayBeNew ? [NSSavePanel savePanel] : [NSOpenPanel openPanel];
    [panel setDirectoryURL:[NSURL fileURLWithPath:folder]];
    [panel setNameFieldStringValue:name];
    return [panel runModal] == NSModalResponseOK ? [[panel URL] path] : nil;
}

// The panel hides it behind a button of its own unless it is told not to.
void showAccessoryView(NSOpenPanel* panel, NSView* view)
{
    [panel setAccessoryView:view];
    [panel setAccessoryViewDisclosed:YES];
}

void showFolder(NSOpenPanel* panel, NSString* folder)
{
    [panel setDirectory:folder];
    [panel setDirectoryURL:[NSURL fileURLWithPath:folder isDirectory:YES]];
}

namespace
{
// Who was in front when windows opened: the terminal that Tessel runs in.
NSRunningApplication* gBefore = nil;
} // namespace

void comeToFront()
{
    NSRunningApplication* front = [[NSWorkspace sharedWorkspace] frontmostApplication];
    if (front && ![front isEqual:[NSRunningApplication currentApplication]])
    {
        [gBefore release];
        gBefore = [front retain];
    }
    [NSApp activateIgnoringOtherApps:YES];
}

// The program would stay in front without a window, and keys would go nowhere.
void leaveScreen()
{
    if ([NSApp isActive])
        [gBefore activateWithOptions:0];
}

namespace
{
void onWait(CFRunLoopObserverRef, CFRunLoopActivity, void* call)
{
    reinterpret_cast<void (*)()>(call)();
}
} // namespace

// Every run of the loop waits in one of its common modes: events, modal windows, menus.
void callBeforeEachWait(void (*call)())
{
    CFRunLoopObserverContext context = {};
    context.info = reinterpret_cast<void*>(call);
    CFRunLoopObserverRef observer =
        CFRunLoopObserverCreate(nullptr, kCFRunLoopBeforeWaiting, true, 0, onWait, &context);
    CFRunLoopAddObserver(CFRunLoopGetMain(), observer, kCFRunLoopCommonModes);
    CFRelease(observer);
}
} // namespace tessel::windowing

// The system's panel, a new one at each call.
NSOpenPanel* tsuiMakeFilePanel()
{
    return [NSOpenPanel openPanel];
}

// The system's panel has no field for names.
bool tsuiTellOfMissingFile(NSOpenPanel*)
{
    return false;
}
