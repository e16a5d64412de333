// Files after the program's name: what a file manager hands over.
#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostTerminal.h"

using testing::AllOf;
using testing::EndsWith;
using testing::HasSubstr;

TEST(FilesAsArguments, AreLoadedInTheirOrderBeforeTheCommands)
{
    const HostSession session;
    const auto lisp = session.folder().write("in \"quotes\" a b.lsp", "(write-line \"it runs\")\n").string();
    const auto result = session.start({lisp, sample("primes.zmb"), "-c", "VERSION"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_EQ(result.output, kBanner + ("it runs\n" + lisp + " is loaded.\n" + kPrimes) +
                                 sample("primes.zmb") + " is loaded.\nCommand: VERSION\n" + kVersionLine);
}

TEST(FilesAsArguments, ThatCannotBeLoadedKeepTheOthersFromNothingAndTheStatusTells)
{
    const HostSession session;
    const auto result = session.start({"/nowhere/gone.zmb", sample("primes.zmb"), "-c", "VERSION"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_EQ(result.output, kBanner + linkerRefuses("/nowhere/gone.zmb", "No such file or directory") +
                                 kPrimes + sample("primes.zmb") + " is loaded.\nCommand: VERSION\n" +
                                 kVersionLine);
}

TEST(FilesAsArguments, OfAKindThatIsKnownAndNotLoadedAreToldSo)
{
    const HostSession session;
    const auto macros = session.folder().write("MACROS.MCP", "macros\n").string();
    const auto result = session.start({sample("survey.rpk"), macros, "/nowhere/gone.rpk"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_EQ(result.output,
              kBanner +
                  linkerRefuses(sample("survey.rpk"),
                                "it is a packaged Lisp application, a kind that Tessel does not load; "
                                "Lisp files (.lsp, .qbc) can be loaded") +
                  linkerRefuses(macros, "it is a macro project, a kind that Tessel does not load") +
                  linkerRefuses("/nowhere/gone.rpk", "No such file or directory"));
}

TEST(FilesAsArguments, ThatAreLibrariesAreLoadedWhateverTheirName)
{
    const HostSession session;
    const auto named = session.folder() / "primes.rpk";
    std::filesystem::copy(sample("primes.zmb"), named);
    const auto result = session.start({named.string()});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, EndsWith(named.string() + " is loaded.\n"));
}

TEST(FilesAsArguments, AreFoundFromTheCurrentFolder)
{
    HostSession session;
    session.folder().write("files/here.lsp", "(write-line \"here\")\n");
    session.startBy("cd '" + (session.folder() / "files").string() + "' && exec \"$0\" \"$@\"");
    const auto result = session.start({"here.lsp"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output,
                HasSubstr("\nhere\n" + (session.folder() / "files/here.lsp").string() + " is loaded.\n"));
}

TEST(FilesAsArguments, LeaveThePersonAtThePrompt)
{
    HostSession session;
    session.alwaysWith({sample("primes.zmb"), "/nowhere/gone.zmb"});
    HostTerminal terminal(session);
    EXPECT_TRUE(terminal.shows("Command: ")) << terminal.screen();
    EXPECT_THAT(terminal.screen(), HasSubstr("is loaded."));
    EXPECT_EQ(terminal.quit(), 0) << "the person has seen what was not loaded";
}

TEST(DialogAlone, EndsWithStatusOneWhereNoWindowCanBeOpened)
{
    HostSession session;
    for (const char* display : {"", ":9999"})
    {
        session.set("DISPLAY", display);
        const auto result = session.start({"--modrig"});
        EXPECT_EQ(result.exitStatus, 1) << display;
        EXPECT_EQ(result.output, "Tessel cannot open a window: there is no display.\n") << display;
    }
}
