// Where things lie in the dialogs, in the size that they open in.
#pragma once

#include "tests/e2e_dialogs/Screen.h"

namespace places
{
inline constexpr int kRowHeight = 20;
inline constexpr int kBrowserRowHeight = 15;

// The main dialog
inline constexpr int kDialogWidth = 750;
inline constexpr Place kFileTypes{250, 390};
inline constexpr Place kAddToHistory{385, 390};
inline constexpr Place kLoad{676, 390};
inline constexpr Place kLoadedTab{100, 425};
inline constexpr Place kHistoryTab{219, 425};
inline constexpr Place kUnload{471, 646};
inline constexpr Place kAddToStartupSuite{206, 646};
inline constexpr Place kLoadFromHistory{70, 646};
inline constexpr Place kRemoveFromHistory{471, 646};
inline constexpr Place kStartupSuiteBox{636, 560};
inline constexpr Place kContents{636, 635};
inline constexpr Place kName{400, 720};
inline constexpr Place kHelp{50, 750};
inline constexpr Place kClose{705, 750};

// The Startup Suite dialog
inline constexpr int kSuiteWidth = 560;
inline constexpr Place kAdd{30, 330};
inline constexpr Place kRemove{67, 330};
inline constexpr Place kSuiteHelp{386, 330};
inline constexpr Place kCloseSuite{496, 330};
inline constexpr Place kFirstFileToAdd{280, 105}; // in its panel
inline constexpr Place kFirstSuiteRow{80, 77};

// A row of the table that shows, and of the browser's last column.
constexpr Place tableRow(int row)
{
    return {80, 478 + row * kRowHeight};
}
constexpr Place file(int row)
{
    return {560, 105 + row * kBrowserRowHeight};
}
} // namespace places
