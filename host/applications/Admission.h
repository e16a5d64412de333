// Who may be loaded. What a person asks for always may; what is loaded without being asked for (at the start,
// for another application that is being loaded, for a command) only if nothing speaks against it.
#pragma once

#include <functional>
#include <set>
#include <string>
#include <vector>

#include "host/commands/RunningMarker.h"
#include "host/text/Result.h"

namespace tessel
{
class Bisecting;
class CommandLine;
class KeptOut;

class Admission
{
public:
    // `safe`: nothing is loaded by itself in this session but what a person needs for a command.
    Admission(CommandLine& commandLine, RunningMarker& marker, KeptOut& keptOut, const Bisecting& bisecting,
              bool safe)
        : mCommandLine(commandLine), mMarker(marker), mKeptOut(keptOut), mBisecting(bisecting), mSafe(safe)
    {
    }

    RunningMarker& marker() const { return mMarker; }
    bool isSafe() const { return mSafe; }

    // Why an application is refused that is kept out: nothing has gone wrong. A person was told of the second
    // kind already. Other failures of loading have the system's numbers, from 1 on.
    static constexpr int kKeptOut = -1;
    static constexpr int kAlreadyTold = -2;
    static bool isKeptOut(int code) { return code == kKeptOut || code == kAlreadyTold; }

    // Asked with a full path before its file is opened. Why not is the end of a sentence, without its stop,
    // and one of the codes above. Says when it is the trial of an application that has ended the host.
    Result<> check(const std::wstring& path);
    // Why the application is kept out at starts, a sentence; empty for one that is not.
    std::wstring whyKeptOut(const std::wstring& path) const;
    // Why what BISECT lets in is kept out all the same, the end of a sentence: "is kept out ...". Empty for
    // what BISECT itself keeps out.
    std::wstring whyOut(const std::string& path) const;
    // Once the start is over: tells of a path without links why the application there was not let in by it,
    // or that it was loaded though BISECT keeps it out. Empty when neither is so.
    std::function<std::wstring(const std::string&)> whyNotAsPlanned() const;
    // Whether this session has not loaded it by itself, or would not have.
    bool keptOutAtStart(const std::wstring& path) const { return mSafe || !whyKeptOut(path).empty(); }
    // What was let in is loaded.
    void noteLoaded(const std::wstring& path);
    // The application at work has others loaded with it, now or later.
    void noteCarrier();

    // What was let in at the start without being asked for by name, but for those that others came with: in
    // the order in which it was asked for.
    std::vector<std::string> suspects() const;

private:
    Failure refuseInSafety();
    void sayWhenOnTrial(const std::string& path);

    CommandLine& mCommandLine;
    RunningMarker& mMarker;
    KeptOut& mKeptOut;
    const Bisecting& mBisecting;
    bool mSafe;
    std::vector<std::string> mAskedFor;
    std::set<std::string, std::less<>> mCarriers;
    std::set<std::string> mLoadedAllTheSame; // of what BISECT keeps out
    bool mSafetyTold = false;
};
} // namespace tessel
