#include <gmock/gmock.h>

#include "tests/host/lisp/LispSession.h"

TEST(LispQueue, RunsExpressionsInTheOrderOfQueueingWhenTold)
{
    LispSession session;
    qxr_queueexpr(L"(write-line \"one\")");
    qxr_queueexpr(L"(write-line \"two\")");
    qxr_queueexpr(L"(prompt \"Command: \")");
    EXPECT_EQ(session.output(), "");
    session.lisp().runQueue();
    EXPECT_EQ(session.output(), "one\ntwo\nCommand: ");
    session.lisp().runQueue(); // nothing is left
    EXPECT_EQ(session.output(), "one\ntwo\nCommand: ");
}

TEST(LispQueue, DoesNotPrintValues)
{
    LispSession session;
    session.lisp().queue(L"(+ 1 2)");
    session.lisp().runQueue();
    EXPECT_EQ(session.output(), "");
}

TEST(LispQueue, GoesOnAfterAnErrorThatIsSaidInOneLine)
{
    LispSession session;
    session.lisp().queue(L"(unknown)");
    session.lisp().queue(L"(write-line \"two\")");
    session.lisp().runQueue();
    EXPECT_EQ(session.output(), "The function UNKNOWN is undefined.\ntwo\n");
}

TEST(LispQueue, PutsWhatIsQueuedMeanwhileAtTheEnd)
{
    LispSession session;
    bool queued = false;
    session.onOutput(
        [&](std::string_view)
        {
            if (!std::exchange(queued, true))
                qxr_queueexpr(L"(write-line \"three\")");
        });
    qxr_queueexpr(L"(write-line \"one\")");
    qxr_queueexpr(L"(write-line \"two\")");
    session.lisp().runQueue();
    EXPECT_EQ(session.output(), "one\ntwo\nthree\n");
}

TEST(LispQueue, DoesNotBeginAgainWithinItself)
{
    LispSession session;
    session.onOutput([&](std::string_view) { session.lisp().runQueue(); });
    session.lisp().queue(L"(progn (write-line \"one\") (write-line \"still one\"))");
    session.lisp().queue(L"(write-line \"two\")");
    session.lisp().runQueue();
    EXPECT_EQ(session.output(), "one\nstill one\ntwo\n");
}

TEST(LispRunning, IsToldWhileAnExpressionRuns)
{
    LispSession session;
    bool running = false;
    session.onOutput([&](std::string_view) { running = session.lisp().running(); });
    session.value("(write-line \"x\")");
    EXPECT_TRUE(running);
    EXPECT_FALSE(session.lisp().running());
}

TEST(LispSetting, AnswersWhetherCompiledAndPackagedLispCanBeLoaded)
{
    {
        LispSession session(true);
        EXPECT_TRUE(RemovingTsLISP());
    }
    LispSession session(false);
    EXPECT_FALSE(RemovingTsLISP());
}

TEST(LispSetting, TakesFunctionsAwayThatAreForRemovingOnly)
{
    LispSession session(false);
    EXPECT_EQ(session.error("(_INTERNAL-LOAD-ALL-FILE \"x.lsp\" nil T T nil)"),
              "The function _INTERNAL-LOAD-ALL-FILE is undefined.");
    EXPECT_EQ(session.error("(qz-unload-rpk \"x\")"), "The function QZ-UNLOAD-RPK is undefined.");
    EXPECT_EQ(session.error("(load \"x.qbc\" )"), "Cannot load \"x.qbc\": No such file or directory.");
}

TEST(LispSetting, OffersThemOtherwise)
{
    LispSession session;
    EXPECT_EQ(session.value("(qz-unload-rpk \"plates\")"), "NIL");
    EXPECT_EQ(session.output(), "No packaged application named plates is loaded.\n");
}
