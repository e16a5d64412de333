// Lists that are longer than the screen.
#pragma once

#include <string>

namespace tessel
{
// Shows the text by the program that PAGER names, or else by `less`, and waits until the person has left it.
// False when nothing could be shown: there is no such program, it has failed, PAGER is empty, or the terminal
// is too plain for `less`. Ctrl-C and Ctrl-Z are for that program meanwhile.
bool showInPager(const std::string& text);
} // namespace tessel
