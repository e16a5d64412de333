// The Startup Suite: the applications that are loaded whenever the module starts.
#pragma once

namespace ModrigUtils
{
// Replaces `gStartupList` with what is stored and loads each application as it joins the list. A file that
// cannot be loaded is reported, stays in the Suite and does not keep the others from loading. Nothing loaded
// here joins the History. Also clears `gbOrreryLoaded`.
void InitializeStartupFiles();

// Stores `gStartupList` whole, in place of what was stored. A failure is told in a message box.
void WriteStartupFilesToRegistry();
} // namespace ModrigUtils
