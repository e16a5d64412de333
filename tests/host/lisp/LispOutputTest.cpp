#include <gmock/gmock.h>

#include "host/lisp/LispOutput.h"
#include "tests/host/lisp/LispSession.h"

using testing::ElementsAre;
using testing::IsEmpty;
using testing::SizeIs;

namespace
{
struct Pieces
{
    Pieces()
    {
        output.connect([this](std::wstring_view piece) { written.emplace_back(piece); },
                       [this] { return column; });
    }
    std::vector<std::wstring> written;
    std::size_t column = 0;
    tessel::LispOutput output;
};
} // namespace

TEST(LispOutput, WaitsForTheEndOfTheLine)
{
    Pieces pieces;
    pieces.output.add(L"one");
    EXPECT_THAT(pieces.written, IsEmpty());
    pieces.output.add(L" line\nand");
    EXPECT_THAT(pieces.written, ElementsAre(L"one line\n"));
    pieces.output.flush();
    EXPECT_THAT(pieces.written, ElementsAre(L"one line\n", L"and"));
    pieces.output.flush();
    EXPECT_THAT(pieces.written, SizeIs(2));
}

TEST(LispOutput, DoesNotWaitForEver)
{
    Pieces pieces;
    pieces.output.add(std::wstring(10000, L'x'));
    EXPECT_THAT(pieces.written, SizeIs(2));
}

TEST(LispOutput, CountsTheColumnFromWhatStandsThereAlready)
{
    Pieces pieces;
    pieces.column = 9;
    pieces.output.add(L"abc");
    EXPECT_EQ(pieces.output.column(), 12U);
}

TEST(LispPrinting, GoesToTheCommandLine)
{
    LispSession session;
    session.value("(write-line \"größer\") (format t \"~a~%\" 1) (print 2 *error-output*) (warn \"w\")");
    EXPECT_EQ(session.output(), "größer\n1\n\n2 \n;;; Warning: w\n");
}

TEST(LispPrinting, WritesPercentSignsAsTheyAre)
{
    LispSession session;
    session.value("(write-line \"\") (prompt \"%s %d \")");
    EXPECT_EQ(session.output(), "\n%s %d ");
}

TEST(LispPrinting, PrincShowsItsTextAtOnceAndAnswersIt)
{
    LispSession session;
    std::vector<std::string> pieces;
    session.onOutput([&](std::string_view piece) { pieces.emplace_back(piece); });
    EXPECT_EQ(session.value("(princ \"working\")"), "\"working\"");
    session.value("(progn (princ 'a) (prompt \"b\"))");
    EXPECT_THAT(pieces, ElementsAre("working", "A", "b"));
}

TEST(LispPrinting, PrincTakesAStream)
{
    LispSession session;
    EXPECT_EQ(session.value("(with-output-to-string (s) (princ \"x\" s))"), "\"x\"");
    EXPECT_EQ(session.output(), "");
}

TEST(LispPrinting, KnowsTheColumn)
{
    LispSession session;
    session.commandLine().print(L"12");
    session.value("(format t \"~5ta~&b~%~3tc\")");
    EXPECT_EQ(session.output(), "12   a\nb\n   c");
}

TEST(LispPrinting, ComesBackToTheCommandLineAfterTheUserHasTurnedItAway)
{
    LispSession session;
    session.value("(setf *standard-output* (make-string-output-stream))");
    session.value("(write-line \"here\")");
    EXPECT_EQ(session.output(), "here\n");
}

TEST(LispReading, FindsTheEndOfTheInput)
{
    LispSession session;
    for (const char* reading : {"(read-line)", "(read)", "(read-char)", "(y-or-n-p)"})
        EXPECT_EQ(session.error(reading), "the end of the input was reached too soon.") << reading;
}
