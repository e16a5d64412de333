// Applications that are loaded when the host starts, and by hand.
#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostProcess.h"

using testing::AllOf;
using testing::HasSubstr;
using testing::Not;

TEST(Startup, LoadsModrigWhichRegistersItsCommand)
{
    const HostSession session;
    const auto result = session.run({"APPS", "HELP MODRIG"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output,
                AllOf(HasSubstr("\n  Modrig.bundle "), HasSubstr("Command: HELP MODRIG\nMODRIG: ")));
}

TEST(Startup, LoadsNothingInSafeMode)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    const auto result = session.run({"APPS"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, HasSubstr("No application is loaded.\n"));
}

TEST(Startup, LoadsTheStartupSuiteWhoseCommandsThenRun)
{
    const HostSession session;
    storeSuite(session, {sample("moon.bundle"), sample("primes.zmb"), sample("gears.omp"),
                         sample("hilbert.lsp"), sample("calendar.qbc")});
    const auto result =
        session.run({"APPS", "GEARS", "MOONPHASE", "PRIMES", "(hilbert 2)", "(calendar 2027 2)"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, AllOf(HasSubstr("\n  moon.bundle "), HasSubstr("\n  primes.zmb "),
                                     HasSubstr("\n  gears.omp "), HasSubstr("\n  hilbert.lsp "),
                                     HasSubstr("\n  calendar.qbc "), HasSubstr("February 2027")));
}

TEST(Startup, GoesOnAfterAnApplicationThatIsMissing)
{
    const HostSession session;
    storeSuite(session, {sample("primes.zmb"), "/nowhere/at all/100%s.zmb", sample("gears.omp")});
    const auto result = session.run({"PRIMES", "GEARS"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, HasSubstr("/nowhere/at all/100%s.zmb"));
}

TEST(Applications, AreLoadedAndUnloadedByHand)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    const auto result =
        session.run({"LOAD " + sample("moon.bundle"), "LOCKMOON", "APPS", "UNLOAD moon.bundle", "UNLOCKMOON",
                     "UNLOAD " + sample("moon.bundle"), "APPS", "MOONPHASE"});
    EXPECT_EQ(result.exitStatus, 1); // unloading what is locked, and a command that is gone
    EXPECT_THAT(result.output, AllOf(HasSubstr(" locked\n"), HasSubstr("is not unloaded: "),
                                     HasSubstr("Command: APPS\nNo application is loaded.\n"),
                                     HasSubstr("Unknown command \"MOONPHASE\"")));
}

TEST(Applications, OfLispAreLoadedAndStay)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    const auto file = session.folder().write("größe 1.lsp", "(defun size () 42)\n").string();
    const auto result = session.run({"LOAD \"" + file + "\"", "(size)", "APPS", "UNLOAD \"" + file + "\""});
    EXPECT_EQ(result.exitStatus, 1); // the last command
    EXPECT_THAT(result.output, AllOf(HasSubstr("Command: (size)\n42\n"), HasSubstr("\n  größe 1.lsp "),
                                     HasSubstr("cannot be unloaded")));
}

TEST(Applications, ThatCannotBeLoadedAreNamedWithTheReason)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    const auto text = session.folder().write("just text.zmb", "not a shared library").string();
    const auto broken = session.folder().write("broken.lsp", "(list 1\n").string();
    for (const std::string& path : {text, broken, std::string("/nowhere/missing.omp")})
    {
        const auto result = session.run({"LOAD \"" + path + "\"", "VERSION"});
        EXPECT_EQ(result.exitStatus, 1) << result.output;
        EXPECT_THAT(result.output, AllOf(HasSubstr(path), HasSubstr("Command: VERSION\nTessel R21"))) << path;
    }
}
