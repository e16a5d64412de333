#include "modrig/loader/HostLinker.h"

#include "tests/support/ModuleTest.h"

using testing::ElementsAre;

namespace
{
class HostLinker : public ModuleTest
{
};
} // namespace

TEST_F(HostLinker, IsLookedUpAgainForEveryCall)
{
    EXPECT_EQ(&host().linker, ModrigUtils::HostLinker());
    EXPECT_EQ(&host().linker, ModrigUtils::HostLinker());
    EXPECT_THAT(host().services.asked, ElementsAre(L"DynamicLinker", L"DynamicLinker"));
}

TEST_F(HostLinker, IsNullWhenTheServiceIsMissingOrOfAnotherClass)
{
    host().services.miss(TSRX_DYNAMIC_LINKER);
    EXPECT_EQ(nullptr, ModrigUtils::HostLinker());
    host().services.set(TSRX_DYNAMIC_LINKER, &host().commands);
    EXPECT_EQ(nullptr, ModrigUtils::HostLinker());
}

TEST_F(HostLinker, KnowsLockedModules)
{
    host().linker.setLocked(L"/a/tool.zmb");
    EXPECT_TRUE(ModrigUtils::IsModuleLocked(L"/a/tool.zmb"));
    EXPECT_FALSE(ModrigUtils::IsModuleLocked(L"/a/other.zmb"));
    host().services.miss(TSRX_DYNAMIC_LINKER);
    EXPECT_FALSE(ModrigUtils::IsModuleLocked(L"/a/tool.zmb"));
}
