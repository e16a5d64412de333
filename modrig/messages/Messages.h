// How the module speaks to its user: the command line, message boxes, help. Texts come by id from the current
// resource module (MessageIds.h); a missing id gives an empty text.
#pragma once

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
// Puts the text into the message line of the open dialog. Prints nothing.
void ModrigCmdlineMessage(const CStdStr& text);

// Prints message `id` about a file, named without its folder, on the host's command line and shows it in the
// open dialog. An empty path: the message as it stands.
void ModrigCmdlineMessage(unsigned id, CStdStr path);

// The same about a number of files. Nothing happens for 0.
void ModrigCmdlineMessage(unsigned id, unsigned count);

// What was done to `count` files: message `oneId` with the path for exactly one, else `manyId` with the
// count.
void ModrigCmdlineSummary(unsigned oneId, unsigned manyId, unsigned count, const CStdStr& path);

// Shows a message box with an OK button. The argument (a whole path, a limit) is formatted into message `id`;
// an empty one leaves the message as it stands.
void ModrigAfxMessageBox(unsigned id, CStdStr argument);
void ModrigAfxMessageBox(const CStdStr& text);

// Opens the help page of a dialog.
inline constexpr int kMainDialogHelp = 0;
inline constexpr int kStartupSuiteHelp = 1;
inline constexpr int kFileSelectionHelp = 2;
void OnCommandHelp(int topic);
} // namespace ModrigUtils
