// What the module's logic asks of the dialogs. The dialogs are Objective-C++ and build on everything else, so
// that the logic knows them by these functions alone.
#pragma once

#include "module/CStdStr.h"

namespace ModrigUtils
{
// Shows the text in the message line of the open Load/Unload dialog; without one nothing happens.
void SetDialogMessage(const CStdStr& text);

// Opens the Load/Unload dialog and returns when it is closed.
void RunModrigDialog();
} // namespace ModrigUtils
