#include "modrig/module/DialogBridge.h"

#import <AppKit/AppKit.h>

#include <tessel/tsformat.h>
#include <tesselui/tsuidisplay.h>
#include <tesselui/tsuierrors.h>

#import "modrig/dialogs/ModrigController.h"
#import "modrig/dialogs/TsOCModrigUtil.h"

#include "modrig/dialogs/Paths.h"
#include "modrig/dialogs/model/ShownText.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/messages/MessageLine.h"

namespace
{
// The controller goes out through the pointer, so that it can be released also when showing it fails.
void RunDialog(void* controller)
{
    ModrigController*& dialog = *static_cast<ModrigController**>(controller);
    dialog = [[ModrigController alloc] init];
    [dialog showModrigDialog];
}

// What went wrong in the toolkit ends the dialog, not the host.
void SayWhatFailed(NSString* error)
{
    const CStdStr reason = ModrigUtils::PathFromString(error);
    const CStdStr text = CStdStr::Formatted(ModrigMessages::kDialogFailed, reason.c_str());
    tsutPrintf(L"%s\n", text.c_str());
}

void ShowDialog()
{
    ModrigController* controller = nil;
    NSString* error = tsuiErrorOf(RunDialog, &controller);
    // Before the pool is drained: what the controller lends out while it goes belongs into that pool.
    [controller release];
    if (error)
        SayWhatFailed(error);
}
} // namespace

namespace ModrigUtils
{
void SetDialogMessage(const CStdStr& text)
{
    [[TsOCModrigUtil getModrigController] setMessage:StringFromPath(ShownText(text))];
}

void RunModrigDialog()
{
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    if (tsuiPrepareWindows())
        ShowDialog();
    [pool drain];
    tsuiFinishWindows();
}
} // namespace ModrigUtils
