// A session from its banner to its end, without a terminal.
#include <gmock/gmock.h>

#include <fstream>

#include "tests/e2e/HostProcess.h"

using testing::AllOf;
using testing::EndsWith;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

TEST(Session, BeginsWithABannerAndEndsByItself)
{
    const HostSession session;
    const auto result = session.run({"VERSION"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, StartsWith("Tessel R21, reference host for Modrig"));
    EXPECT_THAT(result.output, EndsWith(std::string("Command: VERSION\n") + kVersionLine));
}

TEST(Session, KeepsEverythingInItsProfileFolder)
{
    const HostSession session;
    ASSERT_EQ(session.run({"VERSION"}).exitStatus, 0);
    EXPECT_TRUE(std::filesystem::is_regular_file(session.profile() / "registry.db"));
    EXPECT_FALSE(std::filesystem::exists(session.folder() / "home/.local/share/Tessel"));
}

TEST(Session, AnswersAnUnknownCommandWithASentenceAndStatusOne)
{
    const HostSession session;
    const auto result = session.run({"FOO", "VERSION"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("Unknown command \"FOO\". Type HELP for the list of commands.\n"
                                         "Command: VERSION\n"));
}

TEST(Session, ListsItsCommandsByGroup)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    const auto result = session.run({"HELP", "help load"});
    EXPECT_EQ(result.exitStatus, 0);
    for (const char* name : {"HELP", "QUIT", "EXIT", "SETVAR", "LOAD", "UNLOAD", "APPS", "REGISTRY",
                             "PROFILE", "VERSION", "CD", "SCRIPT", "?", "DISABLE", "ENABLE", "BISECT"})
        EXPECT_THAT(result.output, HasSubstr(std::string("\n  ") + name)) << name;
    EXPECT_THAT(result.output, HasSubstr(std::string("Command: HELP\n") + kVersionLine));
    EXPECT_THAT(result.output, HasSubstr("Session\n  HELP         Lists the commands, or tells how"));
    EXPECT_THAT(result.output,
                HasSubstr("\nHELP and a name, such as HELP LOAD, tells how a command is typed.\n"
                          "Command: help load\nLOAD: Loads"));
}

TEST(Session, TellsOfACommandHowItIsTypedWithAnExample)
{
    const HostSession session;
    EXPECT_THAT(session.run({"HELP disable"}).output,
                EndsWith("Command: HELP disable\n"
                         "DISABLE: Keeps an application out at starts; it stays in every list\n"
                         "Usage: DISABLE file\nExample: DISABLE moon.bundle\n"));
    EXPECT_THAT(session.run({"HELP CD"}).output, EndsWith("\nExample: CD \"~/My drawings\"\n"));
    EXPECT_THAT(session.run({"HELP EXIT"}).output, EndsWith("EXIT: Ends the session\nUsage: EXIT\n"));
}

TEST(Session, ListsEachWayOfTypingACommandOnALine)
{
    const HostSession session;
    const std::string ways = "Usage: REGISTRY LIST [key] [--json]\n"
                             "       REGISTRY GET key [name] [--json]\n"
                             "       REGISTRY SET key [name data]\n"
                             "       REGISTRY DELETE key [name]\n"
                             "       REGISTRY EXPORT key file [UTF8]\n"
                             "       REGISTRY IMPORT file\n"
                             "       REGISTRY RESTORE\n"
                             "       REGISTRY RESET\n";
    EXPECT_THAT(session.run({"HELP REGISTRY"}).output, HasSubstr("damaged registry\n" + ways + "Example: "));
    EXPECT_THAT(session.run({"REGISTRY MEND"}).output, EndsWith("Command: REGISTRY MEND\n" + ways));
}

TEST(Session, TakesAQuestionMarkForHelp)
{
    const HostSession session;
    const auto result = session.run({"? unload", "?"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_THAT(result.output, HasSubstr("Command: ? unload\nUNLOAD: Unloads a compiled module\n"));
    EXPECT_THAT(result.output, HasSubstr(std::string("Command: ?\n") + kVersionLine + "Session\n  HELP "));
    EXPECT_EQ(session.run({"? nothing"}).exitStatus, 1);
}

TEST(Session, TellsOfACommandThatIsLoadedWhenItIsTyped)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    const std::string key = R"(REGISTRY SET Software\Tessel\R21\Applications\Later)";
    const auto result =
        session.run({key + " Module /opt/later.zmb", key + " LoadReasons 4", key + R"(\Commands LATER LATER)",
                     key + R"(\Commands MODRIG MODRIG)", "HELP later", "HELP modrig"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_THAT(result.output, HasSubstr("Command: HELP later\nThe application /opt/later.zmb is loaded when "
                                         "LATER is typed, and HELP tells more about it then.\n"));
    EXPECT_THAT(result.output, EndsWith("Command: HELP modrig\nMODRIG: Loads and unloads applications, in a "
                                        "dialog\nUsage: MODRIG\n"));
}

TEST(Session, AnswersAMistypedCommandWithTheNearestOne)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    const auto result = session.run({"laod x.lsp", "HELP registy", "HELP HLEP"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("\nUnknown command \"laod\". Did you mean LOAD? Type HELP for the "
                                         "list of commands.\n"));
    EXPECT_THAT(result.output, HasSubstr("\nThere is no help on \"registy\". Did you mean REGISTRY?\n"));
    EXPECT_THAT(result.output, EndsWith("\nThere is no help on \"HLEP\". Did you mean HELP?\n"));
}

TEST(Session, LoadsFromHttpAndHttpsAddressesOnly)
{
    const HostSession session;
    const auto result = session.run({"LOAD ftp://nowhere.invalid/a.lsp", "LOAD ://a.lsp"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("a.lsp\nThe address ftp://nowhere.invalid/a.lsp cannot be loaded: "
                                         "only http and https addresses can be fetched.\n"));
    EXPECT_THAT(result.output, HasSubstr("Cannot load \"")) << "what is no address is a file";
}

TEST(Session, SaysToQuoteANameWithBlanks)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    const auto result = session.run(
        {"LOAD my lisp/one two.lsp", "CD a b", "SCRIPT a b", "UNLOAD a b", "DISABLE a b", "ENABLE a b"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output,
                HasSubstr("\nUsage: LOAD file\n       LOAD address\nA name with blanks in it is "
                          "typed in quotes: LOAD \"my lisp/one two.lsp\"\n"));
    for (const std::string command : {"CD", "SCRIPT", "UNLOAD", "DISABLE", "ENABLE"})
        EXPECT_THAT(result.output, HasSubstr(" is typed in quotes: " + command + " \"a b\"\n"));
    EXPECT_THAT(session.run({"LOAD"}).output,
                EndsWith("Command: LOAD\nUsage: LOAD file\n       LOAD address\n"));
}

TEST(Session, FindsHomeFoldersByATilde)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    const std::string home = (session.folder() / "home").string();
    const std::string lisp = session.folder().write("home/my lisp/one.lsp", "(princ \"one\")\n").string();
    session.folder().write("home/two.scr", "VERSION\n");
    const auto result = session.run({"LOAD \"~/my lisp/one.lsp\"", "CD ~", "SCRIPT ~/two.scr",
                                     "REGISTRY EXPORT Software ~/all.reg UTF8", "REGISTRY IMPORT ~/all.reg",
                                     "CD ~root", "CD ~nobody-at-all/x", "DISABLE \"~/my lisp/one.lsp\""});
    EXPECT_THAT(result.output, HasSubstr("one\n" + lisp + " is loaded.\nCommand: CD ~\n" + home + "\n"));
    EXPECT_THAT(result.output, HasSubstr(std::string("Command: VERSION\n") + kVersionLine));
    EXPECT_THAT(result.output, HasSubstr("Command: CD ~root\n/root\n"));
    EXPECT_THAT(result.output, HasSubstr("The folder ~nobody-at-all/x cannot be entered: No such file"));
    EXPECT_THAT(result.output, HasSubstr(lisp + " is kept out at starts from now on"));
    EXPECT_TRUE(std::filesystem::exists(session.folder() / "home/all.reg"));
    EXPECT_EQ(result.exitStatus, 1) << "nobody has that home";
}

TEST(Session, TakesATildeForWhatItIsWhereAFileIsCalledSo)
{
    HostSession session;
    session.alwaysWith({"--safe"});
    session.folder().write("~/one.lsp", "(princ \"literal\")\n");
    const auto result = session.run({"CD " + session.folder().path().string(), "LOAD ~/one.lsp"});
    EXPECT_THAT(result.output, HasSubstr("\nliteral\n"));
}

TEST(Session, ShowsTheHelpBookWithoutABrowser)
{
    const HostSession session;
    const auto result = session.run({"HELP startup_suite_dialog", "HELP load_unload_applications_dialog",
                                     "HELP StandardFileSelectionDialogs"});
    EXPECT_EQ(result.exitStatus, 0);
    for (const char* topic :
         {"startup_suite_dialog", "load_unload_applications_dialog", "StandardFileSelectionDialogs"})
        EXPECT_THAT(result.output, HasSubstr(std::string("/Resources/help/") + topic + ".html\n"));
    EXPECT_EQ(session.run({"HELP nothing"}).exitStatus, 1);
}

TEST(Session, ReadsAndWritesSystemVariables)
{
    const HostSession session;
    const auto result = session.run({"SETVAR LISPENABLED", "setvar lispenabled 0", "SETVAR LISPENABLED"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, HasSubstr("Command: SETVAR LISPENABLED\nLISPENABLED = 1\n"));
    EXPECT_THAT(result.output, EndsWith("Command: SETVAR LISPENABLED\nLISPENABLED = 0\n"));
}

TEST(Session, RefusesValuesThatAVariableCannotHave)
{
    const HostSession session;
    for (const char* command : {"SETVAR LISPENABLED 7", "SETVAR LISPENABLED yes", "SETVAR NOSUCHVARIABLE 1"})
    {
        const auto result = session.run({command});
        EXPECT_EQ(result.exitStatus, 1) << result.output;
    }
}

TEST(Session, EvaluatesLisp)
{
    const HostSession session;
    const auto result = session.run({"(+ 40 2)", "(princ \"größer\")"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, AllOf(HasSubstr("Command: (+ 40 2)\n42\n"), HasSubstr("größer")));
}

TEST(Session, GoesOnAfterALispErrorAndEndsWithStatusOne)
{
    const HostSession session;
    const auto result = session.run({"(car 5)", "(+ 1 2)"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("Command: (+ 1 2)\n3\n"));
}

TEST(Session, RunsAScriptAsATranscript)
{
    const HostSession session;
    const auto result = session.runScript("; a comment\n(defun twice (x)\n  (* 2 x))\n(twice 21)\nVERSION\n");
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, AllOf(HasSubstr("Command: ; a comment\n"), HasSubstr("     ...   (* 2 x))\n"),
                                     HasSubstr("Command: (twice 21)\n42\n")));
}

TEST(Session, RunsAScriptInsideOfAScript)
{
    const HostSession session;
    const auto inner = session.folder().write("inner script.txt", "VERSION\nFOO\n");
    const auto result = session.runScript("SCRIPT \"" + inner.string() + "\"\nVERSION\n");
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("Unknown command \"FOO\""));
}

TEST(Session, StopsAScriptThatRunsItself)
{
    const HostSession session;
    const auto script = session.folder() / "script.txt";
    const auto result = session.runScript("SCRIPT " + script.string() + "\n");
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("runs itself"));
}

TEST(Session, SaysThatAScriptIsMissing)
{
    const HostSession session;
    const auto result = session.start({"--script", "/nowhere/at all.script"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, HasSubstr("The script /nowhere/at all.script cannot be read: "));
}

TEST(Session, TreatsAPipeLikeAScript)
{
    const HostSession session;
    const auto result = session.runPipe("VERSION\n(+ 1 2)\nQUIT\nFOO\n");
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, AllOf(HasSubstr("Command: (+ 1 2)\n3\n"), Not(HasSubstr("FOO"))));
    EXPECT_EQ(session.runPipe("FOO\n").exitStatus, 1);
}

TEST(Session, EndsWithStatusTwoForArgumentsItDoesNotKnow)
{
    const HostSession session;
    EXPECT_EQ(session.start({"--nonsense"}).exitStatus, 2);
    EXPECT_EQ(session.start({"--help"}).exitStatus, 0);
    EXPECT_EQ(session.start({"--version"}).output, kVersionLine);
}

TEST(Session, TakesArgumentsThatAreNoText)
{
    const HostSession session;
    const auto file = session.folder().write("caf\xE9.lsp", "(write-line \"it runs\")\n");
    const auto result = session.run({"LOAD \"" + file.string() + "\""});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, HasSubstr("caf\\xE9.lsp\"\n"));
    EXPECT_THAT(result.output, HasSubstr("\nit runs\n"));
}

TEST(Session, TakesAnEnvironmentThatIsNoText)
{
    HostSession session;
    session.set("ODD\xE9", "value");
    session.set("ODD", "\xE9");
    const auto result = session.run({"VERSION"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, EndsWith(std::string("Command: VERSION\n") + kVersionLine));
}

TEST(Session, KeepsItsProfileInAFolderWhoseNameIsNoText)
{
    HostSession session;
    session.nameProfile("profil\xE9");
    EXPECT_EQ(session.run({"REGISTRY SET Software\\Trial name data"}).exitStatus, 0);
    const auto result = session.run({"REGISTRY GET Software\\Trial name"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_THAT(result.output, EndsWith("\ndata\n"));
    EXPECT_TRUE(std::filesystem::is_regular_file(session.profile() / "registry.db"));
}

TEST(Session, RunsFromAFolderWhoseNameIsNoText)
{
    HostSession session;
    const auto link = session.folder() / "h\xE9te";
    std::filesystem::create_directory_symlink(std::filesystem::path(TESSEL_PROGRAM).parent_path(), link);
    session.startBy("exec '" + (link / "Tessel").string() + "' \"$@\"");
    const auto result = session.run({"VERSION"});
    EXPECT_EQ(result.exitStatus, 0) << result.output;
    EXPECT_THAT(result.output, EndsWith(std::string("Command: VERSION\n") + kVersionLine));
}

TEST(Session, OutlivesTheReaderOfItsOutput)
{
    HostSession session;
    const auto status = session.folder() / "status";
    session.startBy("{ \"$0\" \"$@\"; echo $? >'" + status.string() + "'; } | true");
    session.run({"HELP", R"(REGISTRY SET Software\Trial name kept)"});
    std::string content;
    std::ifstream(status) >> content;
    EXPECT_EQ(content, "1") << "not all was read";

    session.startBy("exec \"$0\" \"$@\"");
    EXPECT_THAT(session.run({R"(REGISTRY GET Software\Trial name)"}).output, EndsWith("\nkept\n"));
}

TEST(Session, ChangesTheCurrentFolder)
{
    const HostSession session;
    const auto folder = session.folder().write("a b/x.txt", "").parent_path().string();
    const auto result = session.run({"CD \"" + folder + "\"", "CD", "CD /nowhere/at/all"});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_THAT(result.output, AllOf(HasSubstr("Command: CD\n" + folder + "\n"),
                                     HasSubstr("The folder /nowhere/at/all cannot be entered: ")));
}
