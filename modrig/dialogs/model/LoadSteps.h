// What the Load button does, step by step.
#pragma once

#include <functional>

namespace ModrigUtils
{
// What a dialog knows and can do about loading. None of the functions may be missing.
struct LoadSteps
{
    // Whether any files are chosen, now.
    std::function<bool()> hasChosenFiles;
    // Tells of a file that the person has typed the name of and that is not there; false when there is no
    // such name.
    std::function<bool()> tellsOfMissingFile;
    // Chooses the files that still show as selected, or says that there are none.
    std::function<void()> chooseWhatIsStillSelected;
    // Goes into the host's own folder when that is all that is chosen, and answers whether it did.
    std::function<bool()> goesIntoHostFolder;
    std::function<void()> loadChosenFiles;
    // The next dialog opens in the folder that shows.
    std::function<void()> rememberFolder;
};

// Loads the files that are chosen. A name that no file has ends it, and so does going into a folder: nothing
// is loaded then, and no folder is remembered. It is remembered when nothing is chosen.
void PressLoad(const LoadSteps& steps);
} // namespace ModrigUtils
