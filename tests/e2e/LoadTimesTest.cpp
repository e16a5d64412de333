// APPS: how long loading took, and what was not loaded.
#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"

using testing::ContainsRegex;
using testing::EndsWith;
using testing::HasSubstr;
using testing::Not;

namespace
{
class LoadTimes : public testing::Test
{
protected:
    LoadTimes()
    {
        session.alwaysWith({"--safe"});
        session.keepTimes();
    }

    HostSession session;
};
} // namespace

TEST_F(LoadTimes, AreListedForModulesAndLisp)
{
    const auto slow = session.folder().write("slow.lsp", "(sleep 1.2)\n").string();
    const auto output = session
                            .run({"LOAD " + fixtureModule("Good.zmb"), "LOAD " + lispFixture("good.lsp"),
                                  "LOAD " + slow, "APPS"})
                            .output;
    EXPECT_THAT(output, ContainsRegex("\n  Good.zmb  .* may be unloaded, loaded in [0-9]+(\\.[0-9])? ms\n"));
    EXPECT_THAT(output, ContainsRegex("\n  good.lsp  .* Lisp, loaded in [0-9]+(\\.[0-9])? ms\n"));
    EXPECT_THAT(output, ContainsRegex("\n  slow.lsp  .* Lisp, loaded in 1\\.[2-9] s\n"));
}

TEST_F(LoadTimes, AreThoseOfTheLoadAndNotOfALaterOneThatHadNothingToDo)
{
    const auto slow = session.folder().write("slow.lsp", "(sleep 0.3)\n").string();
    const auto link = session.folder() / "link.zmb";
    std::filesystem::create_symlink(fixtureModule("Good.zmb"), link);
    const auto output =
        session.run({"LOAD " + fixtureModule("Good.zmb"), "LOAD " + link.string(), "LOAD " + slow, "APPS"})
            .output;
    EXPECT_THAT(output, ContainsRegex("\n  slow.lsp  .* Lisp, loaded in [3-9][0-9][0-9] ms\n"));
    EXPECT_THAT(output, Not(HasSubstr("\n  link.zmb")));
}

TEST_F(LoadTimes, StandBeforeWhatCouldNotBeLoadedAndWhy)
{
    const std::string broken = lispFixture("error_on_line_3.lsp");
    const auto output = session
                            .run({"LOAD " + fixtureModule("NoEntry.zmb"), "LOAD " + broken,
                                  "LOAD /nowhere/a.lsp", "LOAD " + fixtureModule("NoEntry.zmb"), "APPS"})
                            .output;
    EXPECT_THAT(output,
                EndsWith("Command: APPS\nNo application is loaded.\n" +
                         listedAsNotLoaded(
                             {{fixtureModule("NoEntry.zmb"), "it has no entry point \"tsrxEntryPoint\""},
                              {broken, "line 3: In function CAR, the value of the only argument is 5 "
                                       "which is not of the expected type CONS"},
                              {"/nowhere/a.lsp", "No such file or directory"}})));
}

TEST_F(LoadTimes, StandAloneOnceWhatHadFailedIsLoaded)
{
    const auto file = session.folder() / "later.lsp";
    const auto output =
        session
            .run({"LOAD " + file.string(),
                  "(with-open-file (s \"" + file.string() + "\" :direction :output) (write 1 :stream s))",
                  "LOAD " + file.string(), "APPS"})
            .output;
    EXPECT_THAT(output, ContainsRegex("Command: APPS\n  later.lsp  .* Lisp, loaded in [0-9.]+ ms\n$"));
}

TEST_F(LoadTimes, LeaveOutAFileWhoseErrorAnotherFileHasCaught)
{
    const auto inner = session.folder().write("inner.lsp", "(car 5)\n").string();
    const auto outer =
        session.folder().write("outer.lsp", "(ignore-errors (load \"" + inner + "\"))\n").string();
    const auto output = session.run({"LOAD " + outer, "APPS"}).output;
    EXPECT_THAT(output, Not(HasSubstr("Not loaded")));
    EXPECT_THAT(output, ContainsRegex("\n  outer.lsp  .* Lisp, loaded in [0-9.]+ ms\n$"));
}
