// Whatever Lisp does, the host goes on, and so does Lisp.
#include <csignal>
#include <cstdint>

#include <sys/wait.h>

#include <gmock/gmock.h>

#include "tests/host/lisp/LispSession.h"

using testing::HasSubstr;
using testing::Not;

namespace
{
constexpr char kStackOverflow[] = "stack overflow: the recursion is endless or too deep.";
constexpr char kExhausted[] = "the memory for Lisp is exhausted.";

class LispSurvival : public testing::Test
{
protected:
    ~LispSurvival() override
    {
        EXPECT_EQ(session.value("(defun still () (format nil \"~a\" '(here))) (still)"), "\"(HERE)\"");
    }

    LispSession session;
};
} // namespace

TEST_F(LispSurvival, OfEndlessRecursionOfEveryKindTimeAndAgain)
{
    for (int round = 0; round < 3; ++round)
        for (const char* body :
             {"(1+ (a x))", "(unwind-protect (a x) x)", "(unwind-protect (a x) (list 1 (princ-to-string x)))",
              "(handler-case (1+ (a x)) (type-error () 1))", "(1+ (apply #'a (list x)))",
              "(mapcar #'a (list x))", "(let ((*print-base* x)) (1+ (a x)))", "(catch 'x (1+ (a x)))",
              "(1+ (eval `(funcall ,#'a ,x)))"})
            EXPECT_EQ(session.error(std::string("(labels ((a (x) ") + body + ")) (a 10))"), kStackOverflow)
                << body;
}

TEST_F(LispSurvival, OfEndlessRecursionThatIsHandled)
{
    EXPECT_EQ(session.value("(let ((caught 0))"
                            "  (dotimes (i 20 caught)"
                            "    (handler-case (labels ((a (x) (unwind-protect (a x) x))) (a 1))"
                            "      (ext:stack-overflow () (incf caught)))))"),
              "20");
}

TEST_F(LispSurvival, OfExhaustedMemory)
{
    for (const char* greedy :
         {"(let (l) (loop (push 1 l)))", "(let (l) (loop (push (make-array 1000) l)))",
          "(make-array 2000000000)",
          "(let ((h (make-hash-table))) (loop for i from 0 do (setf (gethash i h) i)))",
          "(let ((x 7)) (loop (setq x (* x x))))",
          "(let ((s (make-string-output-stream))) (loop (write-string \"aaaaaaaaaaaaaaaaaaaaaaaaaa\" s)))"})
        EXPECT_EQ(session.error(greedy), kExhausted) << greedy;
}

TEST_F(LispSurvival, OfMemoryThatSymbolsExhaust)
{
    for (int round = 0; round < 2; ++round)
        EXPECT_THAT(session.error("(loop for i from 0 do (intern (format nil \"S~A\" i)))"),
                    HasSubstr("the memory for Lisp is exhausted"));
}

TEST_F(LispSurvival, OfTextThatIsNestedTooDeep)
{
    const std::string deep = std::string(6000, '(') + std::string(6000, ')');
    EXPECT_EQ(session.error(deep), "The expression is nested more than 5000 levels deep.");
    EXPECT_EQ(session.error(std::string(6000, '\'') + "a"),
              "The expression is nested more than 5000 levels deep.");
    session.error("(read-from-string (make-string 100000 :initial-element #\\())");
}

TEST_F(LispSurvival, OfTextThatIsNestedJustNotTooDeep)
{
    session.value("'" + std::string(4990, '(') + std::string(4990, ')'));
    std::string sum = "0";
    for (int level = 0; level < 4990; ++level)
        sum = "(1+ " + sum + ")";
    EXPECT_EQ(session.value(sum), "4990");
}

TEST_F(LispSurvival, OfDeepLists)
{
    session.value("(defun deep (n) (let (l) (dotimes (i n l) (setf l (list l)))))");
    EXPECT_EQ(session.value("(equal (deep 500000) (deep 500000))"), "T");
    EXPECT_EQ(session.error("(prin1-to-string (deep 500000))"), kStackOverflow);
}

TEST_F(LispSurvival, OfTextThatIsCutShortWhereAReaderWantsAnObject)
{
    for (const char* text :
         {"#p", "#P ", "(a #p", "#p#p", "#1=", "#1= ; x", "#1=;", "#1=#|x|#", "#1=#|x|#;y", "#1=#p", "(#1=#",
          "#$", "#$ ; x", "(#$#|x|#", "#1=#+nil x", "#1=#-ecl x", "#1=(#$"})
        EXPECT_THAT(session.error("(read-from-string \"" + std::string(text) + "\")"),
                    Not(testing::IsEmpty()))
            << text;
    EXPECT_EQ(session.value("(list #p\"/tmp/x\" #1=#|y|# 5 #1#)"), "(#P\"/tmp/x\" 5 5)");
}

// Whatever character it is: what follows is skipped, and then nothing is left.
TEST_F(LispSurvival, OfEveryReaderAtTheEndOfATextThatSkipsTheLastObject)
{
    for (char character = '!'; character <= '~'; ++character)
        for (const std::string before : {"", "#", "#1", "(#", "'#1"})
            for (const std::string after : {"", " ", "#+nil x", "#|x|#", "; x"})
            {
                const std::string letter = character == '"' || character == '\\' ? "\\" : "";
                const std::string text = before + letter + character + after;
                EXPECT_EQ(session.value("(progn (ignore-errors (read-from-string \"" + text + "\")) 7)"),
                          "7");
            }
}

TEST_F(LispSurvival, OfAttemptsToEndTheProcess)
{
    for (const char* ending : {"(quit)", "(exit)", "(quit 3)", "(ext:quit)", "(si::exit 3)"})
        EXPECT_EQ(session.error(ending), "Lisp cannot end the host; type QUIT without parentheses to do so.")
            << ending;
    EXPECT_EQ(session.error("(mp:exit-process)"), "Lisp has given up what it was doing.");
}

TEST_F(LispSurvival, OfJumpsAndTheDebugger)
{
    EXPECT_THAT(session.error("(throw 'nowhere 1)"), HasSubstr("NOWHERE"));
    EXPECT_THAT(session.error("(abort)"), HasSubstr("ABORT"));
    EXPECT_EQ(session.error("(break)"), "Break");
    EXPECT_EQ(session.error("(invoke-debugger (make-condition 'simple-error :format-control \"hm\"))"), "hm");
    EXPECT_EQ(session.error("(unwind-protect (error \"a\") (error \"b\"))"), "b");
}

TEST_F(LispSurvival, OfThreadsWithErrors)
{
    EXPECT_EQ(
        session.value("(mp:process-join (mp:process-run-function 'x (lambda () (print 1) (error \"x\"))))"),
        "");
    EXPECT_EQ(session.output(), "");
}

namespace
{
// By the signal, or by the sanitizer's report of it.
bool endsByMemoryFault(int status)
{
    return WIFSIGNALED(status) ? WTERMSIG(status) == SIGSEGV : WEXITSTATUS(status) != 0;
}
} // namespace

TEST(LispAndMemoryFaultsDeathTest, LeavesRealOnesAsTheyWere)
{
    testing::FLAGS_gtest_death_test_style = "threadsafe";
    EXPECT_EXIT(
        {
            LispSession session;
            session.value("(+ 1 2)");
            auto* nowhere = reinterpret_cast<volatile int*>(std::uintptr_t{64});
            *nowhere = 1;
        },
        endsByMemoryFault, "");
}
