#include "modrig/dialogs/model/ChosenFiles.h"

#include <gtest/gtest.h>

using namespace ModrigUtils;

TEST(ChosenFiles, StayThoseOfTheHistoryWhenAFileTypeEmptiesThePanel)
{
    EXPECT_FALSE(PanelSelectionCountsAfterFileType(true, true));
}

TEST(ChosenFiles, GoWhenAFileTypeHidesThem)
{
    EXPECT_TRUE(PanelSelectionCountsAfterFileType(true, false));
}

TEST(ChosenFiles, AreThoseThatTheFileTypeLeavesSelected)
{
    EXPECT_TRUE(PanelSelectionCountsAfterFileType(false, true));
    EXPECT_TRUE(PanelSelectionCountsAfterFileType(false, false));
}

TEST(ChosenFiles, AreWhatIsStillSelectedWhenNoneAreLeft)
{
    EXPECT_EQ(LoadSource::kPanel, SourceWithoutChoice(true, false));
    EXPECT_EQ(LoadSource::kPanel, SourceWithoutChoice(true, true));
    EXPECT_EQ(LoadSource::kHistory, SourceWithoutChoice(false, true));
    EXPECT_EQ(LoadSource::kNothing, SourceWithoutChoice(false, false));
}

TEST(ChosenFiles, AreTheHistorysWhenTheLastOfThemIsSelectedThere)
{
    const int rows[3] = {};
    EXPECT_TRUE(AreChosenInHistory({&rows[0], &rows[1]}, {&rows[1], &rows[2]}));
    EXPECT_FALSE(AreChosenInHistory({&rows[1], &rows[0]}, {&rows[1], &rows[2]}));
    EXPECT_FALSE(AreChosenInHistory({&rows[0]}, {}));
    EXPECT_FALSE(AreChosenInHistory({}, {&rows[0]}));
}

TEST(ChosenFiles, AreAFolderToGoIntoWhenTheHostsIsAllOfThem)
{
    const BatchFile folder = {CStdStr(L"/host"), true};
    const BatchFile file = {CStdStr(L"/a/tool.lsp"), false};
    EXPECT_TRUE(IsHostFolderOnly({folder}));
    EXPECT_FALSE(IsHostFolderOnly({file}));
    EXPECT_FALSE(IsHostFolderOnly({folder, file}));
    EXPECT_FALSE(IsHostFolderOnly({file, folder}));
    EXPECT_FALSE(IsHostFolderOnly({}));
}
