#include "modrig/lists/ListRemoval.h"

#include "modrig/lists/Globals.h"
#include "modrig/messages/MessageIds.h"
#include "tests/support/ModuleTest.h"

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class RemovingEntries : public ModuleTest
{
protected:
    void SetUp() override
    {
        ModuleTest::SetUp();
        for (CStringList* list : {&gHistoryList, &gStartupList})
            Fill(*list, {L"/a/one.lsp", L"/a/two.lsp", L"/a/three.lsp", L"/a/four.lsp"});
    }
};
} // namespace

TEST_F(RemovingEntries, NamesTheOnlyEntryRemovedFromTheHistory)
{
    RemoveFromHistory({CStdStr(L"/a/two.lsp")});
    EXPECT_THAT(Texts(gHistoryList), ElementsAre(L"/a/one.lsp", L"/a/three.lsp", L"/a/four.lsp"));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneRemovedFromHistory, L"two.lsp")));
}

TEST_F(RemovingEntries, CountsSeveralEntriesRemovedFromTheHistory)
{
    RemoveFromHistory({CStdStr(L"/a/one.lsp"), CStdStr(L"/a/two.lsp"), CStdStr(L"/a/four.lsp")});
    EXPECT_THAT(Texts(gHistoryList), ElementsAre(L"/a/three.lsp"));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyRemovedFromHistory, L"3")));
}

TEST_F(RemovingEntries, SaysNothingWhenNothingIsRemoved)
{
    RemoveFromHistory({});
    EXPECT_EQ(4u, gHistoryList.GetCount());
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(RemovingEntries, LeavesTheStartupSuiteSilently)
{
    RemoveFromStartupSuite({CStdStr(L"/a/one.lsp"), CStdStr(L"/a/four.lsp")});
    EXPECT_THAT(Texts(gStartupList), ElementsAre(L"/a/two.lsp", L"/a/three.lsp"));
    EXPECT_THAT(lines(), IsEmpty());
    EXPECT_THAT(boxes(), IsEmpty());
}
