// What comes from the display. The toolkit loses a part of it in its waits: a tap, whose press and release
// come at once, left a button down or a row pressed until the next click.
#import <AppKit/AppKit.h>
#import <GNUstepGUI/GSDisplayServer.h>

#include <cstdint>
#include <utility>

#include "host/platform/gnustep/StandIn.h"
#include "host/ui/platform/gnustep/Behaviour.h"
#include "host/ui/platform/gnustep/WindowHints.h"

namespace tessel::windowing
{
namespace
{
using ShouldBlock = BOOL (*)(id, SEL, BOOL*);
using PollUntil = BOOL (*)(id, SEL, int, NSArray*);
using ReceivedEvent = void (*)(id, SEL, void*, RunLoopEventType, void*, NSString*);
using AcceptOrderedInput = void (*)(id, SEL, NSString*, NSDate*);
ShouldBlock toolkitShouldBlock;
PollUntil toolkitPollUntil;
ReceivedEvent toolkitReceivedEvent;
AcceptOrderedInput toolkitAcceptOrderedInput;

// Threads have run loops of their own, and no display.
thread_local bool inputWaits = false;
thread_local bool takesInput = false;

// Says so for a time, however that ends.
class Noted
{
public:
    Noted(bool& note, bool value) : mNote(note), mBefore(std::exchange(note, value)) {}
    ~Noted() { mNote = mBefore; }
    Noted(const Noted&) = delete;
    Noted& operator=(const Noted&) = delete;

private:
    bool& mNote;
    bool mBefore;
};

// The display is not watched for the time, by waits for answers of other programs.
class DisplayUnwatched
{
public:
    DisplayUnwatched()
    {
        [[NSRunLoop currentRunLoop] removeEvent:descriptor()
                                           type:ET_RDESC
                                        forMode:NSConnectionReplyMode
                                            all:YES];
    }
    ~DisplayUnwatched()
    {
        [[NSRunLoop currentRunLoop] addEvent:descriptor()
                                        type:ET_RDESC
                                     watcher:(id<RunLoopEvents>)GSCurrentServer()
                                     forMode:NSConnectionReplyMode];
    }
    DisplayUnwatched(const DisplayUnwatched&) = delete;
    DisplayUnwatched& operator=(const DisplayUnwatched&) = delete;

private:
    // The run loop keeps numbers of files as pointers.
    static void* descriptor()
    {
        const int number = connectionNumber([GSCurrentServer() serverDevice]);
        return reinterpret_cast<void*>(static_cast<std::intptr_t>(number));
    }
};

BOOL shouldBlock(id server, SEL selector, BOOL* trigger)
{
    const BOOL blocks = toolkitShouldBlock(server, selector, trigger);
    inputWaits = inputWaits || !blocks;
    return blocks;
}

// What the display's library has read already is taken at once, but the toolkit does not count it as input
// and waits on for more: whoever waits for that event is not told of it.
BOOL pollUntil(id context, SEL selector, int milliseconds, NSArray* contexts)
{
    const Noted noInput(inputWaits, false);
    const BOOL hadInput = toolkitPollUntil(context, selector, milliseconds, contexts);
    return hadInput || inputWaits;
}

void receivedEvent(id server, SEL selector, void* data, RunLoopEventType type, void* extra, NSString* mode)
{
    const Noted taking(takesInput, true);
    toolkitReceivedEvent(server, selector, data, type, extra, mode);
}

// To take an event may need an answer of another program of the toolkit: the first press of a session asks
// how the mouse is set up. What comes from the display during that wait would overtake the event.
void acceptOrderedInput(id loop, SEL selector, NSString* mode, NSDate* limit)
{
    if (!takesInput || ![mode isEqualToString:NSConnectionReplyMode])
        return toolkitAcceptOrderedInput(loop, selector, mode, limit);
    const DisplayUnwatched unwatched;
    toolkitAcceptOrderedInput(loop, selector, mode, limit);
}
} // namespace

void takeInputInItsOrder()
{
    toolkitShouldBlock = standInFor("XGServer", @selector(runLoopShouldBlock:), shouldBlock);
    toolkitPollUntil = standInFor("GSRunLoopCtxt", @selector(pollUntil:within:), pollUntil);
    toolkitReceivedEvent =
        standInFor("XGServer", @selector(receivedEvent:type:extra:forMode:), receivedEvent);
    toolkitAcceptOrderedInput =
        standInFor("NSRunLoop", @selector(acceptInputForMode:beforeDate:), acceptOrderedInput);
}
} // namespace tessel::windowing
