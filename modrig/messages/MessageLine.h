// Where the dialog shows what else goes to the command line. The dialogs define it; a unit test does so too.
#pragma once

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
// Shows the text in the message line of the open Load/Unload dialog; without one nothing happens.
void SetDialogMessage(const CStdStr& text);
} // namespace ModrigUtils
