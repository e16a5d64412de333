// What the command asks of the dialogs. They are Objective-C++ and build on everything else, so that the
// command knows them by this function alone.
#pragma once

namespace ModrigUtils
{
// Opens the Load/Unload dialog and returns when it is closed.
void RunModrigDialog();
} // namespace ModrigUtils
