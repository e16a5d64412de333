#include <gmock/gmock.h>

#include "tests/host/lisp/LispSession.h"
#include "tests/support/TemporaryFolder.h"

using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;

namespace
{
std::string quoted(const std::string& text)
{
    std::string literal = "\"";
    for (const char character : text)
    {
        if (character == '"' || character == '\\')
            literal += '\\';
        literal += character;
    }
    return literal + '"';
}

class LispFiles : public testing::Test
{
protected:
    std::string write(const std::string& name, std::string_view content)
    {
        return folder.write(name, content).string();
    }
    static std::string load(const std::string& path) { return "(load " + quoted(path) + ")"; }

    TemporaryFolder folder;
    LispSession session;
};
} // namespace

TEST_F(LispFiles, AreLoadedFormByForm)
{
    const auto path =
        write("good.lsp", "(defun twice (x) (* 2 x))\n; comment\n(write-line \"größe\")\n(twice 4)\n");
    EXPECT_EQ(session.value(load(path)), "T");
    EXPECT_EQ(session.output(), "größe\n");
    EXPECT_EQ(session.value("(twice 21)"), "42");
}

TEST_F(LispFiles, AreListedInTheDocumentByThePathAsGiven)
{
    const auto path = write("good.lsp", "1");
    session.value(load(path));
    EXPECT_THAT(session.documentNames(), ElementsAre(path));
}

TEST_F(LispFiles, WithAnErrorAreNotListed)
{
    session.error(load(write("bad.lsp", "(unknown)")));
    EXPECT_THAT(session.documentNames(), IsEmpty());
}

TEST_F(LispFiles, WithAnErrorNameTheLineOfTheFailingForm)
{
    const auto path =
        write("bad.lsp", "(defun a () 1)\n\n(list 1\n      unknown)\n(write-line \"not reached\")\n");
    EXPECT_EQ(session.error(load(path)), path + ":3: The variable UNKNOWN is unbound.");
    EXPECT_EQ(session.value("(a)"), "1");
    EXPECT_EQ(session.output(), "");
}

TEST_F(LispFiles, CountLinesThroughCommentsStringsAndOtherLineEnds)
{
    const auto path =
        write("bad.lsp", "; one\r\n#| two\r\n #| three |#\r\n|#\r\n\"five\r\nsix\" #\\( (unknown)\r\n");
    EXPECT_THAT(session.error(load(path)), EndsWith("bad.lsp:6: The function UNKNOWN is undefined."));
}

TEST_F(LispFiles, NameTheLineOfTheFormThatIsNeverClosed)
{
    const auto path =
        write("open.lsp", "(write-line \"first\")\n(defun a ()\n  (list 1 2)\n\n(defun b () 2)\n");
    EXPECT_EQ(session.error(load(path)), path + ":2: The form that begins here is never closed.");
    EXPECT_EQ(session.output(), "first\n");
}

TEST_F(LispFiles, NameTheLineOfAParenthesisTooMany)
{
    EXPECT_THAT(session.error(load(write("many.lsp", "(list 1)\n(list 2))\n"))),
                EndsWith("many.lsp:2: Unmatched right parenthesis, #\\)"));
}

TEST_F(LispFiles, NameTheLineOfAStringOrCommentThatIsNeverClosed)
{
    EXPECT_THAT(session.error(load(write("string.lsp", "1\n\n\"abc\n"))), HasSubstr("string.lsp:3: "));
    EXPECT_THAT(session.error(load(write("comment.lsp", "1\n#| abc\n"))), HasSubstr("comment.lsp:2: "));
}

TEST_F(LispFiles, NameTheLineOfEndlessRecursion)
{
    const auto path = write("deep.lsp", "(defun deep (x) (1+ (deep x)))\n(deep 1)\n");
    EXPECT_EQ(session.error(load(path)), path + ":2: stack overflow: the recursion is endless or too deep.");
    EXPECT_EQ(session.value("(+ 1 2)"), "3");
}

TEST_F(LispFiles, NameTheLineWhereMemoryIsExhausted)
{
    const auto path = write("much.lsp", "\n(let (all) (loop (push (make-array 10000) all)))\n");
    EXPECT_EQ(session.error(load(path)), path + ":2: the memory for Lisp is exhausted.");
    EXPECT_EQ(session.value("(length (make-array 100000))"), "100000");
}

// What one session of the process has given up is there for the next.
TEST(LispFilesInManySessions, LeaveMemoryToTheNextThatTheyExhausted)
{
    const TemporaryFolder folder;
    const auto path = folder.write("much.lsp", "(let (all) (loop (push (make-array 10000) all)))\n").string();
    for (int round = 0; round < 10; ++round)
    {
        LispSession session;
        EXPECT_EQ(session.error("(load " + quoted(path) + ")"),
                  path + ":1: the memory for Lisp is exhausted.");
        EXPECT_EQ(session.value("(length (make-array 100000))"), "100000") << round;
    }
}

TEST_F(LispFiles, NameTheInnermostFileAndLine)
{
    const auto inner = write("inner.lsp", "\n\n(unknown)");
    const auto outer = write("outer.lsp", "1\n" + load(inner));
    EXPECT_EQ(session.error(load(outer)), inner + ":3: The function UNKNOWN is undefined.");
}

TEST_F(LispFiles, LeaveErrorsToTheirCallerIfItWants)
{
    const auto path = write("bad.lsp", "(unknown)");
    EXPECT_EQ(session.value("(handler-case " + load(path) + " (undefined-function () 'handled))"), "HANDLED");
    EXPECT_EQ(session.error("(progn (ignore-errors " + load(path) + ") (error \"another\"))"), "another");
}

TEST_F(LispFiles, ThatLoadThemselvesEnd)
{
    const auto path = (folder / "self.lsp").string();
    write("self.lsp", load(path));
    EXPECT_THAT(session.error(load(path)),
                HasSubstr("self.lsp:1: Files load one another more than 100 deep."));
}

TEST_F(LispFiles, ThatAreNestedTooDeepAreRefusedBeforeTheyAreRead)
{
    const std::string depth(6000, '(');
    const auto path = write("deep.lsp", "1\n'" + depth + std::string(6000, ')'));
    EXPECT_EQ(session.error(load(path)),
              "Cannot load \"" + path +
                  "\": the form that begins in line 2 is nested more than 5000 levels deep.");
}

TEST_F(LispFiles, CannotBeMissing)
{
    const auto path = (folder / "missing.lsp").string();
    EXPECT_EQ(session.error(load(path)), "Cannot load \"" + path + "\": No such file or directory.");
    EXPECT_EQ(session.value("(load " + quoted(path) + " :if-does-not-exist nil)"), "NIL");
    EXPECT_EQ(session.value("(null (ignore-errors " + load(path) + "))"), "T");
}

TEST_F(LispFiles, CannotBeFoldersOrDevices)
{
    EXPECT_EQ(session.error(load(folder.path().string())),
              "Cannot load \"" + folder.path().string() + "\": it is a folder.");
    EXPECT_EQ(session.error(load("/dev/zero")), "Cannot load \"/dev/zero\": it is not an ordinary file.");
}

TEST_F(LispFiles, MayHaveAnyNameThatTheSystemAllows)
{
    for (const char* name :
         {"with blanks.lsp", "single'quote.lsp", "double\"quote.lsp", "%s%d%n.lsp", "größe 🙂.lsp",
          "*.lsp", "[a]?.lsp", "~~a.lsp", "semi;colon.lsp", "back\\slash.lsp"})
    {
        const auto path = write(name, "(write-line \"in\")\n(unknown)");
        session.clearOutput();
        EXPECT_EQ(session.error(load(path)), path + ":2: The function UNKNOWN is undefined.");
        EXPECT_EQ(session.output(), "in\n");
        EXPECT_EQ(session.value(load(write(name, "1"))), "T") << name;
    }
}

TEST_F(LispFiles, WithAPathOf4000CharactersAreRefusedInOneSentence)
{
    const std::string path = "/" + std::string(4000, 'x') + ".lsp";
    EXPECT_EQ(session.error(load(path)), "Cannot load \"" + path + "\": File name too long.");
}

TEST_F(LispFiles, AreFoundWithoutTheirExtension)
{
    write("app.lsp", "(write-line \"in\")\n(unknown)");
    const auto stem = (folder / "app").string();
    EXPECT_EQ(session.error(load(stem)), stem + ".lsp:2: The function UNKNOWN is undefined.");
}

TEST_F(LispFiles, MayBeEmptyOrBeginWithAByteOrderMark)
{
    EXPECT_EQ(session.value(load(write("empty.lsp", ""))), "T");
    EXPECT_EQ(session.value(load(write("mark.lsp", "\xEF\xBB\xBF(write-line \"in\")"))), "T");
    EXPECT_EQ(session.output(), "in\n");
}

TEST_F(LispFiles, ThatAreNoTextAreRefusedByLispAndNothingWorse)
{
    std::string bytes;
    for (int byte = 0; byte < 256; ++byte)
        bytes += static_cast<char>(byte);
    EXPECT_THAT(session.error(load(write("bytes.lsp", bytes))), HasSubstr("bytes.lsp:"));
    EXPECT_EQ(session.value("(+ 1 2)"), "3");
}

TEST_F(LispFiles, DoNotChangeThePackageOfTheSession)
{
    session.value(load(write("package.lsp", "(in-package \"CL-USER\")")));
    EXPECT_EQ(session.value("(package-name *package*)"), "\"TESSEL-USER\"");
}

TEST_F(LispFiles, AreLoadedWithAllThatBelongsToThem)
{
    const auto path = write("app.lsp", "(write-line \"in\")");
    EXPECT_EQ(session.value("(progn (_INTERNAL-LOAD-ALL-FILE " + quoted(path) + " nil T T nil)(princ))"), "");
    EXPECT_EQ(session.output(), "in\n");
    EXPECT_THAT(session.documentNames(), ElementsAre(path));
}

TEST_F(LispFiles, NeedANameOfASensibleKind)
{
    EXPECT_THAT(session.error("(load 5)"), HasSubstr("5"));
    EXPECT_EQ(session.value("(load (pathname " + quoted(write("app.lsp", "1")) + "))"), "T");
}

// The host's lists of what is being loaded have one writer.
TEST_F(LispFiles, AreLoadedByTheMainThreadAlone)
{
    const auto path = write("seven.lsp", "(setq seven 7)");
    EXPECT_EQ(session.value("(mp:process-join (mp:process-run-function 'other (lambda () "
                            "(handler-case " +
                            load(path) + " (error (problem) (princ-to-string problem))))))"),
              "\"Files are loaded by Lisp's main thread only.\"");
    EXPECT_THAT(session.documentNames(), IsEmpty());
    EXPECT_EQ(session.value(load(path)), "T");
}
