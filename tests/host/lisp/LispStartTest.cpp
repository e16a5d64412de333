#include <gtest/gtest.h>

#include <cstdio>
#include <cstdlib>

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
// Starts Lisp where the system gives no file any more, and ends with what is said about it.
void startWithoutFiles()
{
    tessel::CommandLine commandLine([](std::string_view) {});
    tessel::Document document;
    const tessel::EndRequest endRequest;
    const int next = dup(STDERR_FILENO);
    rlimit limit = {};
    getrlimit(RLIMIT_NOFILE, &limit);
    limit.rlim_cur = static_cast<rlim_t>(next);
    close(next);
    setrlimit(RLIMIT_NOFILE, &limit);
    const auto lisp = tessel::LispInterpreter::start({}, commandLine, document, endRequest);
    std::fputs(tessel::toUtf8(lisp.sentence()).c_str(), stderr);
    std::_Exit(lisp ? EXIT_SUCCESS : EXIT_FAILURE);
}
} // namespace

TEST(LispStart, FailsInASentenceWhenThereIsNoPipeToInterruptItThrough)
{
    EXPECT_EXIT(startWithoutFiles(), testing::ExitedWithCode(EXIT_FAILURE),
                "Lisp did not start: no pipe for interrupting Lisp: .*\\.");
}
