// What comes from the display while the program does something else.
#include "tests/dialogs/support/DialogTest.h"
#include "tests/dialogs/support/Events.h"

#include <gtest/gtest.h>

// Moves the pointer over a window when its timer fires.
@interface PointerMover : NSObject
{
    NSView* mView;
}
- (id)initWithView:(NSView*)view;
- (void)move:(NSTimer*)timer;
@end

@implementation PointerMover

- (id)initWithView:(NSView*)view
{
    self = [super init];
    mView = view;
    return self;
}

- (void)move:(NSTimer*)timer
{
    events::sendPointerTo(mView, events::middleOf([mView bounds]));
}

@end

namespace
{
class Input : public DialogTest
{
protected:
    void SetUp() override
    {
        DialogTest::SetUp();
        mWindow = [[[NSWindow alloc] initWithContentRect:NSMakeRect(200, 200, 100, 100)
                                               styleMask:NSBorderlessWindowMask
                                                 backing:NSBackingStoreBuffered
                                                   defer:NO] autorelease];
        [mWindow setReleasedWhenClosed:NO];
        [mWindow setAcceptsMouseMovedEvents:YES];
        [mWindow orderFront:nil];
        events::movePointerTo([mWindow contentView], NSZeroPoint);
    }
    void TearDown() override
    {
        [mWindow orderOut:nil];
        DialogTest::TearDown();
    }

    NSWindow* mWindow = nil;
};
} // namespace

// A release, say, which is read together with the answer to a question that was put to the display.
TEST_F(Input, IsTakenAtOnceWhenItCameRightBeforeTheWait)
{
    PointerMover* mover = [[[PointerMover alloc] initWithView:[mWindow contentView]] autorelease];
    NSTimer* timer = [NSTimer timerWithTimeInterval:0
                                             target:mover
                                           selector:@selector(move:)
                                           userInfo:nil
                                            repeats:NO];
    [[NSRunLoop currentRunLoop] addTimer:timer forMode:NSEventTrackingRunLoopMode];
    EXPECT_NE(nil, [NSApp nextEventMatchingMask:NSMouseMovedMask
                                      untilDate:[NSDate dateWithTimeIntervalSinceNow:3]
                                         inMode:NSEventTrackingRunLoopMode
                                        dequeue:YES]);
}
