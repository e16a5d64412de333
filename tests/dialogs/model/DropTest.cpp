#include "modrig/dialogs/model/Drop.h"

#include "tests/dialogs/model/TableNames.h"
#include "tests/support/ModuleTest.h"

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class Drop : public ModuleTest
{
protected:
    DraggedFiles Files(std::vector<const wchar_t*> paths)
    {
        return {paths.size(), [this, paths](std::size_t index)
                {
                    mAsked.push_back(index);
                    return CStdStr(paths.at(index));
                }};
    }
    DropAnswer Answer(const ProposedDrop& drop) { return AnswerDrop(drop, Files({L"/a/tool.lsp"})); }

    // The indexes of the files whose paths were asked for.
    std::vector<std::size_t> mAsked;
};
} // namespace

TEST_F(Drop, IsTakenForOneApplicationAmongOthers)
{
    EXPECT_TRUE(HasApplication(Files({L"/a/text.txt", L"/a/TOOL.LSP", L"/a/more.lsp"})));
    EXPECT_THAT(mAsked, ElementsAre(0u, 1u));
}

TEST_F(Drop, IsNotTakenWithoutAnApplication)
{
    EXPECT_FALSE(HasApplication(Files({L"/a/text.txt", L"/a/lsp"})));
    EXPECT_FALSE(HasApplication(Files({})));
}

TEST_F(Drop, IsNotDisturbedByFilesWithoutAnExtension)
{
    EXPECT_TRUE(HasApplication(Files({L"/a/README", L"/a/README.", L"/a/tool.lsp"})));
    EXPECT_FALSE(HasApplication(Files({L"/a/README", L"/a/README."})));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(Drop, BetweenRowsIsTakenThere)
{
    EXPECT_EQ(DropAnswer::kTaken, Answer({kLoadedTable, 0, false}));
    EXPECT_EQ(DropAnswer::kTaken, Answer({kLoadedTable, 3, false}));
    EXPECT_EQ(DropAnswer::kTaken, Answer({kHistoryTable, 3, false}));
}

TEST_F(Drop, OnARowIsRefusedWithoutAskingForTheFiles)
{
    EXPECT_EQ(DropAnswer::kRefused, Answer({kLoadedTable, 0, true}));
    EXPECT_EQ(DropAnswer::kRefused, Answer({kHistoryTable, 0, true}));
    EXPECT_EQ(DropAnswer::kRefused, Answer({kHistoryTable, -1, true}));
    EXPECT_THAT(mAsked, IsEmpty());
}

TEST_F(Drop, OnTheTableAsAWholeGoesAfterTheLastRow)
{
    EXPECT_EQ(DropAnswer::kTakenAtEnd, Answer({kLoadedTable, -1, true}));
    EXPECT_EQ(DropAnswer::kTakenAtEnd, Answer({kLoadedTable, -1, false}));
}

TEST_F(Drop, WithoutAnApplicationIsRefusedEverywhere)
{
    for (const long row : {-1L, 0L})
        EXPECT_EQ(DropAnswer::kRefused, AnswerDrop({kLoadedTable, row, row < 0}, Files({L"/a/text.txt"})));
}
