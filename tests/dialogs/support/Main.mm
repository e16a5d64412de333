// Runs all tests of the dialogs under one display of their own.
#include <csignal>
#include <cstdlib>
#include <iostream>

#include <sys/prctl.h>
#include <sys/wait.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include "host/text/Unicode.h"
#include "tests/dialogs/support/VirtualDisplay.h"
#include "tests/support/RecordingHost.h"
#include "tests/support/TemporaryFolder.h"

#include <tesselui/tsuidisplay.h>

#import <Foundation/Foundation.h>

namespace
{
constexpr char kHasFolder[] = "MODRIG_UI_TESTS_HAVE_A_FOLDER";

[[noreturn]] void startAgainIn(const TemporaryFolder& folder, char** argv)
{
    prctl(PR_SET_PDEATHSIG, SIGKILL);
    setenv("TMPDIR", std::filesystem::temp_directory_path().c_str(), 1); // of the tests themselves
    for (const char* variable : {"TMP", "TEMP"})                         // of the toolkit
        setenv(variable, folder.path().c_str(), 1);
    setenv(kHasFolder, "1", 1);
    execv("/proc/self/exe", argv);
    _exit(127);
}

// The programs that serve the toolkit (its pasteboard is one) and those that they serve find one another by
// the folder for temporary files, and end with the first that needed them: several runs of these tests would
// take them from each other. The toolkit looks the folder up before `main` and needs it until after, so that
// the tests run in a program of their own.
int runInAFolderOfItsOwn(char** argv)
{
    const TemporaryFolder folder;
    const pid_t tests = fork();
    if (tests == 0)
        startAgainIn(folder, argv);
    int status = 0;
    waitpid(tests, &status, 0);
    return WIFEXITED(status) ? WEXITSTATUS(status) : EXIT_FAILURE;
}
} // namespace

int main(int argc, char** argv)
try
{
    if (!std::getenv(kHasFolder))
        return runInAFolderOfItsOwn(argv);
    testing::InitGoogleTest(&argc, argv);
    const VirtualDisplay display;
    setenv("DISPLAY", display.name().c_str(), 1);
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    const TemporaryFolder profile;
    recordingHost().applicationServices.folderOfProfile = tessel::toWide(profile.path().string());
    if (!tsuiPrepareWindows())
        return EXIT_FAILURE;
    const int result = RUN_ALL_TESTS();
    [pool drain];
    return result;
}
catch (const std::exception& error)
{
    std::cerr << error.what() << '\n';
    return EXIT_FAILURE;
}
