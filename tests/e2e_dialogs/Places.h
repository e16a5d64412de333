// Where things lie in the dialogs, in the size that they open in.
#pragma once

#include "tests/e2e_dialogs/Screen.h"

namespace places
{
inline constexpr int kTableRowHeight = 18;
inline constexpr int kFileRowHeight = 20;

// The main dialog
inline constexpr int kDialogWidth = 750;
inline constexpr Place kFileTypes{230, 375};
inline constexpr Place kAddToHistory{575, 405};
inline constexpr Place kLoad{640, 376};
inline constexpr Place kLoadedTab{100, 410};
inline constexpr Place kHistoryTab{214, 410};
inline constexpr Place kUnload{475, 631};
inline constexpr Place kAddToStartupSuite{206, 631};
inline constexpr Place kLoadFromHistory{70, 631};
inline constexpr Place kRemoveFromHistory{475, 631};
inline constexpr Place kStartupSuiteBox{640, 545};
inline constexpr Place kContents{640, 620};
inline constexpr Place kName{300, 330};
inline constexpr Place kHiddenFiles{600, 330};
inline constexpr Place kEndOfNames{461, 51}; // between the headers of the first two columns
inline constexpr Place kHelp{50, 708};
inline constexpr Place kClose{697, 708};

// The Startup Suite dialog
inline constexpr int kSuiteWidth = 560;
inline constexpr Place kAdd{30, 330};
inline constexpr Place kRemove{67, 330};
inline constexpr Place kSuiteHelp{386, 330};
inline constexpr Place kCloseSuite{496, 330};
inline constexpr Place kFirstSuiteRow{80, 89};
inline constexpr Place kKeepOutInSuiteMenu{40, 130}; // from where the menu was opened

// A row of the table that shows, and of the list of files; that of the Add panel stands in the same place.
constexpr Place tableRow(int row)
{
    return {80, 464 + row * kTableRowHeight};
}
constexpr Place file(int row)
{
    return {120, 73 + row * kFileRowHeight};
}
} // namespace places
