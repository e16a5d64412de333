#include "modrig/dialogs/model/LoadSteps.h"

#include <string>
#include <vector>

#include <gmock/gmock.h>

using namespace ModrigUtils;
using testing::ElementsAre;

namespace
{
// A dialog that notes what it does.
struct NotingDialog
{
    bool hasChosenFiles = false;
    bool hasNameOfNoFile = false;
    bool hasHostFolderOnly = false;
    std::vector<std::string> done = {};

    std::vector<std::string> pressLoad()
    {
        LoadSteps steps;
        steps.hasChosenFiles = [this]
        {
            return hasChosenFiles;
        };
        steps.tellsOfMissingFile = [this]
        {
            return hasNameOfNoFile && note("told");
        };
        steps.chooseWhatIsStillSelected = [this]
        {
            note("chosen");
        };
        steps.goesIntoHostFolder = [this]
        {
            return hasHostFolderOnly && note("gone into folder");
        };
        steps.loadChosenFiles = [this]
        {
            note("loaded");
        };
        steps.rememberFolder = [this]
        {
            note("remembered");
        };
        PressLoad(steps);
        return done;
    }
    bool note(const char* what)
    {
        done.emplace_back(what);
        return true;
    }
};
} // namespace

TEST(LoadSteps, LoadWhatIsChosenAndRememberTheFolder)
{
    EXPECT_THAT(NotingDialog{.hasChosenFiles = true}.pressLoad(), ElementsAre("loaded", "remembered"));
}

TEST(LoadSteps, TakeNoNoticeOfATypedNameWhenFilesAreChosen)
{
    EXPECT_THAT((NotingDialog{.hasChosenFiles = true, .hasNameOfNoFile = true}.pressLoad()),
                ElementsAre("loaded", "remembered"));
}

TEST(LoadSteps, ChooseWhatIsStillSelectedWhenNothingIsChosen)
{
    EXPECT_THAT(NotingDialog().pressLoad(), ElementsAre("chosen", "loaded", "remembered"));
}

TEST(LoadSteps, EndWithATypedNameThatNoFileHas)
{
    EXPECT_THAT(NotingDialog{.hasNameOfNoFile = true}.pressLoad(), ElementsAre("told"));
    EXPECT_THAT((NotingDialog{.hasNameOfNoFile = true, .hasHostFolderOnly = true}.pressLoad()),
                ElementsAre("told"));
}

TEST(LoadSteps, EndInTheHostsFolderWhenThatIsAllThatIsChosen)
{
    EXPECT_THAT((NotingDialog{.hasChosenFiles = true, .hasHostFolderOnly = true}.pressLoad()),
                ElementsAre("gone into folder"));
    EXPECT_THAT(NotingDialog{.hasHostFolderOnly = true}.pressLoad(),
                ElementsAre("chosen", "gone into folder"));
}
