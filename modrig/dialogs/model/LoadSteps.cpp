#include "modrig/dialogs/model/LoadSteps.h"

namespace ModrigUtils
{
void PressLoad(const LoadSteps& steps)
{
    if (!steps.hasChosenFiles())
    {
        if (steps.tellsOfMissingFile())
            return;
        steps.chooseWhatIsStillSelected();
    }
    if (steps.goesIntoHostFolder())
        return;
    steps.loadChosenFiles();
    steps.rememberFolder();
}
} // namespace ModrigUtils
