// What is installed before anything is built, on a machine that has none of it.
#include <fstream>
#include <iterator>

#include <gmock/gmock.h>

#include "tests/packages/TreeOfPrograms.h"

using testing::AllOf;
using testing::HasSubstr;
using testing::Not;

namespace
{
// Programs in the place of those that know and install packages.
class Setup : public TreeOfPrograms
{
protected:
    Setup()
    {
        program("bin/id", "echo 0");
        program("bin/apt-get", "echo \" $* \" >>\"$(dirname \"$0\")/../asked\"");
        program("bin/apt-cache",
                "printf 'gnustep-back%s\\n' 0.29-cairo 0.31-cairo 0.31-xlib -common 0.4-cairo");
        installed("nothing");
    }

    // The package as the pattern of a shell has it.
    void installed(const std::string& pattern) const
    {
        program("bin/dpkg-query",
                "case $3 in " + pattern + ") echo installed ;; *) echo not-installed ;; esac");
    }

    // What apt was asked for.
    std::string setup(const std::string& option) const
    {
        const auto outcome =
            runCommand("PATH='" + (folder / "bin").string() + "':\"$PATH\" " SETUP " " + option);
        EXPECT_EQ(outcome.status, 0) << outcome.output;
        std::ifstream file(folder / "asked");
        return {std::istreambuf_iterator<char>(file), {}};
    }
};
} // namespace

TEST_F(Setup, InstallsForRunningNothingThatOnlyTheTestsOrTheTourNeed)
{
    const std::string asked = setup("--run");
    EXPECT_THAT(asked, AllOf(HasSubstr(" g++ "), HasSubstr(" llvm "), HasSubstr(" fonts-inter ")));
    for (const char* package :
         {" xvfb ", " libgtest-dev ", " clang-tidy ", " qtbase5-dev ", " lintian ", " zsh "})
        EXPECT_THAT(asked, Not(HasSubstr(package)));
}

TEST_F(Setup, InstallsForTheTourADisplayToo)
{
    EXPECT_THAT(setup("--tour"), AllOf(HasSubstr(" g++ "), HasSubstr(" fonts-inter "), HasSubstr(" xvfb "),
                                       Not(HasSubstr(" libgtest-dev "))));
}

TEST_F(Setup, InstallsForTheBenchmarksWhatTheyCountAndCompareWith)
{
    EXPECT_THAT(setup("--bench"), AllOf(HasSubstr(" g++ "), HasSubstr(" xvfb "), HasSubstr(" valgrind "),
                                        HasSubstr(" libltdl-dev "), Not(HasSubstr(" libgtest-dev "))));
}

TEST_F(Setup, InstallsForTheTestsAllThereIs)
{
    EXPECT_THAT(setup(""),
                AllOf(HasSubstr(" g++ "), HasSubstr(" xvfb "), HasSubstr(" dpkg-dev "),
                      HasSubstr(" libgtest-dev "), HasSubstr(" lintian "), HasSubstr(" valgrind ")));
}

TEST_F(Setup, TakesTheHighestVersionThatANameCanHave)
{
    EXPECT_THAT(setup("--run"),
                AllOf(HasSubstr(" gnustep-back0.31-cairo "), Not(HasSubstr("0.29")), Not(HasSubstr("xlib"))));
}

TEST_F(Setup, IsContentWithWhicheverVersionIsInstalled)
{
    installed("'gnustep-back*-cairo'");
    EXPECT_THAT(setup("--run"), AllOf(HasSubstr(" g++ "), Not(HasSubstr("gnustep-back"))));
}

TEST_F(Setup, AsksForNothingWhereAllIsThere)
{
    installed("*");
    EXPECT_EQ(setup(""), "");
}
