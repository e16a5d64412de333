// Applications that end the host, in every way that there is: one line names each, and the host ends as the
// system would have ended it.
#include <csignal>
#include <ostream>

#include <gmock/gmock.h>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostTerminal.h"

using testing::HasSubstr;
using testing::Not;

namespace
{
struct Way
{
    const char* file;
    int exitStatus;
    const char* words; // empty where nothing can be said
};

void PrintTo(const Way& way, std::ostream* stream)
{
    *stream << way.file;
}

class LastWords : public testing::TestWithParam<Way>
{
protected:
    HostSession session;
};

constexpr char kFault[] = "memory fault (SIGSEGV)";
} // namespace

TEST_P(LastWords, NameTheApplicationAndWhatItWasDoing)
{
    const Way& way = GetParam();
    const std::string path = deadly(session, way.file);
    const auto result = session.run({"LOAD " + path, "PERISH", "VERSION"});
    EXPECT_EQ(result.exitStatus, way.exitStatus) << result.output;
    const std::string line = "The application \"" + path + "\" has ended Tessel " + way.words + ".\n";
    if (*way.words)
        EXPECT_THAT(result.output, testing::EndsWith(line));
    else
        EXPECT_THAT(result.output, Not(HasSubstr("has ended Tessel")));
    EXPECT_THAT(result.output, Not(HasSubstr("Command: VERSION"))) << "the host went on";
}

INSTANTIATE_TEST_SUITE_P(
    OfEveryEnd, LastWords,
    testing::Values(
        Way{"segv", -SIGSEGV, "while its entry point ran: memory fault (SIGSEGV)"},
        Way{"raise", -SIGSEGV, "while its entry point ran: memory fault (SIGSEGV)"},
        Way{"stack", -SIGSEGV, "while its entry point ran: memory fault (SIGSEGV)"},
        Way{"abort", -SIGABRT, "while its entry point ran: it stopped at an error of its own (SIGABRT)"},
        Way{"noexcept", -SIGABRT, "while its entry point ran: it stopped at an error of its own (SIGABRT)"},
        Way{"pthread_exit", -SIGABRT,
            "while its entry point ran: it stopped at an error of its own (SIGABRT)"},
        Way{"exit", 1, "while its entry point ran: it called \"exit\""},
        Way{"exit-command", 1, "while its command \"PERISH\" ran: it called \"exit\""},
        Way{"segv-command", -SIGSEGV, "while its command \"PERISH\" ran: memory fault (SIGSEGV)"},
        Way{"stack-command", -SIGSEGV, "while its command \"PERISH\" ran: memory fault (SIGSEGV)"},
        Way{"abort-constructor", -SIGABRT,
            "while it was being loaded: it stopped at an error of its own (SIGABRT)"},
        Way{"segv-nested", -SIGSEGV, "while its entry point ran: memory fault (SIGSEGV)"},
        Way{"kill", -SIGKILL, ""}, Way{"_exit", 0, ""}),
    [](const auto& way)
    {
        std::string name = way.param.file;
        std::erase_if(name, [](char character)
                      { return std::isalnum(static_cast<unsigned char>(character)) == 0; });
        return name + (*way.param.file == '_' ? "AtOnce" : "");
    });

TEST(LastWordsOf, AnApplicationThatIsUnloaded)
{
    const HostSession session;
    const std::string path = deadly(session, "abort-unload");
    const auto result = session.run({"LOAD " + path, "UNLOAD " + path});
    EXPECT_EQ(result.exitStatus, -SIGABRT);
    EXPECT_THAT(result.output, HasSubstr("\"" + path + "\" has ended Tessel while it was being unloaded: "));
}

TEST(LastWordsOf, ALispFile)
{
    const HostSession session;
    const auto path = session.folder().write("deadly.lsp", kLispThatFaults).string();
    const auto result = session.run({"LOAD " + path, "VERSION"});
    EXPECT_EQ(result.exitStatus, -SIGSEGV) << result.output;
    EXPECT_THAT(result.output,
                testing::EndsWith("The application \"" + path +
                                  "\" has ended Tessel while its Lisp ran: " + kFault + ".\n"));
}

// A letter of two bytes whose second one alone would be a control character stays.
TEST(LastWordsOf, AnApplicationCalledByOrdersToTheTerminalAreReadable)
{
    const HostSession session;
    const std::string folder = session.folder().path().string();
    const auto last = deadly(session, "segv");
    const std::string path = folder + "/segv-\xC2\x9B"
                                      "31m\x7F\x1B[1m\xC2\x80\xC2\x9F\xC2\xA0\xC3\x9B.zmb";
    std::filesystem::copy_file(last, path);
    const auto result = session.start({"-c", "LOAD \"" + path + "\""});
    EXPECT_EQ(result.exitStatus, -SIGSEGV);
    EXPECT_THAT(result.output,
                HasSubstr("The application \"" + folder + "/segv-??31m??[1m????\xC2\xA0\xC3\x9B.zmb\" has "));
}

// The name of a file need not be text. Alone, such a byte is an order to a terminal of one byte a character.
TEST(LastWordsOf, AnApplicationCalledByBytesThatAreNoTextAreReadable)
{
    const HostSession session;
    const std::string folder = session.folder().path().string();
    const auto last = deadly(session, "segv");
    const std::string path = folder + "/segv-\x9B"
                                      "31m\xC3\xE2\x82\xFF\xE2\x82\xAC\xF0\x9F\x98\x80\xE2\x80.zmb";
    std::filesystem::copy_file(last, path);
    const auto result = session.start({"-c", "LOAD \"" + path + "\""});
    EXPECT_EQ(result.exitStatus, -SIGSEGV);
    EXPECT_THAT(result.output, HasSubstr("The application \"" + folder +
                                         "/segv-?31m????\xE2\x82\xAC\xF0\x9F\x98\x80??.zmb\" has "));
}

// Nothing can be kept in the profile: the next start does not know, but this session still says it.
TEST(LastWordsOf, AnApplicationAreSaidWhereTheyCannotBeKept)
{
    const HostSession session;
    session.folder().write("profile/applications", "in the way");
    const std::string path = deadly(session, "exit");
    const auto result = session.run({"LOAD " + path, "VERSION"});
    EXPECT_EQ(result.exitStatus, 1) << result.output;
    EXPECT_THAT(result.output, HasSubstr("What ends Tessel cannot be remembered: the folder " +
                                         (session.folder().path() / "profile/applications").string()));
    EXPECT_THAT(result.output, testing::EndsWith("The application \"" + path +
                                                 "\" has ended Tessel while its "
                                                 "entry point ran: it called \"exit\".\n"));
}

TEST(LastWordsOf, AChildThatEndsAreNone)
{
    const HostSession session;
    const std::string path = deadly(session, "child");
    const auto result = session.run({"LOAD " + path, "VERSION"});
    EXPECT_EQ(result.exitStatus, 0);
    EXPECT_EQ(
        result.output,
        kBanner + ("Command: LOAD " + path) + "\nchild.zmb: message 1\n" + path +
            " is loaded.\nCommand: VERSION\nTessel R21, reference host for Modrig, version " MODRIG_VERSION
            "\n" +
            "child.zmb: message 2\n");
}

TEST(LastWordsOf, TheHostItselfAreNone)
{
    const HostSession session;
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.shows("Command: ")) << terminal.screen();
    kill(terminal.process(), SIGABRT);
    EXPECT_EQ(terminal.waitForEnd(), -SIGABRT);
    EXPECT_THAT(terminal.screen(), Not(HasSubstr("has ended Tessel")));
}

// A Lisp that is interrupted is interrupted by the same signal as one that crashes.
TEST(LastWordsOf, NobodyWhenLispIsInterrupted)
{
    const HostSession session;
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.shows("Command: ")) << terminal.screen();
    for (int time = 0; time < 3; ++time)
    {
        terminal.type("(progn (princ \"be\") (princ \"gun\") (loop (list 1 2)))\r");
        ASSERT_TRUE(terminal.shows("begun")) << terminal.screen();
        kill(terminal.process(), SIGINT);
        ASSERT_TRUE(terminal.shows("Lisp was interrupted.")) << terminal.screen();
        ASSERT_TRUE(terminal.shows("Command: ")) << terminal.screen();
    }
    const std::string path = deadly(session, "stack");
    terminal.type("LOAD " + path + "\r");
    EXPECT_EQ(terminal.waitForEnd(), -SIGSEGV);
    EXPECT_THAT(terminal.screen(), HasSubstr("has ended Tessel while its entry point ran"));
}
