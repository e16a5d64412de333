// Startup Suites with files that cannot be loaded: each is told in sentences that name the file and the
// reason, the applications around it are loaded, and the host goes on.
#include <gmock/gmock.h>

#include <algorithm>
#include <csignal>
#include <fstream>

#include <sys/stat.h>

#include "tests/e2e/Applications.h"
#include "tests/e2e/HostTerminal.h"
#include "tests/support/Content.h"

namespace fs = std::filesystem;

using testing::HasSubstr;
using testing::Not;

namespace
{
constexpr char kGoOn[] = "VERSION";
constexpr char kStillThere[] =
    "Command: VERSION\nTessel R21, reference host for Modrig, version " MODRIG_VERSION "\n";
constexpr char kGoodLisp[] = "good.lsp: loaded\n";

// What is said about a broken file between a good file of its kind and another one.
class BrokenSuite : public testing::Test
{
protected:
    std::string saidAboutModule(const std::string& path)
    {
        storeSuite(session, {fixtureModule("Good.zmb"), path, fixtureModule("Good.bundle")});
        return between("Good.zmb: message 1\n", "Good.bundle: message 1\n",
                       "Good.bundle: message 2\nGood.zmb: message 2\n");
    }

    std::string saidAboutLisp(const std::string& path)
    {
        const auto last = session.folder().write("last.lsp", "(write-line \"last.lsp: loaded\")\n").string();
        storeSuite(session, {lispFixture("good.lsp"), path, last});
        // Every file but the last is followed by the prompt, and what comes next stands after it.
        return between(std::string(kGoodLisp) + "\nReady. ",
                       std::string("\nReady. last.lsp: loaded\n") + kLispReady, "");
    }

    HostSession session;
    std::string summary; // of the start, as it was said last

    // Why the summary says that the only file in it was not loaded.
    std::string reasonInSummary(const std::string& path) const
    {
        const std::string start = startSummary({{path, ""}});
        const std::string before = start.substr(0, start.size() - 1);
        EXPECT_TRUE(summary.starts_with(before)) << summary;
        EXPECT_TRUE(summary.ends_with(".\n")) << summary;
        return summary.starts_with(before) ? summary.substr(before.size(), summary.size() - before.size() - 2)
                                           : summary;
    }

private:
    // Without what was said before and after it, the summary of the start, and the end.
    std::string between(const std::string& before, const std::string& after, const std::string& atEnd)
    {
        const auto result = session.run({kGoOn});
        EXPECT_EQ(result.exitStatus, 0) << result.output;
        const std::string start = kBanner + before;
        const std::string end = kStillThere + atEnd;
        EXPECT_TRUE(result.output.starts_with(start)) << result.output;
        EXPECT_TRUE(result.output.ends_with(end)) << result.output;
        if (result.output.size() < start.size() + after.size() + end.size())
            return "too little was said: " + result.output;
        std::string said =
            result.output.substr(start.size(), result.output.size() - start.size() - end.size());
        summary = said.substr(std::min(said.find("Message: "), said.size()));
        said.erase(said.size() - summary.size());
        EXPECT_TRUE(said.ends_with(after)) << result.output;
        return said.substr(0, said.size() - after.size());
    }
};

struct BrokenModule
{
    const char* file;
    const char* reason;
    const char* saidBefore = ""; // by the module itself
};

// Names the case in the list of tests; without it the name would hold addresses.
void PrintTo(const BrokenModule& module, std::ostream* stream)
{
    *stream << module.file;
}

class BrokenModules : public BrokenSuite, public testing::WithParamInterface<BrokenModule>
{
};

std::string nameOfModule(const testing::TestParamInfo<BrokenModule>& info)
{
    return fs::path(info.param.file).stem();
}

struct BrokenLisp
{
    const char* file;
    const char* reason; // after the path
    const char* saidBefore = "";
};

void PrintTo(const BrokenLisp& lisp, std::ostream* stream)
{
    *stream << lisp.file;
}

class BrokenLispFiles : public BrokenSuite, public testing::WithParamInterface<BrokenLisp>
{
};

std::string nameOfLisp(const testing::TestParamInfo<BrokenLisp>& info)
{
    return fs::path(info.param.file).stem();
}
} // namespace

TEST_P(BrokenModules, AreToldWithTheReasonInTheSummaryAlone)
{
    const std::string path = fixtureModule(GetParam().file);
    EXPECT_EQ(saidAboutModule(path), GetParam().saidBefore);
    EXPECT_EQ(summary, startSummary({{path, GetParam().reason + std::string(".")}}));
}

INSTANTIATE_TEST_SUITE_P(
    OfEveryKind, BrokenModules,
    testing::Values(
        BrokenModule{"NoEntry.zmb", "it has no entry point \"tsrxEntryPoint\""},
        BrokenModule{"Unresolved.zmb", "undefined symbol: aFunctionThatNobodyHas"},
        BrokenModule{"UnresolvedClasses.bundle", "undefined symbol: aFunctionThatNobodyHas"},
        BrokenModule{"MissingDependency.zmb",
                     "libfixture_absent.so: cannot open shared object file: No such file or directory"},
        BrokenModule{"Answers3.zmb", "its entry point answered 3", "Answers3.zmb: message 1\n"},
        BrokenModule{"Throws.zmb", "its entry point threw an exception: the coffee is cold"},
        BrokenModule{"ThrowsNumber.omp",
                     "its entry point threw something that is not an error of the standard library"},
        BrokenModule{"ThrowsInMapping.zmb",
                     "while it was being mapped, its code threw an exception: the ruler is broken"},
        BrokenModule{"ThrowsWithClasses.bundle",
                     "while it was being mapped, its code threw an exception: the ruler is broken"},
        BrokenModule{"RaisesInMapping.bundle", "while it was being mapped, its code threw an exception: "
                                               "NSInternalInconsistencyException: the kettle is empty"},
        BrokenModule{"Raises.bundle",
                     "its entry point threw an exception: NSInvalidArgumentException: the tea is cold"},
        BrokenModule{"Missing.bundle", "No such file or directory"}),
    nameOfModule);

TEST_F(BrokenSuite, SaysThatAModuleIsCutShort)
{
    const auto cut = session.folder() / "cut short.zmb";
    const std::string whole = contentOf(fixtureModule("Good.zmb"));
    for (const std::size_t length : {whole.size() / 2, std::size_t{64}, std::size_t{3}, std::size_t{0}})
    {
        std::ofstream(cut, std::ios::binary) << whole.substr(0, length);
        const std::string said = saidAboutModule(cut);
        EXPECT_EQ(said, "");
        EXPECT_NE(reasonInSummary(cut), "");
    }
}

TEST_F(BrokenSuite, SaysThatAFileIsNoSharedLibrary)
{
    const auto text = session.folder().write("letter.zmb", "Dear Sir or Madam,\n").string();
    EXPECT_EQ(saidAboutModule(text), "");
    EXPECT_EQ(summary, startSummary({{text, "it is not a shared library."}}));
    const auto folder = session.folder() / "folder.omp";
    fs::create_directory(folder);
    EXPECT_EQ(saidAboutModule(folder), "");
    EXPECT_EQ(summary, startSummary({{folder, "it is a folder, not a file."}}));
}

TEST_F(BrokenSuite, SaysThatABundleIsEmpty)
{
    const auto bundle = session.folder() / "empty.bundle";
    fs::create_directory(bundle);
    EXPECT_EQ(saidAboutModule(bundle), "");
    EXPECT_NE(reasonInSummary(bundle), "");
}

TEST_P(BrokenLispFiles, AreToldWithTheLineAndTheReason)
{
    const std::string path = lispFixture(GetParam().file);
    EXPECT_EQ(saidAboutLisp(path), GetParam().saidBefore);
    const std::string line = GetParam().reason + 1; // without the colon
    EXPECT_EQ(summary, startSummary({{path, "line " + line + (line.ends_with('.') ? "" : ".")}}));
}

TEST_P(BrokenLispFiles, AreToldTheSameWhenTheyAreLoadedByHand)
{
    session.alwaysWith({"--safe"});
    const std::string path = lispFixture(GetParam().file);
    const auto result = session.run({"LOAD " + path, kGoOn});
    EXPECT_EQ(result.exitStatus, 1);
    EXPECT_EQ(result.output, kBanner + ("Command: LOAD " + path + "\n") + GetParam().saidBefore + path +
                                 GetParam().reason + "\n" + kStillThere);
}

INSTANTIATE_TEST_SUITE_P(
    OfEveryKind, BrokenLispFiles,
    testing::Values(
        BrokenLisp{"never_closed.lsp", ":5: The form that begins here is never closed.",
                   "never_closed.lsp: begun\n"},
        BrokenLisp{"one_too_many.lsp", ":3: Unmatched right parenthesis, #\\)", "one_too_many.lsp: begun\n"},
        BrokenLisp{"error_on_line_3.lsp",
                   ":3: In function CAR, the value of the only argument is 5 which is not of the "
                   "expected type CONS",
                   "error_on_line_3.lsp: one\nerror_on_line_3.lsp: two\n"},
        BrokenLisp{"endless_recursion.lsp", ":6: stack overflow: the recursion is endless or too deep."},
        BrokenLisp{"undefined_function.lsp", ":2: The function NO-SUCH-FUNCTION is undefined."}),
    nameOfLisp);

TEST_F(BrokenSuite, LoadsALispFileThatHoldsNothing)
{
    EXPECT_EQ(saidAboutLisp(lispFixture("nothing.lsp")), "");
    EXPECT_EQ(summary, "");
}

TEST_F(BrokenSuite, SaysThatALispFileIsNone)
{
    const auto folder = session.folder() / "folder.lsp";
    fs::create_directory(folder);
    EXPECT_EQ(saidAboutLisp(folder), "");
    EXPECT_EQ(summary, startSummary({{folder, "it is a folder."}}));
    const auto pipe = session.folder() / "pipe.lsp";
    ASSERT_EQ(mkfifo(pipe.c_str(), S_IRUSR | S_IWUSR), 0);
    EXPECT_EQ(saidAboutLisp(pipe), "");
    EXPECT_EQ(summary, startSummary({{pipe, "it is not an ordinary file."}}));
}

TEST_F(BrokenSuite, SaysThatALispFileIsNoText)
{
    std::string bytes;
    for (int value = 0; value < 256; ++value)
        bytes += static_cast<char>(value);
    const auto file = session.folder().write("bytes.lsp", bytes).string();
    EXPECT_EQ(saidAboutLisp(file), "");
    const std::string reason = reasonInSummary(file);
    EXPECT_TRUE(reason.starts_with("line ")) << reason;
    EXPECT_THAT(reason, Not(HasSubstr("#<"))) << "an object of Lisp tells nobody anything";
    EXPECT_EQ(std::ranges::count(reason, '\n'), 0) << reason;
}

TEST_F(BrokenSuite, SaysThatCompiledLispIsDamaged)
{
    const std::string whole = contentOf(sample("calendar.qbc"));
    const auto file = session.folder() / "damaged.qbc";
    const auto saidAbout = [&](const std::string& content)
    {
        std::ofstream(file, std::ios::binary) << content;
        EXPECT_EQ(saidAboutLisp(file), "");
        return reasonInSummary(file);
    };
    std::string changed = whole;
    changed[whole.size() / 2] = static_cast<char>(changed[whole.size() / 2] ^ 1);
    EXPECT_EQ(saidAbout(whole.substr(0, whole.size() / 2)), "it is cut short");
    EXPECT_EQ(saidAbout(changed), "it is damaged");
    EXPECT_EQ(saidAbout("(write-line \"not compiled\")"), "it is not compiled Lisp");
    EXPECT_EQ(saidAbout(""), "it is not compiled Lisp");
}

TEST_F(BrokenSuite, WithAnEndlessLoopIsStoppedByTheInterruptSignal)
{
    const std::string loop = lispFixture("endless_loop.lsp");
    storeSuite(session, {lispFixture("good.lsp"), loop, sample("hilbert.lsp")});
    HostTerminal terminal(session);
    ASSERT_TRUE(terminal.shows("endless_loop.lsp: begun")) << terminal.screen();
    ASSERT_EQ(kill(terminal.process(), SIGINT), 0);
    ASSERT_TRUE(terminal.shows("Hilbert: ")) << terminal.screen();
    ASSERT_TRUE(terminal.shows(loop + ": line 3: Lisp was interrupted.")) << terminal.screen();
    ASSERT_TRUE(terminal.awaitPrompt());
    terminal.type("(good)\r");
    EXPECT_TRUE(terminal.shows("\n42")) << terminal.screen();
    EXPECT_EQ(terminal.quit(), 0);
}
