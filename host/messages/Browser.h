// The browser of the person at the display.
#pragma once

#include <filesystem>

namespace tessel
{
// Opens the page in it. False when there is no display or no browser.
bool openInBrowser(const std::filesystem::path& page);
} // namespace tessel
