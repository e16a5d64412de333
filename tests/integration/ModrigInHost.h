// A real host in this process that has loaded Modrig, with its profile and the test's files in a throwaway
// folder.
//
//     TEST_F(SomeTests, AreShort)
//     {
//         dialog([&] { EXPECT_EQ(ModrigUnderTest::load(wide(file), false, false), 1); });
//         EXPECT_EQ(said(), "");
//     }
#pragma once

#include <functional>
#include <memory>
#include <string>

#include <gmock/gmock.h>

#include "host/app/Host.h"
#include "tests/integration/ModrigUnderTest.h"
#include "tests/support/TemporaryFolder.h"

std::wstring wide(const std::filesystem::path& path);

class ModrigInHost : public testing::Test
{
protected:
    ModrigInHost();
    ~ModrigInHost() override;

    // Ends the session, and begins another one with the same profile. Modrig is not loaded yet.
    void end() { mHost.reset(); }
    void restart();
    // Lets the host load Modrig, which reads its lists and loads the Startup Suite.
    void loadModrig();

    // Types a line.
    bool type(const std::wstring& line) { return mHost->run(line); }
    // Types MODRIG, and plays the actions while the dialog is open. False when the host says that the command
    // failed; `dialog` throws then.
    bool tryDialog(const std::function<void()>& actions);
    void dialog(const std::function<void()>& actions);

    // What the host has said since it was last asked.
    std::string said();

    // A module of the test's own: the system forgets nothing about a library that an earlier test has left
    // loaded.
    std::filesystem::path module(const std::string& name) const;

    std::filesystem::path profile() const { return folder / "profile"; }

    TemporaryFolder folder;
    tessel::HostOptions options; // from the next start on

private:
    std::filesystem::path mFolderBefore;
    std::string mOutput;
    std::unique_ptr<tessel::Host> mHost;
};
