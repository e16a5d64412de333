// ./run, in a tree where everything that it starts only tells that it was started.
#include <filesystem>

#include <gmock/gmock.h>

#include "tests/packages/TreeOfPrograms.h"

namespace fs = std::filesystem;
using testing::AllOf;
using testing::ContainsRegex;
using testing::HasSubstr;
using testing::Not;

namespace
{
class Run : public TreeOfPrograms
{
protected:
    Run()
    {
        fs::copy_file(RUN, folder / "run");
        for (const char* name :
             {"tools/setup", "tools/tour", "tools/demo_profile", "build/release/Tessel.app/Tessel"})
            tells(name);
        program("bin/cmake",
                "printf '[0/2] Re-checking globbed directories...\\n[1/3] Building a\\n[3/3] Linking b\\n'");
        folder.write("build/release/build.ninja", "");
    }

    std::string command(const std::string& arguments) const
    {
        return "env -u DISPLAY -u WAYLAND_DISPLAY PATH='" + (folder / "bin").string() + "':\"$PATH\" '" +
               (folder / "run").string() + "' " + arguments;
    }

    CommandOutcome run(const std::string& arguments) const
    {
        return runCommand(command(arguments) + " </dev/null");
    }

    // At a terminal.
    CommandOutcome runAtTerminal(const std::string& arguments) const
    {
        const auto script = folder.write("typed", command(arguments) + "\n");
        return runCommand("script --quiet --return --command 'sh " + script.string() +
                          "' /dev/null </dev/null");
    }
};
} // namespace

TEST_F(Run, GivesAPromptOnATerminalWithoutADisplay)
{
    const auto outcome = runAtTerminal("");
    EXPECT_EQ(outcome.status, 0) << outcome.output;
    EXPECT_THAT(outcome.output,
                AllOf(HasSubstr("setup --run."), HasSubstr("Tessel --profile-dir build/demo-profile."),
                      Not(HasSubstr("tour"))));
}

TEST_F(Run, PlaysTheTourWhereThereIsNoTerminal)
{
    const auto outcome = run("");
    EXPECT_EQ(outcome.status, 0) << outcome.output;
    EXPECT_THAT(outcome.output,
                AllOf(HasSubstr("setup --tour."), HasSubstr("\ntour build/release/Tessel.app/Tessel "),
                      Not(HasSubstr("Tessel --profile-dir"))));
}

TEST_F(Run, StartsTesselOnAMacWhichHasNoDisplayForATour)
{
    program("bin/uname", "echo Darwin");
    tells("build/release/Tessel.app/Contents/MacOS/Tessel");
    const auto outcome = run("");
    EXPECT_EQ(outcome.status, 0) << outcome.output;
    EXPECT_THAT(outcome.output, AllOf(HasSubstr("Tessel --profile-dir"), Not(HasSubstr("tour"))));
}

TEST_F(Run, HandsItsArgumentsToTessel)
{
    const auto outcome = run("-- -c 'LOAD \"a b.lsp\"' c.zmb");
    EXPECT_EQ(outcome.status, 0);
    EXPECT_THAT(outcome.output,
                AllOf(HasSubstr("setup --run."), HasSubstr("\nTessel -c LOAD \"a b.lsp\" c.zmb.\n")));
}

TEST_F(Run, ShowsHowFarTheBuildIs)
{
    EXPECT_THAT(run("-c VERSION").output, HasSubstr("Built: 1 of 3\nBuilt: 3 of 3\nTessel -c"));
    EXPECT_THAT(runAtTerminal("-c VERSION").output, ContainsRegex("\rBuilt: 1 of 3 \rBuilt: 3 of 3 \r?\n"));
}

TEST_F(Run, SaysNothingOfABuildThatHasNothingToDo)
{
    program("bin/cmake", "printf '[0/2] Re-checking globbed directories...\\nninja: no work to do.\\n'");
    EXPECT_EQ(run("-c VERSION").output, "setup --run.\nTessel -c VERSION.\n");
}

TEST_F(Run, ShowsTheEndOfABuildThatFails)
{
    program("bin/cmake", "echo 'FAILED: a.cpp'; exit 1");
    const auto outcome = run("-c VERSION");
    EXPECT_EQ(outcome.status, 1);
    EXPECT_THAT(outcome.output,
                AllOf(HasSubstr("FAILED: a.cpp\nTessel could not be built"), Not(HasSubstr("Tessel -c"))));
}

TEST_F(Run, KeepsWhatItSaysByItselfOffTheOutput)
{
    const auto outcome = runCommand(command("-c VERSION") + " </dev/null 2>/dev/null");
    EXPECT_EQ(outcome.output, "Tessel -c VERSION.\n");
}
