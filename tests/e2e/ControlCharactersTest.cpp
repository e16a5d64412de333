// What a terminal would take for orders, in what other people wrote.
#include <gmock/gmock.h>

#include <algorithm>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostTerminal.h"
#include "tests/support/Content.h"

namespace fs = std::filesystem;

using testing::AllOf;
using testing::HasSubstr;

namespace
{
// Retitles the window of most terminals.
constexpr char kOrder[] = "\x1b]0;taken\x07";
constexpr char kOrderShown[] = "\\x1B]0;taken\\x07";

class ControlCharacters : public testing::Test
{
protected:
    static void expectReadable(const HostResult& result)
    {
        const auto isOrder = [](char character)
        {
            return (static_cast<unsigned char>(character) < ' ' && character != '\n' && character != '\t') ||
                   character == '\x7f';
        };
        EXPECT_TRUE(std::ranges::none_of(result.output, isOrder)) << testing::PrintToString(result.output);
    }

    HostSession session;
};
} // namespace

TEST_F(ControlCharacters, OfAFileNameAreShown)
{
    const auto result =
        session.run({std::string("LOAD /nowhere/") + kOrder + ".zmb", std::string("CD /nowhere/") + kOrder,
                     std::string("SCRIPT /nowhere/") + kOrder, std::string("x") + kOrder});
    expectReadable(result);
    EXPECT_THAT(result.output, AllOf(HasSubstr(linkerRefuses(std::string("/nowhere/") + kOrderShown + ".zmb",
                                                             "No such file or directory")),
                                     HasSubstr(std::string("The folder /nowhere/") + kOrderShown + " cannot"),
                                     HasSubstr(std::string("The script /nowhere/") + kOrderShown + " cannot"),
                                     HasSubstr(std::string("Unknown command \"x") + kOrderShown + "\"")));
}

TEST_F(ControlCharacters, OfALoadedFilesNameAreShown)
{
    const auto file =
        session.folder().write(std::string("a") + kOrder + "\rb.lsp", "(write-line \"it runs\")\n");
    const std::string shown = std::string("a") + kOrderShown + "\\x0Db.lsp";
    const auto result = session.run({"LOAD \"" + file.string() + "\"", "APPS"});
    EXPECT_EQ(result.exitStatus, 0);
    expectReadable(result);
    EXPECT_THAT(result.output, AllOf(HasSubstr("\nit runs\n"),
                                     HasSubstr(std::string("/a") + kOrderShown + "\\x0Db.lsp is loaded."),
                                     HasSubstr(listed(file.parent_path() / shown, "Lisp"))));
}

// The linker repeats the name of the library that is missing, which is any bytes.
TEST_F(ControlCharacters, OfTheLinkersWordsAreShown)
{
    std::string library = contentOf(fixtureModule("MissingDependency.zmb"));
    const std::string name = "libfixture_absent.so";
    const std::size_t place = library.find(name);
    ASSERT_NE(place, library.npos);
    library.replace(place, 4, "\x1b[2J");
    const auto module = session.folder().write("Module.zmb", library);
    const auto result = session.run({"LOAD " + module.string()});
    expectReadable(result);
    EXPECT_THAT(result.output, HasSubstr("\\x1B[2Jixture_absent.so: cannot open shared object file"));
}

TEST_F(ControlCharacters, OfLispAreShown)
{
    const auto result = session.run(
        {"(princ (coerce (list (code-char 27) #\\[ (code-char 155) (code-char 13) (code-char 8)) 'string))",
         "(format nil \"a~Cb\" (code-char 27))", "(error \"a~Cb\" (code-char 7))",
         "(princ (format nil \"one~C~Ctwo~Cthree\" (code-char 13) (code-char 10) (code-char 9)))"});
    expectReadable(result);
    EXPECT_THAT(result.output, AllOf(HasSubstr("\\x1B[\\x9B\\x0D\\x08"), HasSubstr("\"a\\x1Bb\""),
                                     HasSubstr("a\\x07b"), HasSubstr("one\ntwo\tthree")));
}

TEST_F(ControlCharacters, OfArgumentsThatAreNotKnownAreShown)
{
    const auto result = session.start({std::string("--") + kOrder});
    EXPECT_EQ(result.exitStatus, 2);
    expectReadable(result);
    EXPECT_THAT(result.output, HasSubstr(kOrderShown));
}

TEST_F(ControlCharacters, OfAnEarlierLineAreShownAtTheTerminal)
{
    session.folder().write("profile/history", "_HiStOrY_V2_\nx\\033]0;taken\\007y\n");
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.shows("Command: ")) << terminal.screen();
    terminal.type("\x1b[A");
    EXPECT_TRUE(terminal.shows("x^[]0;taken^Gy")) << terminal.screen();
}
