#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>
#include <filesystem>
#include <iterator>

#include <fcntl.h>
#include <sys/resource.h>
#include <unistd.h>

#include "host/applications/Document.h"
#include "host/commands/EndRequest.h"
#include "host/lisp/LispInterpreter.h"
#include "host/text/CommandLine.h"
#include "host/text/Unicode.h"

namespace
{
// In a process of its own; ends it with what the work answers.
template <class Work>
[[noreturn]] void endWith(const Work& work)
{
    tessel::CommandLine commandLine([](std::string_view) {});
    tessel::Document document;
    const tessel::EndRequest endRequest;
    tessel::LispInterpreter lisp({}, commandLine, document, endRequest);
    std::_Exit(work(lisp));
}

void setMostFiles(rlim_t count)
{
    rlimit limit = {};
    getrlimit(RLIMIT_NOFILE, &limit);
    limit.rlim_cur = count;
    setrlimit(RLIMIT_NOFILE, &limit);
}

rlim_t filesOpen()
{
    const int next = dup(STDERR_FILENO);
    close(next);
    return static_cast<rlim_t>(next);
}

// Where the system gives no file any more, and when it gives some again.
int evaluateWithoutFiles(tessel::LispInterpreter& lisp)
{
    setMostFiles(filesOpen());
    const auto value = lisp.evaluate(L"(+ 1 2)");
    setMostFiles(filesOpen() + 16);
    const auto later = lisp.evaluate(L"(+ 1 2)");
    std::fputs(tessel::toUtf8(value.sentence() + L" Later: " + (later ? *later : later.sentence())).c_str(),
               stderr);
    return value ? EXIT_FAILURE : EXIT_SUCCESS;
}

bool hasThread()
{
    return std::distance(std::filesystem::directory_iterator("/proc/self/task"), {}) > 1;
}

int useWithoutLisp(tessel::LispInterpreter& lisp)
{
    lisp.interrupt();
    lisp.interruptUntilItEnds();
    lisp.runQueue();
    const bool before = hasThread() || lisp.running() || lisp.evaluations() != 0;
    const auto value = lisp.evaluate(L"(+ 1 2)");
    return !before && value && *value == L"3" && hasThread() ? EXIT_SUCCESS : EXIT_FAILURE;
}
} // namespace

TEST(LispStart, FailsInASentenceWhenThereIsNoPipeToInterruptItThroughAndIsTriedAgain)
{
    EXPECT_EXIT(endWith(evaluateWithoutFiles), testing::ExitedWithCode(EXIT_SUCCESS),
                "Lisp did not start: no pipe for interrupting Lisp: .*\\. Later: 3");
}

// Its thread shows that it runs.
TEST(LispStart, WaitsForTheFirstExpressionAndNotForWhatInterruptsOne)
{
    EXPECT_EXIT(endWith(useWithoutLisp), testing::ExitedWithCode(EXIT_SUCCESS), "");
}
