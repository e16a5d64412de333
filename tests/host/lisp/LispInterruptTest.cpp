#include <csignal>
#include <thread>

#include <gmock/gmock.h>

#include "host/commands/Interruption.h"
#include "tests/host/lisp/LispSession.h"
#include "tests/support/TemporaryFolder.h"

using testing::EndsWith;

namespace
{
// Lisp that never ends is interrupted as soon as it has begun to run, which it tells by printing.
class LispInterrupt : public testing::Test
{
protected:
    LispInterrupt()
    {
        session.onOutput([this](std::string_view) { session.lisp().interrupt(); });
    }

    std::string interrupted(const std::string& endless)
    {
        return session.error("(princ \"begun\") " + endless);
    }

    LispSession session;
};
} // namespace

TEST_F(LispInterrupt, StopsAnEndlessLoop)
{
    EXPECT_EQ(interrupted("(loop)"), "Lisp was interrupted.");
    EXPECT_EQ(session.output(), "begun");
    EXPECT_FALSE(session.lisp().running());
}

TEST(LispInterruptBeforeItsTime, StopsLispThatHasNotBegunYet)
{
    LispSession session;
    const tessel::EndRequest endRequest;
    tessel::Interruption interruption(endRequest);
    const tessel::Interruption::Work work(interruption);
    const tessel::Interruption::Wish wish(interruption);
    EXPECT_EQ(*session.lisp().evaluate(L"(+ 1 2)", &wish), L"3");
    interruption.press(session.lisp().evaluations());
    session.lisp().interrupt(); // as the key does it: nothing runs yet that this could stop
    EXPECT_EQ(session.lisp().evaluate(L"(loop)", &wish).sentence(), L"Lisp was interrupted.");
}

TEST_F(LispInterrupt, LeavesLispInOrder)
{
    for (int round = 0; round < 20; ++round)
    {
        EXPECT_EQ(interrupted("(loop (make-list 100))"), "Lisp was interrupted.");
        EXPECT_EQ(session.value("(+ 1 2)"), "3");
    }
}

TEST_F(LispInterrupt, PassesErrorHandlers)
{
    EXPECT_EQ(interrupted("(loop (ignore-errors (loop (ignore-errors (error \"x\")))))"),
              "Lisp was interrupted.");
    EXPECT_EQ(interrupted("(loop (handler-case (loop) (condition () 1)))"), "Lisp was interrupted.");
    EXPECT_EQ(interrupted("(loop (catch 'x (throw 'x 1)))"), "Lisp was interrupted.");
}

TEST_F(LispInterrupt, WakesLispThatSleeps)
{
    EXPECT_EQ(interrupted("(sleep 1000)"), "Lisp was interrupted.");
}

TEST_F(LispInterrupt, StopsThePrintingOfItsValueAndItsError)
{
    session.value("(defclass endless () ())"
                  "(defmethod print-object ((e endless) s) (princ \"begun\" *terminal-io*) (loop))"
                  "(define-condition never (error) () (:report (lambda (c s) (princ \"begun\" *terminal-io*) "
                  "(loop))))");
    EXPECT_EQ(session.error("(make-instance 'endless)"), "Lisp was interrupted.");
    EXPECT_EQ(session.error("(error 'never)"), "Lisp was interrupted.");
}

TEST_F(LispInterrupt, NamesTheLineOfAFile)
{
    const TemporaryFolder folder;
    const auto path = folder.write("endless.lsp", "1\n\n\n(progn (princ \"begun\")\n  (loop))\n").string();
    EXPECT_EQ(session.error("(load \"" + path + "\")"), path + ":4: Lisp was interrupted.");
    EXPECT_EQ(session.document().loadedApplicationCount(), 0);
}

TEST_F(LispInterrupt, StopsOneExpressionOfTheQueueOnly)
{
    session.lisp().queue(L"(progn (princ \"begun\") (loop))");
    session.lisp().queue(L"(setq sum (+ 1 2))");
    session.lisp().runQueue();
    EXPECT_EQ(session.output(), "begun\nLisp was interrupted.\n");
    EXPECT_FALSE(session.lisp().running());
    EXPECT_EQ(session.value("sum"), "3");
}

TEST_F(LispInterrupt, StopsAFunctionThatIsCalled)
{
    session.value("(defun endless () (princ \"begun\") (loop))");
    TsResultBuffer* call = tsutBuildList({TsRbValue::String(L"endless")});
    TsResultBuffer* result = nullptr;
    EXPECT_EQ(tsedInvoke(call, &result), TS_ERROR);
    EXPECT_EQ(result, nullptr);
    EXPECT_THAT(session.output(), EndsWith("Lisp was interrupted.\n"));
    tsutRelRb(call);
}

TEST(LispInterruptAtRest, DoesNothing)
{
    LispSession session;
    session.lisp().interrupt();
    for (int round = 0; round < 100; ++round)
    {
        session.lisp().interrupt();
        EXPECT_EQ(session.value("(+ 1 2)"), "3");
    }
}

TEST(LispInterruptFromAnywhere, MayComeFromASignalHandler)
{
    static LispSession* current = nullptr;
    LispSession session;
    current = &session;
    const auto previous = std::signal(SIGINT, [](int) { current->lisp().interrupt(); });
    session.onOutput([](std::string_view) { std::raise(SIGINT); });
    EXPECT_EQ(session.error("(princ \"begun\") (loop)"), "Lisp was interrupted.");
    std::signal(SIGINT, previous);
    current = nullptr;
}

TEST(LispInterruptFromAnywhere, MayComeFromAnotherThread)
{
    LispSession session;
    std::thread other;
    session.onOutput([&](std::string_view) { other = std::thread([&] { session.lisp().interrupt(); }); });
    EXPECT_EQ(session.error("(princ \"begun\") (loop)"), "Lisp was interrupted.");
    other.join();
}

// An interrupt that comes as the evaluation ends must not meet the host's own code, nor the next evaluation.
TEST(LispInterruptFromAnywhere, MayComeAtAnyMoment)
{
    LispSession session;
    std::atomic<bool> over = false;
    std::thread other(
        [&]
        {
            while (!over)
                session.lisp().interrupt();
        });
    for (int round = 0; round < 2000; ++round)
    {
        const auto value = session.lisp().evaluate(L"(length (loop for i below 100 collect (make-list 10)))");
        if (value)
            EXPECT_EQ(*value, L"100");
        else
            EXPECT_EQ(value.sentence(), L"Lisp was interrupted.");
    }
    over = true;
    other.join();
    EXPECT_EQ(session.value("(+ 1 2)"), "3");
}
