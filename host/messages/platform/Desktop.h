// What differs between the desktops when a page is to be shown.
#pragma once

#include <string>
#include <vector>

namespace tessel
{
bool hasDisplay();

// Programs that show a page in the person's browser, the preferred one first.
std::vector<std::string> pageOpeners();
} // namespace tessel
