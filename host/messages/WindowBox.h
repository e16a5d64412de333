// The message box as a window, from the library of the host's windows.
#pragma once

#include <filesystem>

#include "host/messages/MessageBox.h"

namespace tessel
{
// Loads the library that stands in that folder when the first box is to be shown and there is a display: a
// session that shows none does not carry the toolkit.
MessageBox::Presenter windowBoxes(const std::filesystem::path& libraryFolder);
} // namespace tessel
