// A window that is not closable cannot tell the window manager so: there is a close button all the same, and
// who presses it ends the program. Here every window with a title bar is closable.
#import <AppKit/AppKit.h>

#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/Behaviour.h"

namespace tessel::windowing
{
namespace
{
using MakeWindow = id (*)(id, SEL, NSRect, NSUInteger, NSBackingStoreType, BOOL);
MakeWindow toolkitMakeWindow;

id makeWindow(id window, SEL selector, NSRect content, NSUInteger style, NSBackingStoreType backing,
              BOOL defer)
{
    if (style & NSTitledWindowMask)
        style |= NSClosableWindowMask;
    return toolkitMakeWindow(window, selector, content, style, backing, defer);
}

BOOL cancelPanel(id panel, SEL, id sender)
{
    [panel cancel:sender];
    return NO;
}

BOOL answerAlert(id, SEL, id)
{
    [NSApp stopModalWithCode:NSAlertFirstButtonReturn];
    return NO;
}

// What a window does that is about to be closed. Windows that know already keep to it.
void onClosing(const char* className, BOOL (*closing)(id, SEL, id))
{
    if (Class windowClass = objc_getClass(className))
        class_addMethod(windowClass, @selector(windowShouldClose:),
                        reinterpret_cast<IMP>(reinterpret_cast<void*>(closing)), "c@:@");
}
} // namespace

void makeWindowsClosable()
{
    toolkitMakeWindow =
        standInFor("NSWindow", @selector(initWithContentRect:styleMask:backing:defer:), makeWindow);
    onClosing("NSSavePanel", cancelPanel);
    onClosing("GSAlertPanel", answerAlert);
}
} // namespace tessel::windowing
