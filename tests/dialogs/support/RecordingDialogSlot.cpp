// The dialogs are the real ones here; what the shared fixture resets of recorded ones is of no use.
#include "tests/support/RecordingDialog.h"

RecordingDialog& recordingDialog()
{
    static RecordingDialog unused;
    return unused;
}
