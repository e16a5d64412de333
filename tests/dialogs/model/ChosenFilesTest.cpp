#include "modrig/dialogs/model/ChosenFiles.h"

#include <gtest/gtest.h>

using namespace ModrigUtils;

TEST(ChosenFiles, AreThePanelsWhateverSomebodyChoosesThere)
{
    for (const bool panelIsEmpty : {false, true})
        for (const bool chosenInHistory : {false, true})
            EXPECT_TRUE(PanelSelectionCounts(PanelChange::kChoice, panelIsEmpty, chosenInHistory));
}

TEST(ChosenFiles, StayThoseOfTheHistoryWhenAFileTypeEmptiesThePanel)
{
    EXPECT_FALSE(PanelSelectionCounts(PanelChange::kFileType, true, true));
}

TEST(ChosenFiles, GoWhenAFileTypeHidesThem)
{
    EXPECT_TRUE(PanelSelectionCounts(PanelChange::kFileType, true, false));
}

TEST(ChosenFiles, AreThoseThatTheFileTypeLeavesSelected)
{
    EXPECT_TRUE(PanelSelectionCounts(PanelChange::kFileType, false, true));
    EXPECT_TRUE(PanelSelectionCounts(PanelChange::kFileType, false, false));
}

TEST(ChosenFiles, AreWhatIsStillSelectedWhenNoneAreLeft)
{
    EXPECT_EQ(LoadSource::kPanel, SourceWithoutChoice(true, false));
    EXPECT_EQ(LoadSource::kPanel, SourceWithoutChoice(true, true));
    EXPECT_EQ(LoadSource::kHistory, SourceWithoutChoice(false, true));
    EXPECT_EQ(LoadSource::kNothing, SourceWithoutChoice(false, false));
}
