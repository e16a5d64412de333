// Starts the real Tessel, as a person or a script would, and listens to it.
//
//     HostSession session;                                   // a throwaway profile
//     const HostResult result = session.run({"SETVAR LISPENABLED 0", "VERSION"});
//     EXPECT_EQ(result.exitStatus, 0);
//     EXPECT_THAT(result.output, HasSubstr("Tessel R21"));
//
// The profile lives as long as the session, so that a second run finds what the first one stored.
#pragma once

#include <chrono>
#include <filesystem>
#include <string>
#include <utility>
#include <vector>

#include "tests/support/TemporaryFolder.h"

inline constexpr std::chrono::seconds kHostTimeLimit{60};

// What the host answers when it is asked for its version.
inline constexpr char kVersionLine[] = "Tessel R21, reference host for Modrig, version " MODRIG_VERSION "\n";

struct HostResult
{
    std::string output; // what the host printed, errors included, without times
    int exitStatus = 0; // of a host that a signal ended: minus the signal's number
    bool timedOut = false;
};

// A variable of the environment with its value.
using EnvironmentChange = std::pair<std::string, std::string>;

// The output without the times that loading took, which differ from run to run: ", loaded in 0.4 ms".
std::string withoutTimes(const std::string& output);

class HostSession
{
public:
    HostSession();

    // Runs the commands by `-c`, one argument each, and waits for the end.
    HostResult run(const std::vector<std::string>& commands) const;

    // Runs the lines as a script file, or down a pipe.
    HostResult runScript(const std::string& lines) const;
    HostResult runPipe(const std::string& lines) const;

    // Starts the host with these arguments after `--profile-dir`, and gives it the text to read.
    HostResult start(const std::vector<std::string>& arguments, const std::string& input = {}) const;

    // Arguments that are put in front of all others, such as "--safe".
    void alwaysWith(std::vector<std::string> arguments) { mAlways = std::move(arguments); }

    // A shell command that starts the host, which it knows as "$0" "$@": for limits and pipes.
    void startBy(const std::string& shellCommand) { mLauncher = {"/bin/sh", "-c", shellCommand}; }

    // Rights of files bind the administrator only who gives up his own.
    void startBoundByRights();

    // Changes the environment that the host is started in. It has no display from the beginning.
    void set(const std::string& variable, const std::string& value);

    // Leaves in the output how long loading took.
    void keepTimes() { mKeepsTimes = true; }

    const TemporaryFolder& folder() const { return mFolder; } // for the files of the test
    std::filesystem::path profile() const { return mFolder / mProfile; }
    void nameProfile(const std::string& name) { mProfile = name; }

    // The program and its arguments, and the environment, as `execve` wants them.
    std::vector<std::string> commandLine(const std::vector<std::string>& arguments) const;
    std::vector<std::string> environment() const;

private:
    TemporaryFolder mFolder;
    std::string mProfile = "profile";
    std::vector<std::string> mLauncher;
    std::vector<std::string> mAlways;
    bool mKeepsTimes = false;
    std::vector<EnvironmentChange> mEnvironment;
};
