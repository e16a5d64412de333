#include <gmock/gmock.h>

#include "tests/host/lisp/LispSession.h"

using testing::AllOf;
using testing::HasSubstr;
using testing::SizeIs;

TEST(LispEvaluation, AnswersThePrintedValue)
{
    LispSession session;
    EXPECT_EQ(session.value("(+ 40 2)"), "42");
    EXPECT_EQ(session.value("(list 1 \"a\" 'b 2.5)"), "(1 \"a\" B 2.5)");
    EXPECT_EQ(session.value("nil"), "NIL");
    EXPECT_EQ(session.output(), "");
}

TEST(LispEvaluation, RunsEveryFormOfALineAndAnswersTheLastValue)
{
    LispSession session;
    EXPECT_EQ(session.value("(setf *a* 1) (incf *a*) (* *a* 21)"), "42");
}

TEST(LispEvaluation, ReadsEachFormAsThoseBeforeItDemand)
{
    LispSession session;
    EXPECT_EQ(session.value("(defpackage \"MINE\" (:use \"CL\")) (symbol-name 'mine::x)"), "\"X\"");
}

TEST(LispEvaluation, KeepsDefinitionsAndThePackageFromLineToLine)
{
    LispSession session;
    EXPECT_EQ(session.value("(defun twice (x) (* 2 x))"), "TWICE");
    EXPECT_EQ(session.value("(twice 21)"), "42");
    session.value("(in-package \"CL-USER\")");
    EXPECT_EQ(session.value("(package-name *package*)"), "\"COMMON-LISP-USER\"");
}

TEST(LispEvaluation, ForgetsWhatAnEarlierSessionDefined)
{
    {
        LispSession session;
        session.value("(defun twice (x) (* 2 x))");
    }
    LispSession session;
    EXPECT_EQ(session.error("(twice 21)"), "The function TWICE is undefined.");
}

TEST(LispEvaluation, HasNothingToShowForACommentNoValuesAndPrincAlone)
{
    LispSession session;
    for (const char* expression :
         {"", "  ; a comment", "#| one |#", "(values)", "(princ)", "(progn 1 (princ))"})
        EXPECT_EQ(session.value(expression), "") << expression;
}

TEST(LispEvaluation, TellsErrorsInOneLine)
{
    LispSession session;
    EXPECT_EQ(session.error("unknown"), "The variable UNKNOWN is unbound.");
    EXPECT_EQ(session.error("(unknown 1)"), "The function UNKNOWN is undefined.");
    EXPECT_EQ(session.error("(/ 1 0)"), "division by zero.");
    EXPECT_EQ(session.error("(error \"two~%   lines with ~a\" \"a  size\")"), "two lines with a  size");
    EXPECT_THAT(session.error("(car 5)"), AllOf(HasSubstr("CAR"), HasSubstr("5")));
    EXPECT_EQ(session.error("(error 'program-error)"), "an error of the type PROGRAM-ERROR.");
    EXPECT_EQ(session.error("nowhere::symbol"), "There is no package with the name NOWHERE.");
}

TEST(LispEvaluation, TellsErrorsOfTheReader)
{
    LispSession session;
    for (const char* unfinished : {"(+ 1", "\"abc", "#| abc", "'", "|abc"})
        EXPECT_EQ(session.error(unfinished), "The form that begins here is never closed.") << unfinished;
    EXPECT_THAT(session.error(")"), HasSubstr("Unmatched right parenthesis"));
    EXPECT_THAT(session.error("#<a>"), HasSubstr("dispatch macro character"));
    EXPECT_EQ(session.error("#.(error \"at read time\")"), "at read time");
}

TEST(LispEvaluation, TellsAnErrorThatCannotTellItself)
{
    LispSession session;
    session.value("(define-condition worse (error) () (:report (lambda (c s) (error \"again\"))))");
    EXPECT_EQ(session.error("(error 'worse)"), "an error of the type WORSE, which cannot be printed.");
}

TEST(LispEvaluation, TakesNonAsciiTextBothWays)
{
    LispSession session;
    EXPECT_EQ(session.value("(concatenate 'string \"größe\" \" ∑ 🙂\")"), "\"größe ∑ 🙂\"");
    EXPECT_EQ(session.value("(length \"größe🙂\")"), "6");
    EXPECT_EQ(session.value("(defun größe () 'ä) (größe)"), "Ä");
}

TEST(LispEvaluation, BoundsWhatItPrints)
{
    LispSession session;
    EXPECT_EQ(session.value("(let ((l (list 1 2))) (setf (cddr l) l))"), "#1=(1 2 . #1#)");
    EXPECT_EQ(session.value("(expt 7 1000000)"), "#<an integer of 2807355 bits>");
    EXPECT_THAT(session.value("(make-string 1000000)"), SizeIs(testing::Lt(10100U)));
    EXPECT_THAT(session.value("(make-array 1000000)"), SizeIs(testing::Lt(1000U)));
    EXPECT_THAT(session.value("(let (l) (dotimes (i 100000 l) (setf l (list l))))"),
                SizeIs(testing::Lt(100U)));
}

TEST(LispEvaluation, DoesNotLetSettingsOfThePrinterSpoilIts)
{
    LispSession session;
    session.value("(setf *print-base* 2 *print-readably* t *print-length* 0)");
    EXPECT_EQ(session.value("(list 10 11)"), "(10 11)");
}

TEST(LispEvaluation, KeepsTheFunctionsOfLispAndOfTheSystem)
{
    LispSession session;
    EXPECT_EQ(session.error("(defun list (x) x)"), "Attempt to redefine function LIST in locked package.");
    EXPECT_EQ(session.error("(defun princ (x) x)"), "Attempt to redefine function PRINC in locked package.");
    EXPECT_EQ(session.value("(list 1)"), "(1)");
}

TEST(LispSentences, PutInWhatLispPrintsEvenNil)
{
    LispSession session;
    session.value("(setf *print-base* 2)");
    EXPECT_EQ(session.value("(tessel-host::translated \"{} and {}\" 10 nil)"), "\"10 and NIL\"");
    EXPECT_EQ(session.value("(tessel-host::translated \"{}\" \"a {}\")"), "\"a {}\"");
}

TEST(LispSentences, StandAsTheyAreWhenTheirPlacesDoNotFit)
{
    LispSession session;
    EXPECT_EQ(session.value("(tessel-host::translated \"{} and {}\" 1)"), "\"{} and {}\"");
    EXPECT_EQ(session.value("(tessel-host::translated \"none\" 1)"), "\"none\"");
}

TEST(LispSentences, AreFoundInEveryThread)
{
    LispSession session;
    EXPECT_EQ(session.value("(let* ((said nil) (thread (mp:process-run-function 'talker (lambda ()"
                            " (setf said (handler-case (quit) (error (e) (princ-to-string e))))))))"
                            " (mp:process-join thread) said)"),
              "\"Lisp cannot end the host; type QUIT without parentheses to do so.\"");
}
