// Runs all tests of the dialogs under one display of their own.
#include <cstdlib>
#include <iostream>

#include <gtest/gtest.h>

#include "host/text/Unicode.h"
#include "tests/dialogs/support/VirtualDisplay.h"
#include "tests/support/RecordingHost.h"
#include "tests/support/TemporaryFolder.h"

#include <tesselui/tsuidisplay.h>

#import <Foundation/Foundation.h>

namespace
{
// Whoever runs the tests reads the texts that they expect, unless a run asks for another language.
void speakOneLanguage()
{
    const char* language = std::getenv("LANGUAGE_OF_TESTS");
    unsetenv("LANGUAGE");
    unsetenv("LC_ALL");
    setenv("LANG", "C.UTF-8", 1);
    setenv("LC_MESSAGES", language ? language : "C", 1);
}
} // namespace

int main(int argc, char** argv)
try
{
    testing::InitGoogleTest(&argc, argv);
    speakOneLanguage();
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
