// ./test on a Mac, in a tree where everything that it starts only tells that it was started.
#include <filesystem>

#include <gmock/gmock.h>

#include "tests/packages/TreeOfPrograms.h"

namespace fs = std::filesystem;
using testing::AllOf;
using testing::HasSubstr;
using testing::Not;

namespace
{
class TestOnMac : public TreeOfPrograms
{
protected:
    TestOnMac()
    {
        fs::copy_file(TEST_EVERYTHING, folder / "test");
        for (const char* name :
             {"tools/setup", "tools/static_checks", "tools/check_macos", "bin/cmake", "bin/ctest"})
            tells(name);
        system("Darwin");
        folder.write("build/debug/build.ninja", "");
        folder.write("build/asan/build.ninja", "");
        folder.write("build/tsan/build.ninja", "");
    }

    void system(const std::string& name) const { program("bin/uname", "echo " + name); }

    CommandOutcome test(const std::string& arguments = "") const
    {
        return runCommand(path() + "'" + (folder / "test").string() + "' " + arguments);
    }
};
} // namespace

TEST_F(TestOnMac, BuildsAndTestsAndLeavesTheChecksOfSourcesToLinux)
{
    const auto outcome = test("-R Startup");
    EXPECT_EQ(outcome.status, 0) << outcome.output;
    EXPECT_THAT(outcome.output, AllOf(HasSubstr("setup .\ncmake --build --preset debug -j"),
                                      HasSubstr("ctest --preset debug -j"), HasSubstr(" -R Startup.\n"),
                                      Not(HasSubstr("static_checks"))));
    const auto deep = test("--deep");
    EXPECT_EQ(deep.status, 0) << deep.output;
    EXPECT_THAT(deep.output, AllOf(HasSubstr("ctest --preset asan"), Not(HasSubstr("static_checks")),
                                   Not(HasSubstr("check_macos"))));
}

TEST_F(TestOnMac, TellsOfATestThatFails)
{
    program("bin/ctest", "exit 8");
    EXPECT_EQ(test().status, 8);
}

TEST_F(TestOnMac, IsOnLinuxWithTheChecksOfSources)
{
    system("Linux");
    EXPECT_THAT(test("--deep").output,
                AllOf(HasSubstr("static_checks build/debug."), HasSubstr("static_checks --deep build/debug."),
                      HasSubstr("check_macos sdk tests.")));
    program("tools/static_checks", "exit 1");
    const auto outcome = test();
    EXPECT_EQ(outcome.status, 1);
    EXPECT_THAT(outcome.output, HasSubstr("The static checks have found faults"));
}
