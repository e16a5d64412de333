#include "modrig/dialogs/LongLoad.h"

#import "modrig/dialogs/ModrigController.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

#include "modrig/dialogs/Paths.h"
#include "modrig/dialogs/platform/Waiting.h"

namespace ModrigUtils
{
namespace
{
using Clock = std::chrono::steady_clock;

// Whether Escape has been pressed. The keys that have been pressed until now are taken, whatever they were.
bool TakeEscape()
{
    constexpr unichar kEscape = 0x1B;
    bool escape = false;
    while (NSEvent* event = [NSApp nextEventMatchingMask:NSKeyDownMask
                                               untilDate:[NSDate distantPast]
                                                  inMode:NSEventTrackingRunLoopMode
                                                 dequeue:YES])
        escape |= [[event characters] length] == 1 && [[event characters] characterAtIndex:0] == kEscape;
    return escape;
}
} // namespace

LongLoad::LongLoad(ModrigController* controller, std::size_t files)
    : mController(controller), mWindow([[[controller view] window] retain]), mFiles(files),
      mProgress(Clock::now())
{
    ModrigPlatform::ShowWaitCursor(mWindow);
}

LongLoad::~LongLoad()
{
    ModrigPlatform::EndWaitCursor(mWindow);
    [mWindow release];
}

bool LongLoad::IsStopped(std::size_t done)
{
    const LoadProgress::Time now = Clock::now();
    if (mProgress.IsTimeToTell(now))
        Say(@"IDS_MODRIG_LOADING", done);
    if (!mProgress.IsTimeToLook(now) || !TakeEscape())
        return false;
    Say(@"IDS_MODRIG_LOADING_STOPPED", done);
    return true;
}

void LongLoad::Say(NSString* key, std::size_t done) const
{
    CStdStr text;
    text.Fmt(PathFromString([TsOCModrigUtil modrigLoadString:key]).c_str(), static_cast<unsigned>(done),
             static_cast<unsigned>(mFiles));
    [mController setMessage:StringFromPath(text)];
    ModrigPlatform::DrawNow(mWindow);
}
} // namespace ModrigUtils
