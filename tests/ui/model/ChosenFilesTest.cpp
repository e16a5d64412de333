#include "ui/model/ChosenFiles.h"

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

TEST(ChosenFiles, AreLoadedWhateverElseIsSelected)
{
    for (const bool panel : {false, true})
        for (const bool history : {false, true})
            EXPECT_EQ(LoadSource::kChosenFiles, SourceForLoad(true, panel, history));
}

TEST(ChosenFiles, AreWhatIsStillSelectedWhenNoneAreLeft)
{
    EXPECT_EQ(LoadSource::kPanel, SourceForLoad(false, true, false));
    EXPECT_EQ(LoadSource::kPanel, SourceForLoad(false, true, true));
    EXPECT_EQ(LoadSource::kHistory, SourceForLoad(false, false, true));
    EXPECT_EQ(LoadSource::kNothing, SourceForLoad(false, false, false));
}
