// What CHECK_LEAKS promises. Memory that a caller frees like its own, such as the string of a variable, is
// missed by nobody else.
#include <gtest/gtest.h>
#include <tessel/tsed.h>

#include <cstdlib>

#include <sys/wait.h>

#include "tests/support/RecordingHost.h"

namespace
{
// With a status of the leak checker's own, which is another one within the address sanitizer.
bool hasFailed(int status)
{
    return WIFEXITED(status) && WEXITSTATUS(status) != EXIT_SUCCESS;
}

// Not inlined, and with a stack of its own: what lies about there would still count as known.
[[gnu::noinline]] void askForTheVariable(bool givesItBack)
{
    TsResultBuffer variable = {};
    tsedGetVar(L"TEXT", &variable);
    if (givesItBack)
        delete[] variable.value.string;
    variable = {};
}

void endAfterAsking(bool givesItBack)
{
    recordingHost().reset();
    recordingHost().variables.set(L"TEXT", RecordingValue::String(L"text"));
    askForTheVariable(givesItBack);
    std::exit(EXIT_SUCCESS);
}
} // namespace

TEST(LeakCheck, FailsAProgramThatLosesTheStringOfAVariable)
{
    EXPECT_EXIT(endAfterAsking(true), testing::ExitedWithCode(EXIT_SUCCESS), "");
    EXPECT_EXIT(endAfterAsking(false), hasFailed, "tsedGetVar");
}
