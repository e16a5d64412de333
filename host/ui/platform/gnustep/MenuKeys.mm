// While a menu is open the toolkit waits for the mouse alone. Keys wait, too, and go to the window under the
// menu when that has closed: Escape would close the window with it.
#import <AppKit/AppKit.h>

#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/Behaviour.h"

namespace
{
constexpr NSTimeInterval kBetweenLooks = 0.03;
constexpr unichar kEscape = 0x1B;

bool isEscape(NSEvent* event)
{
    NSString* characters = [event characters];
    return [characters length] == 1 && [characters characterAtIndex:0] == kEscape;
}
} // namespace

// Takes the keys that are pressed while one menu is open.
@interface TsUIMenuKeys : NSObject
{
    NSEventType mRelease; // of the button that the menu was opened with
    NSInteger mWindow;
    BOOL mCloses;
}
- (id)initForMenuOpenedBy:(NSEvent*)event;
- (void)takeKeys:(NSTimer*)timer;
@end

@implementation TsUIMenuKeys

- (id)initForMenuOpenedBy:(NSEvent*)event
{
    self = [super init];
    if (!self)
        return nil;
    const NSEventType type = [event type];
    mRelease = type == NSRightMouseDown || type == NSRightMouseDragged ? NSRightMouseUp : NSLeftMouseUp;
    mWindow = [event windowNumber];
    return self;
}

// Outside of everything, so that nothing is chosen.
- (void)letGo
{
    [NSApp postEvent:[NSEvent mouseEventWithType:mRelease
                                        location:NSMakePoint(-10000, -10000)
                                   modifierFlags:0
                                       timestamp:0
                                    windowNumber:mWindow
                                         context:nil
                                     eventNumber:0
                                      clickCount:1
                                        pressure:0]
             atStart:YES];
}

- (void)takeKeys:(NSTimer*)timer
{
    (void)timer;
    while (NSEvent* key = [NSApp nextEventMatchingMask:NSKeyDownMask
                                             untilDate:[NSDate distantPast]
                                                inMode:NSEventTrackingRunLoopMode
                                               dequeue:YES])
        mCloses = mCloses || isEscape(key);
    // The release of a button that a person holds down can leave the menu open, as that of a click does.
    if (mCloses)
        [self letGo];
}

@end

namespace tessel::windowing
{
namespace
{
using Track = BOOL (*)(NSMenuView*, SEL, NSEvent*);
Track toolkitTrack;

BOOL track(NSMenuView* menu, SEL selector, NSEvent* event)
{
    TsUIMenuKeys* keys = [[[TsUIMenuKeys alloc] initForMenuOpenedBy:event] autorelease];
    NSTimer* timer = [NSTimer timerWithTimeInterval:kBetweenLooks
                                             target:keys
                                           selector:@selector(takeKeys:)
                                           userInfo:nil
                                            repeats:YES];
    [[NSRunLoop currentRunLoop] addTimer:timer forMode:NSEventTrackingRunLoopMode];
    const BOOL tracked = toolkitTrack(menu, selector, event);
    [timer invalidate];
    return tracked;
}
} // namespace

void letEscapeCloseMenus()
{
    if (!toolkitTrack)
        toolkitTrack = standInFor("NSMenuView", @selector(trackWithEvent:), track);
}
} // namespace tessel::windowing
