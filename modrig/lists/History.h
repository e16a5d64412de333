// The History list: files loaded before, offered again in the dialog.
#pragma once

namespace ModrigUtils
{
// Replaces `gHistoryList` with what is stored. A missing count leaves it empty.
void InitializeHistoryFiles();

// Stores `gHistoryList` whole, in place of what was stored. A failure is told in a message box.
void WriteHistoryFilesToRegistry();
} // namespace ModrigUtils
