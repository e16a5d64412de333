#include "module/DialogBridge.h"

#import <AppKit/AppKit.h>

#include <tessel/tsformat.h>
#include <tesselui/tsuidisplay.h>
#include <tesselui/tsuierrors.h>

#import "ui/ModrigController.h"
#import "ui/TsOCModrigUtil.h"

#include "ui/Paths.h"

namespace
{
void RunDialog(void*)
{
    ModrigController* controller = [[[ModrigController alloc] init] autorelease];
    [controller showModrigDialog];
}

// What went wrong in the toolkit ends the dialog, not the host.
void SayWhatFailed(NSString* error)
{
    const CStdStr reason = ModrigUtils::PathFromString(error);
    tsutPrintf(L"The Load/Unload Applications dialog was closed by an error of the toolkit: %s.\n",
               reason.c_str());
}
} // namespace

namespace ModrigUtils
{
void SetDialogMessage(const CStdStr& text)
{
    [[TsOCModrigUtil getModrigController] setMessage:StringFromPath(text)];
}

void RunModrigDialog()
{
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    if (tsuiPrepareWindows())
        if (NSString* error = tsuiErrorOf(RunDialog, nullptr))
            SayWhatFailed(error);
    [pool drain];
    tsuiFinishWindows();
}
} // namespace ModrigUtils
