// What is noted of the files that an expression loads.
#include <gmock/gmock.h>

#include <functional>

#include "host/applications/Document.h"
#include "host/applications/LoadOutcomes.h"
#include "host/commands/EndRequest.h"
#include "host/lisp/LispInterpreter.h"
#include "host/text/CommandLine.h"
#include "host/text/Unicode.h"
#include "tests/support/TemporaryFolder.h"

using testing::ElementsAre;
using testing::IsEmpty;
using testing::Pair;

namespace
{
class LoadsOfLisp : public testing::Test
{
protected:
    std::string write(const std::string& name, const std::string& content)
    {
        return folder.write(name, content).string();
    }
    static std::string load(const std::string& path) { return "(load \"" + path + "\")"; }

    void fail(const std::string& expression)
    {
        EXPECT_FALSE(lisp.evaluate(tessel::toWide(expression))) << expression;
    }
    void succeed(const std::string& expression)
    {
        const auto value = lisp.evaluate(tessel::toWide(expression));
        EXPECT_TRUE(value) << expression << ": " << tessel::toUtf8(value.sentence());
    }

    // Each file that failed, with the reason.
    std::vector<std::pair<std::string, std::string>> failed() const
    {
        std::vector<std::pair<std::string, std::string>> files;
        for (const auto& outcome : outcomes.failed())
            files.emplace_back(tessel::toUtf8(outcome.path), tessel::toUtf8(outcome.loaded.sentence()));
        return files;
    }

    TemporaryFolder folder;
    std::function<void()> onOutput = [] {
    };
    tessel::CommandLine commandLine{[this](std::string_view)
                                    {
                                        onOutput();
                                    }};
    tessel::Document document;
    tessel::EndRequest endRequest;
    tessel::LoadOutcomes outcomes;
    tessel::LispInterpreter lisp{{.outcomes = &outcomes}, commandLine, document, endRequest};
};
} // namespace

TEST_F(LoadsOfLisp, NameTheLineOfAFileThatFails)
{
    const auto path = write("a.lsp", "1\n(car 5)");
    fail(load(path));
    EXPECT_THAT(failed(), ElementsAre(Pair(path, testing::StartsWith("line 2: In function CAR, "))));
}

TEST_F(LoadsOfLisp, NameTheLineOfAFileThatWasNamedWithoutItsExtension)
{
    write("a.lsp", "\n(unknown)");
    const auto stem = (folder / "a").string();
    fail(load(stem));
    EXPECT_THAT(failed(), ElementsAre(Pair(stem, "line 2: The function UNKNOWN is undefined.")));
}

TEST_F(LoadsOfLisp, GiveTheReasonOfAFileThatIsRefused)
{
    const auto path = (folder / "no.lsp").string();
    fail(load(path));
    fail(load(folder.path().string()));
    EXPECT_THAT(failed(), ElementsAre(Pair(path, "No such file or directory"),
                                      Pair(folder.path().string(), "it is a folder")));
}

TEST_F(LoadsOfLisp, BlameTheOutermostFileAndNameTheOneWithin)
{
    const auto inner = write("inner.lsp", "1\n2\n(unknown)");
    const auto missing = (folder / "missing.lsp").string();
    const auto first = write("first.lsp", load(inner));
    const auto second = write("second.lsp", "\n" + load(missing));
    fail(load(first));
    fail(load(second));
    EXPECT_THAT(failed(), ElementsAre(Pair(first, inner + ":3: The function UNKNOWN is undefined."),
                                      Pair(second, "line 2: Cannot load \"" + missing +
                                                       "\": No such file or directory.")));
}

TEST_F(LoadsOfLisp, BlameNoFileWhoseErrorWasCaughtForWhatComesAfterIt)
{
    const auto bad = write("bad.lsp", "(unknown)");
    fail("(progn (ignore-errors " + load(bad) + ") (car 5))");
    fail("(progn (ignore-errors " + load(bad) + ") (error \"" + bad + ":1: is only named\"))");
    EXPECT_THAT(failed(), IsEmpty());
    const auto other = write("other.lsp", "(unknown)");
    fail("(progn (ignore-errors " + load(bad) + ") " + load(other) + ")");
    EXPECT_THAT(failed(), ElementsAre(Pair(other, "line 1: The function UNKNOWN is undefined.")));
}

TEST_F(LoadsOfLisp, NoteAFileThatGoesOnWithoutOneWithin)
{
    const auto bad = write("bad.lsp", "(unknown)");
    const auto good = write("good.lsp", "(ignore-errors " + load(bad) + ")");
    succeed(load(good));
    ASSERT_NE(outcomes.of(tessel::toWide(good)), nullptr);
    EXPECT_TRUE(outcomes.of(tessel::toWide(good))->loaded);
    EXPECT_EQ(outcomes.of(tessel::toWide(bad)), nullptr);
}

TEST_F(LoadsOfLisp, BlameTheFileInWhichLispIsInterrupted)
{
    const auto path = write("a.lsp", "1\n(progn (princ \"x\") (loop))");
    onOutput = [this]
    {
        lisp.interrupt();
    };
    fail(load(path));
    EXPECT_THAT(failed(), ElementsAre(Pair(path, "line 2: Lisp was interrupted.")));
}

TEST_F(LoadsOfLisp, BlameTheFileThatFillsTheStack)
{
    const auto path = write("a.lsp", "(defun endless (n) (+ 1 (endless n)))\n(endless 1)");
    fail(load(path));
    EXPECT_THAT(failed(),
                ElementsAre(Pair(path, "line 2: stack overflow: the recursion is endless or too deep.")));
}
