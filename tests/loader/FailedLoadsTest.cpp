#include "modrig/loader/FailedLoads.h"

#include "modrig/loader/ApplicationLoader.h"
#include "tests/support/ModuleTest.h"

using namespace ModrigUtils;

namespace
{
class FailedLoads : public ModuleTest
{
protected:
    static void Load(const wchar_t* path) { static_cast<void>(PerformModrig(CStdStr(path), 0, 0, 0)); }
    static bool Failed(const wchar_t* path) { return LastLoadFailed(CStdStr(path)); }
};
} // namespace

TEST_F(FailedLoads, AreThoseThatDidNotLoadWhenTheyWereLastTried)
{
    host().linker.refuseToLoad(L"/a/sometimes.zmb");
    EXPECT_FALSE(Failed(L"/a/sometimes.zmb"));
    Load(L"/a/sometimes.zmb");
    EXPECT_TRUE(Failed(L"/a/sometimes.zmb"));
    EXPECT_TRUE(Failed(L"/A/SOMETIMES.zmb"));
    EXPECT_FALSE(Failed(L"/b/sometimes.zmb"));
    host().linker.allow(L"/a/sometimes.zmb");
    Load(L"/A/sometimes.zmb");
    EXPECT_FALSE(Failed(L"/a/sometimes.zmb"));
}

TEST_F(FailedLoads, AreFilesOfOtherKindsToo)
{
    Load(L"/a/project.mcp");
    EXPECT_TRUE(Failed(L"/a/project.mcp"));
}
