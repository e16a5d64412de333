// What is said before anything is built, on a Mac that lacks some of it. Programs stand in the place of those
// that a Mac has.
#include <filesystem>

#include <gmock/gmock.h>

#include "tests/packages/TreeOfPrograms.h"

namespace fs = std::filesystem;
using testing::AllOf;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

namespace
{
const char kAllForBuilding[] =
    "cmake ninja pkgconf ecl bdw-gc sqlite icu4c@77 libdeflate openssl@3 libedit cli11 nlohmann-json gettext "
    "boost llvm lld librsvg ";

class SetupOnMac : public TreeOfPrograms
{
protected:
    SetupOnMac()
    {
        program("bin/uname", "echo Darwin");
        program("bin/xcode-select", "[ \"$1\" = -p ] && echo '" + (folder / "Xcode").string() + "'");
        program("Xcode/usr/bin/ibtool", "");
        has(std::string(kAllForBuilding) + "googletest doxygen");
        for (const char* installer : {"bin/apt-get", "bin/sudo"})
            program(installer, "echo \"Asked to install: $*\"");
    }

    // What Homebrew has installed. All else that it is asked for counts as installing.
    void has(const std::string& formulae) const
    {
        program("bin/brew", "[ \"$*\" = 'list --formula -1' ] || { echo \"Asked to install: $*\"; exit; }\n"
                            "printf '%s\\n' " +
                                formulae);
    }

    CommandOutcome setup(const std::string& option = "") const
    {
        return runCommand(path() + SETUP " " + option);
    }
};
} // namespace

TEST_F(SetupOnMac, SaysNothingWhereAllIsThere)
{
    const auto outcome = setup();
    EXPECT_EQ(outcome.status, 0);
    EXPECT_THAT(outcome.output, IsEmpty());
}

TEST_F(SetupOnMac, SaysWhatIsMissingAndTheCommandThatBringsItAndInstallsNothing)
{
    has("cmake ninja ecl icu4c@77 lldb");
    const auto outcome = setup();
    EXPECT_EQ(outcome.status, 1);
    EXPECT_THAT(
        outcome.output,
        HasSubstr("brew install pkgconf bdw-gc sqlite libdeflate openssl@3 libedit cli11 nlohmann-json "
                  "gettext boost llvm lld librsvg googletest doxygen\n"));
    EXPECT_THAT(outcome.output, Not(HasSubstr("Asked to install")));
}

TEST_F(SetupOnMac, WantsForRunningNothingThatOnlyTheTestsNeed)
{
    has(kAllForBuilding);
    EXPECT_EQ(setup("--run").status, 0);
    EXPECT_EQ(setup("--build").status, 0);
    EXPECT_THAT(setup().output, HasSubstr("brew install googletest doxygen\n"));
}

TEST_F(SetupOnMac, AsksForTheDeveloperTools)
{
    program("bin/xcode-select", "echo 'unable to get active developer directory' >&2; exit 2");
    const auto outcome = setup();
    EXPECT_EQ(outcome.status, 1);
    EXPECT_THAT(outcome.output,
                AllOf(HasSubstr("Apple's developer tools are missing."), HasSubstr("xcode-select --switch"),
                      Not(HasSubstr("brew install")), Not(HasSubstr("unable"))));
}

TEST_F(SetupOnMac, IsNotContentWithToolsThatCannotCompileLayouts)
{
    fs::remove(folder / "Xcode/usr/bin/ibtool");
    const auto outcome = setup();
    EXPECT_EQ(outcome.status, 1);
    EXPECT_THAT(outcome.output, AllOf(HasSubstr((folder / "Xcode").string() + " have no compiler of layouts"),
                                      HasSubstr("xcode-select --switch")));
}

TEST_F(SetupOnMac, AsksForHomebrew)
{
    fs::remove(folder / "bin/brew");
    const auto outcome = setup();
    EXPECT_EQ(outcome.status, 1);
    EXPECT_THAT(outcome.output, AllOf(HasSubstr("Homebrew is missing"), HasSubstr("https://brew.sh")));
}
