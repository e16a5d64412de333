// The report from a Mac, in a tree where everything that it starts only tells that it was started.
#include <filesystem>
#include <fstream>
#include <iterator>

#include <gmock/gmock.h>

#include "tests/packages/TreeOfPrograms.h"

namespace fs = std::filesystem;
using testing::AllOf;
using testing::HasSubstr;
using testing::Not;

namespace
{
class MacReport : public TreeOfPrograms
{
protected:
    MacReport()
    {
        fs::create_directories(folder / "tools");
        fs::copy_file(MACOS_REPORT, folder / "tools/macos_report");
        for (const char* tool : {"sw_vers", "uname", "xcodebuild", "brew", "cmake", "git", "ctest",
                                 "codesign", "lipo", "otool", "nm", "plutil"})
            tells(std::string("bin/") + tool);
        program("bin/screencapture", "echo picture >\"$2\"");
        tells("tools/setup");
        tells("tools/macos_sign");
        // The dialog stays open; everything else ends.
        program("build/release/Tessel.app/Contents/MacOS/Tessel",
                "case $* in *--modrig*) exec sleep 60 ;; esac; echo Tessel \"$@\" ~");
    }

    CommandOutcome report(const std::string& parts = "") const
    {
        return runCommand("HOME='" + (folder / "home").string() +
                          "' MACOS_REPORT_PATIENCE=1 MACOS_REPORT_LIMIT=2 " + path() + "'" +
                          (folder / "tools/macos_report").string() + "' " + parts);
    }
    std::string written(const std::string& name = "report.md") const
    {
        std::ifstream file(folder / "build/macos-report" / name);
        return {std::istreambuf_iterator<char>(file), {}};
    }
};
} // namespace

TEST_F(MacReport, TellsOfEveryPartAndPutsAllIntoOneFile)
{
    const auto outcome = report();
    EXPECT_EQ(outcome.status, 0) << outcome.output;
    for (const char* part : {"system", "setup", "build", "tests", "session", "signature", "pictures"})
        EXPECT_THAT(written(), HasSubstr(std::string("## ") + part + ": all well\n"));
    EXPECT_THAT(written(), AllOf(HasSubstr("    sw_vers ."), HasSubstr("    setup ."),
                                 HasSubstr("cmake --build --preset release --target Tessel Modrig samples."),
                                 HasSubstr("ctest --preset debug -L"), HasSubstr("lipo -archs"),
                                 HasSubstr("moon.bundle")));
    EXPECT_EQ(written("dialog.png"), "picture\n");
    const auto listed =
        runCommand("tar -tzf '" + (folder / "build/macos-report.tar.gz").string() + "'").output;
    EXPECT_THAT(listed, AllOf(HasSubstr("macos-report/report.md"), HasSubstr("macos-report/dialog.png"),
                              HasSubstr("macos-report/tests.log")));
}

TEST_F(MacReport, TellsOfAPartThatFailsAndGoesOn)
{
    program("bin/ctest", "echo 'one test of two'; exit 8");
    const auto outcome = report();
    EXPECT_EQ(outcome.status, 1);
    EXPECT_THAT(outcome.output, HasSubstr("These parts failed: tests\n"));
    EXPECT_THAT(written(), AllOf(HasSubstr("## tests: FAILED"), HasSubstr("one test of two"),
                                 HasSubstr("It ended with 8."), HasSubstr("## pictures: all well")));
}

TEST_F(MacReport, TriesTheTestsThatWereBuiltWhereOthersCouldNotBe)
{
    program("bin/cmake", "case $* in *'--build --preset debug'*) exit 1 ;; esac");
    report("build tests");
    EXPECT_THAT(written(), AllOf(HasSubstr("## build: all well"), HasSubstr("## tests: FAILED"),
                                 HasSubstr("ctest --preset debug -L"), Not(HasSubstr("## session"))));
}

TEST_F(MacReport, SaysWhatIsNotThere)
{
    fs::remove(folder / "bin/codesign");
    EXPECT_EQ(report("signature").status, 1);
    EXPECT_THAT(written(), AllOf(HasSubstr("There is no codesign here."), HasSubstr("plutil -lint")));
}

TEST_F(MacReport, NoticesADialogThatDoesNotStay)
{
    program("build/release/Tessel.app/Contents/MacOS/Tessel", "echo 'no display'");
    EXPECT_EQ(report("pictures").status, 1);
    EXPECT_THAT(written(), AllOf(HasSubstr("no display"), HasSubstr("The dialog did not stay open.")));
}

TEST_F(MacReport, EndsASessionThatDoesNotEndAndAllThatItStarted)
{
    program("build/release/Tessel.app/Contents/MacOS/Tessel",
            "echo begun; trap '' TERM; sleep 60 & echo $! >started; wait; sleep 60");
    EXPECT_EQ(report("session signature").status, 1);
    EXPECT_THAT(written(), AllOf(HasSubstr("begun"), HasSubstr("It did not end within 2 seconds."),
                                 HasSubstr("It ended with 137."), HasSubstr("## signature: all well")));
    // Whoever has ended may still wait for somebody to take note.
    EXPECT_EQ(runCommand("ps -o stat= -p $(cat '" + (folder / "started").string() + "') | grep -v Z").output,
              "");
}

TEST_F(MacReport, TellsASessionThatIsKilledFromOneThatDoesNotEnd)
{
    program("build/release/Tessel.app/Contents/MacOS/Tessel", "echo begun; kill -KILL $$");
    EXPECT_EQ(report("session").status, 1);
    EXPECT_THAT(written(), AllOf(HasSubstr("begun"), HasSubstr("It ended with 137."),
                                 Not(HasSubstr("It did not end within"))));
}

TEST_F(MacReport, EndsADialogThatDoesNotWantTo)
{
    program("build/release/Tessel.app/Contents/MacOS/Tessel", "trap '' TERM; while :; do sleep 1; done");
    EXPECT_EQ(report("pictures").status, 0);
    EXPECT_EQ(written("dialog.png"), "picture\n");
}

TEST_F(MacReport, SignsACopyOfWhatWasBuilt)
{
    program("tools/macos_sign", "echo signed \"$1\"; ls \"$1/Contents/MacOS\"");
    EXPECT_EQ(report("signature").status, 0);
    EXPECT_THAT(written(), HasSubstr("signed build/macos-report/signed/Tessel.app\n    Tessel\n"));
    EXPECT_FALSE(fs::exists(folder / "build/macos-report/signed"));
    program("tools/macos_sign", "exit 1");
    EXPECT_EQ(report("signature").status, 1);
    EXPECT_THAT(written(), HasSubstr("plutil -lint"));
}

TEST_F(MacReport, TakesThePersonsFolderOutOfWhatItTells)
{
    EXPECT_EQ(report("session").status, 0);
    EXPECT_THAT(written(), AllOf(HasSubstr("-c APPS ~\n"), Not(HasSubstr((folder / "home").string()))));
}

TEST_F(MacReport, RefusesAPartThatItDoesNotKnow)
{
    const auto outcome = report("pictres");
    EXPECT_EQ(outcome.status, 2);
    EXPECT_THAT(outcome.output, HasSubstr("There is no part pictres"));
    EXPECT_FALSE(fs::exists(folder / "build/macos-report"));
}
