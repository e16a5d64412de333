// The road to the dialogs, for benchmarks that open none.
#include "modrig/messages/MessageLine.h"
#include "modrig/module/DialogBridge.h"

namespace ModrigUtils
{
void SetDialogMessage(const CStdStr&)
{
}
void RunModrigDialog()
{
}
} // namespace ModrigUtils
