#include "host/ui/SessionEnd.h"

#import <AppKit/AppKit.h>

#include <tessel/tssession.h>
#include <tesselui/tsuieach.h>

#include <poll.h>

namespace
{
constexpr NSTimeInterval kBetweenWindows = 0.02;

// A loop looks whether it was stopped when it has an event.
NSEvent* wakeUp()
{
    return [NSEvent otherEventWithType:NSApplicationDefined
                              location:NSZeroPoint
                         modifierFlags:0
                             timestamp:0
                          windowNumber:0
                               context:nil
                               subtype:0
                                 data1:0
                                 data2:0];
}

// What an open menu waits for, and a control that is held down. Outside of everything: nothing is chosen.
NSEvent* releaseOfTheMouse()
{
    return [NSEvent mouseEventWithType:NSLeftMouseUp
                              location:NSMakePoint(-1, -1)
                         modifierFlags:0
                             timestamp:0
                          windowNumber:[[NSApp modalWindow] windowNumber]
                               context:nil
                           eventNumber:0
                            clickCount:1
                              pressure:0];
}
} // namespace

// Lives as long as the process. Windows lie over one another, and whoever opened one may open the next as
// soon as it has closed: so it looks again and again, from the request on.
@interface TsUISessionEnd : NSObject
- (void)watch:(int)descriptor;
@end

@implementation TsUISessionEnd

- (NSArray*)modes
{
    return [NSArray
        arrayWithObjects:NSModalPanelRunLoopMode, NSEventTrackingRunLoopMode, NSDefaultRunLoopMode, nil];
}

- (void)watch:(int)descriptor
{
    NSFileHandle* request = [[NSFileHandle alloc] initWithFileDescriptor:descriptor closeOnDealloc:NO];
    [[NSNotificationCenter defaultCenter] addObserver:self
                                             selector:@selector(onRequest:)
                                                 name:NSFileHandleDataAvailableNotification
                                               object:request];
    [request waitForDataInBackgroundAndNotifyForModes:[self modes]];
}

- (void)onRequest:(NSNotification*)notification
{
    NSTimer* timer = [NSTimer timerWithTimeInterval:kBetweenWindows
                                             target:self
                                           selector:@selector(closeFrontWindow:)
                                           userInfo:nil
                                            repeats:YES];
    for (NSString* mode : tsuiEach<NSString*>([self modes]))
        [[NSRunLoop currentRunLoop] addTimer:timer forMode:mode];
}

- (void)closeFrontWindow:(NSTimer*)timer
{
    tessel::cancelFrontWindow();
}

@end

void tessel::closeWindowsWhenTheSessionEnds()
{
    const int descriptor = tsrxEndRequest();
    if (descriptor >= 0)
        [[[TsUISessionEnd alloc] init] watch:descriptor];
}

void tessel::cancelFrontWindow()
{
    if (![NSApp modalWindow])
        return;
    [NSApp stopModalWithCode:NSModalResponseCancel];
    const bool tracking =
        [[[NSRunLoop currentRunLoop] currentMode] isEqualToString:NSEventTrackingRunLoopMode];
    [NSApp postEvent:tracking ? releaseOfTheMouse() : wakeUp() atStart:YES];
}

bool tessel::sessionIsToEnd()
{
    pollfd request{tsrxEndRequest(), POLLIN, 0};
    return poll(&request, 1, 0) > 0;
}
