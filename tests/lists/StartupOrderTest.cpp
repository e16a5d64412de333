#include "modrig/lists/StartupOrder.h"

#include "modrig/lists/Globals.h"
#include "tests/support/ModuleTest.h"

using ModrigUtils::MoveInStartupSuite;
using testing::ElementsAre;

namespace
{
class OrderOfTheStartupSuite : public ModuleTest
{
protected:
    void SetUp() override
    {
        ModuleTest::SetUp();
        Fill(gStartupList, {L"/a/one.lsp", L"/a/two.lsp", L"/a/three.lsp", L"/a/four.lsp"});
    }
    static bool Move(const wchar_t* path, const wchar_t* neighbour)
    {
        return MoveInStartupSuite(CStdStr(path), CStdStr(neighbour));
    }
};
} // namespace

TEST_F(OrderOfTheStartupSuite, ChangesUpwards)
{
    EXPECT_TRUE(Move(L"/a/three.lsp", L"/a/two.lsp"));
    EXPECT_THAT(Texts(gStartupList),
                ElementsAre(L"/a/one.lsp", L"/a/three.lsp", L"/a/two.lsp", L"/a/four.lsp"));
}

TEST_F(OrderOfTheStartupSuite, ChangesDownwardsWhateverTheCase)
{
    EXPECT_TRUE(Move(L"/A/ONE.lsp", L"/a/Two.lsp"));
    EXPECT_THAT(Texts(gStartupList),
                ElementsAre(L"/a/two.lsp", L"/a/one.lsp", L"/a/three.lsp", L"/a/four.lsp"));
}

TEST_F(OrderOfTheStartupSuite, PassesEntriesThatHaveNoRow)
{
    EXPECT_TRUE(Move(L"/a/four.lsp", L"/a/one.lsp"));
    EXPECT_THAT(Texts(gStartupList),
                ElementsAre(L"/a/four.lsp", L"/a/one.lsp", L"/a/two.lsp", L"/a/three.lsp"));
}

TEST_F(OrderOfTheStartupSuite, StaysWhenOneOfTheTwoIsUnknown)
{
    EXPECT_FALSE(Move(L"/a/other.lsp", L"/a/one.lsp"));
    EXPECT_FALSE(Move(L"/a/one.lsp", L"/a/other.lsp"));
    EXPECT_THAT(Texts(gStartupList),
                ElementsAre(L"/a/one.lsp", L"/a/two.lsp", L"/a/three.lsp", L"/a/four.lsp"));
}
