#include <unordered_set>
#include <utility>

#import "host/ui/platform/gnustep/filepanel/FilePanel.h"
#import "host/ui/platform/gnustep/filepanel/FileTable.h"
#include "host/ui/platform/gnustep/filepanel/PanelState.h"

using namespace tessel::filepanel;

namespace
{
constexpr NSTimeInterval kSecondsBetweenLooks = 0.5;
constexpr NSTimeInterval kSecondsToGather = 0.2; // changes seldom come alone, and are dealt with together

void* eventOf(int descriptor)
{
    return reinterpret_cast<void*>(static_cast<std::intptr_t>(descriptor));
}
} // namespace

@implementation TsUIFilePanel (Watching)

- (void)forgetDatesOf:(const std::vector<std::string>&)names
{
    const std::unordered_set<std::string> written(names.begin(), names.end());
    for (Entry& entry : mState->entries)
        if (written.contains(entry.name))
            entry.changed.reset();
    if (mState->order.column == Column::kDate)
        [self sortAgain];
    else
        [mTable setNeedsDisplay:YES];
}

// Of the files that show. The date of a folder does not tell of them.
- (void)lookAtDates
{
    const NSRange rows = [mTable rowsInRect:[mTable visibleRect]];
    std::vector<std::string> written;
    for (NSUInteger row = rows.location; row < NSMaxRange(rows) && row < mState->entries.size(); ++row)
    {
        const Entry& entry = mState->entries[row];
        if (entry.changed && *entry.changed != dateOf(mState->pathOf(entry)).value_or(0))
            written.push_back(entry.name);
    }
    if (!written.empty())
        [self forgetDatesOf:written];
}

- (void)lookForChanges:(NSTimer*)timer
{
    if (mState->wanted != mState->folder)
        return;
    if (stateOf(mState->folder) != mState->seen)
        [self listAgain];
    else
        [self lookAtDates];
}

- (void)takeChanges
{
    mState->isGathering = false;
    const FolderChanges changes = std::exchange(mState->changes, {});
    if (mState->wanted != mState->folder)
        return; // the folder that shows is on its way out
    if (changes.isOther)
        [self listAgain];
    else if (!changes.written.empty())
        [self forgetDatesOf:changes.written];
}

- (void)receivedEvent:(void*)data type:(RunLoopEventType)type extra:(void*)extra forMode:(NSString*)mode
{
    mState->changes.add(mState->watch.take());
    if (std::exchange(mState->isGathering, true))
        return;
    [self performSelector:@selector(takeChanges)
               withObject:nil
               afterDelay:kSecondsToGather
                  inModes:[NSArray arrayWithObject:NSModalPanelRunLoopMode]];
}

- (void)endWatch
{
    [mLooks invalidate];
    mLooks = nil;
    const int descriptor = mState->watch.descriptor();
    if (descriptor >= 0)
        [[NSRunLoop currentRunLoop] removeEvent:eventOf(descriptor)
                                           type:ET_RDESC
                                        forMode:NSModalPanelRunLoopMode
                                            all:YES];
    mState->watch.stop();
}

// Where nobody tells of changes, they are looked for.
- (void)watchFolder
{
    [self endWatch];
    if (!mIsWatching)
        return;
    NSRunLoop* loop = [NSRunLoop currentRunLoop];
    if (mState->watch.start(mState->folder))
        return [loop addEvent:eventOf(mState->watch.descriptor())
                         type:ET_RDESC
                      watcher:(id<RunLoopEvents>)self
                      forMode:NSModalPanelRunLoopMode];
    mLooks = [NSTimer timerWithTimeInterval:kSecondsBetweenLooks
                                     target:self
                                   selector:@selector(lookForChanges:)
                                   userInfo:nil
                                    repeats:YES];
    [loop addTimer:mLooks forMode:NSModalPanelRunLoopMode];
}

- (void)startWatching
{
    mIsWatching = YES;
    [self watchFolder];
    [self lookForChanges:nil];
}

- (void)stopWatching
{
    mIsWatching = NO;
    [self endWatch];
    [NSObject cancelPreviousPerformRequestsWithTarget:self selector:@selector(takeChanges) object:nil];
    mState->isGathering = false;
    mState->changes = {};
}

@end
