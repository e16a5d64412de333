#include "module/DialogBridge.h"

#import <AppKit/AppKit.h>

#include <tessel/tsformat.h>
#include <tesselui/tsuidisplay.h>

#import "ui/ModrigController.h"
#import "ui/TsOCModrigUtil.h"

#include "ui/Paths.h"

namespace
{
// What went wrong in the toolkit ends the dialog, not the host.
void SayWhatFailed(NSException* exception)
{
    NSString* text = [NSString stringWithFormat:@"%@: %@", [exception name], [exception reason]];
    const CStdStr reason = ModrigUtils::PathFromString(text);
    tsutPrintf(L"The Load/Unload Applications dialog was closed by an error of the toolkit, %s.\n",
               reason.c_str());
}

void RunDialog()
{
    ModrigController* controller = [[ModrigController alloc] init];
    @try
    {
        [controller showModrigDialog];
    }
    @catch (NSException* exception)
    {
        SayWhatFailed(exception);
    }
    [controller release];
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
        RunDialog();
    [pool drain];
    tsuiFinishWindows();
}
} // namespace ModrigUtils
