// Modrig with a dialog that a test plays. What a person does in the dialog, the test does by these functions,
// from within the command MODRIG (`playDialog`), where the module's texts are current and the host knows who
// is calling.
#pragma once

#include <functional>
#include <string>
#include <vector>

#include <tessel/tsdefs.h>
#include <wincompat/winfile.h>

namespace ModrigUnderTest
{
using Paths = std::vector<std::wstring>;

// What happens while the dialog is open, from the next MODRIG on.
TESSEL_EXPORT void playDialog(std::function<void()> actions);

// What the message line has shown since it was last asked.
TESSEL_EXPORT Paths messageLine();

// The three lists as they are.
TESSEL_EXPORT Paths loaded();
TESSEL_EXPORT Paths startup();
TESSEL_EXPORT Paths history();
TESSEL_EXPORT void replaceStartup(const Paths& paths);
TESSEL_EXPORT void replaceHistory(const Paths& paths);

// What the dialog does when it opens, for its buttons, and when it closes.
TESSEL_EXPORT void populate();
TESSEL_EXPORT int load(const std::wstring& path, bool addToHistory, bool addToStartup);
TESSEL_EXPORT std::vector<std::size_t> unload(const Paths& selection);
TESSEL_EXPORT bool mayBeUnloaded(const std::wstring& path);
TESSEL_EXPORT void close();

// What it asks about a file.
TESSEL_EXPORT bool isLoaded(const std::wstring& path);
TESSEL_EXPORT DWORD findFile(std::wstring& path);
TESSEL_EXPORT void fetch(std::wstring& path);
TESSEL_EXPORT bool isTemporaryInternetFile(const std::wstring& path);

// Unloads rows that were made when all of them could be unloaded.
TESSEL_EXPORT std::vector<std::size_t> unloadAsListedUnloadable(const Paths& selection);
} // namespace ModrigUnderTest
