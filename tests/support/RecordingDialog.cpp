#include "tests/support/RecordingDialog.h"

#include "modrig/messages/MessageLine.h"
#include "modrig/module/DialogBridge.h"

RecordingDialog& recordingDialog()
{
    static RecordingDialog dialog;
    return dialog;
}

namespace ModrigUtils
{
void SetDialogMessage(const CStdStr& text)
{
    recordingDialog().messages.push_back(text.Text());
    if (recordingDialog().duringMessage)
        recordingDialog().duringMessage();
}

void RunModrigDialog()
{
    ++recordingDialog().runs;
    if (recordingDialog().duringRun)
        recordingDialog().duringRun();
}
} // namespace ModrigUtils
