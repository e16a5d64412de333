#include "modrig/lists/History.h"

#include "modrig/lists/Globals.h"
#include "tests/support/ModuleTest.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class History : public ModuleTest
{
protected:
    static void Store(std::initializer_list<const wchar_t*> paths)
    {
        const std::wstring key = host().moduleKey() + L"\\History";
        host().registry.setValue(key, L"NumHistory", std::to_wstring(paths.size()));
        std::size_t index = 0;
        for (const wchar_t* path : paths)
            host().registry.setValue(key, std::to_wstring(++index) + L"History", path);
    }
};
} // namespace

TEST_F(History, LoadsNothing)
{
    Store({L"/a/tool.zmb", L"/a/tool.lsp", L"/a/tool.mcp", L"/a/tool"});
    ModrigUtils::InitializeHistoryFiles();
    EXPECT_EQ(4u, gHistoryList.GetCount());
    EXPECT_THAT(WithoutBookkeeping(host().journal.entries()), IsEmpty());
    EXPECT_TRUE(gLoadedAppList.IsEmpty());
}

TEST_F(History, LeavesTheFlagOfTheLispEnvironmentAlone)
{
    gbOrreryLoaded = true;
    ModrigUtils::InitializeHistoryFiles();
    EXPECT_TRUE(gbOrreryLoaded);
}

TEST_F(History, HoldsObjectDatabaseModulesOnceByName)
{
    Store({L"/a/tool.omp", L"/b/TOOL.OMP", L"/a/tool.bundle", L"/b/tool.bundle"});
    ModrigUtils::InitializeHistoryFiles();
    EXPECT_THAT(Texts(gHistoryList), ElementsAre(L"/a/tool.omp", L"/a/tool.bundle", L"/b/tool.bundle"));
}

TEST_F(History, TouchesNoOtherList)
{
    Fill(gStartupList, {L"/s.lsp"});
    Fill(gHistoryList, {L"/h.lsp"});
    ModrigUtils::WriteHistoryFilesToRegistry();
    ModrigUtils::InitializeHistoryFiles();
    EXPECT_THAT(Texts(gStartupList), ElementsAre(L"/s.lsp"));
    EXPECT_FALSE(host().registry.hasKey(host().moduleKey() + L"\\Startup"));
}
