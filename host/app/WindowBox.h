// The message box as a window, from the library of the host's windows.
#pragma once

#include <filesystem>

#include "host/messages/MessageBox.h"

namespace tessel
{
class Admission;

// Whether there is a display, and it answers. Asked of that library too.
bool canShowWindows(const std::filesystem::path& libraryFolder);

// Boxes are windows from now on, also without a terminal that would tell of somebody. `libraryFolder`: as
// above.
void expectSomebodyAtTheDisplay(const std::filesystem::path& libraryFolder);

// Loads the library that stands in that folder when the first box is to be shown and there is a display: a
// session that shows none does not carry the toolkit.
MessageBox::Presenter windowBoxes(const std::filesystem::path& libraryFolder);

// What is refused in a safe session was meant to be: a box for each, before the person gets to the window
// that they have asked for, would tell nothing that they do not know.
MessageBox::Presenter quietWhenSafe(MessageBox::Presenter show, const Admission& admission);
} // namespace tessel
