// Which application is at work, in a small file of the profile: it is still there when the process is not.
//
// The file is mapped into the process, so that marking costs a copy of the path and no call of the system,
// and nothing needs to be done at the end: whatever ends the process, the file says what was going on. Each
// process has a file of its own and holds a lock on it; a file that nobody holds belongs to a session that is
// over.
#pragma once

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <string>
#include <string_view>
#include <vector>

#include "host/text/Result.h"

namespace tessel
{
class RunningMarker
{
public:
    // What an application does. The numbers stand in files.
    enum class Deed : std::uint32_t
    {
        kLoading = 1, // the system maps it and runs its constructors
        kEntryPoint,
        kUnloading, // its entry point with message 2, its destructors
        kCommand,
        kLispFile
    };
    // Why it was asked for. The numbers stand in files.
    enum class Reason : std::uint32_t
    {
        kByHand = 1,
        kAtStart,
        kForAnother, // by an application that is being loaded itself: its list of what to load with it
        kOnCommand
    };

    // How a session ended that did not end in good order: the number of a signal, or one of these.
    static constexpr int kVanished = 0; // nobody could say anything any more
    static constexpr int kCalledExit = -1;
    static constexpr int kEndedByKey = -2; // a person wished it, after Ctrl-C in vain

    struct Work
    {
        Deed deed = Deed::kLoading;
        Reason reason = Reason::kByHand;
        bool waitsForPerson = false; // nothing of it was running, as far as anybody knows
        std::int64_t since = 0;      // seconds of the calendar
        std::string path;            // UTF-8
        std::string detail;          // the name of the command
    };
    // What a session has left: what was at work innermost when it ended.
    struct Leftover
    {
        Work work;
        int ending = kVanished;
    };

    // Marks nothing.
    RunningMarker() = default;
    // Makes the folder if need be. Where no file can be kept there, the marks last as long as the process: it
    // can still say what ended it, but the next start does not know.
    explicit RunningMarker(const std::filesystem::path& folder);
    // The session has ended in good order.
    ~RunningMarker();
    RunningMarker(const RunningMarker&) = delete;
    RunningMarker& operator=(const RunningMarker&) = delete;

    // Why the marks do not outlive the process, a whole sentence.
    const Result<>& outlivesProcess() const { return mOutlivesProcess; }

    // Of sessions that ended while an application was at work. They are there again at the next start, until
    // they are forgotten.
    const std::vector<Leftover>& leftovers() const { return mLeftovers; }
    void forgetLeftovers();

    // Whether another session keeps its marks in the folder now.
    bool otherSessionRuns() const;

    // One piece of work, for as long as the object lives. These nest; the innermost is the one that counts.
    class Scope
    {
    public:
        Scope(RunningMarker& marker, Deed deed, std::string_view path, std::string_view detail = {})
            : mMarker(marker), mDepth(marker.depth())
        {
            marker.begin(deed, path, detail);
        }
        ~Scope() { mMarker.endTo(mDepth); }
        Scope(const Scope&) = delete;
        Scope& operator=(const Scope&) = delete;

    private:
        RunningMarker& mMarker;
        std::size_t mDepth;
    };

    // The same for work whose end is no end of a block.
    std::size_t depth() const;
    void begin(Deed deed, std::string_view path, std::string_view detail = {});
    void endTo(std::size_t depth);

    // Why applications are asked for, for as long as the object lives.
    class ReasonScope
    {
    public:
        ReasonScope(RunningMarker& marker, Reason reason) : mMarker(marker), mBefore(marker.mReason)
        {
            marker.mReason = reason;
        }
        ~ReasonScope() { mMarker.mReason = mBefore; }
        ReasonScope(const ReasonScope&) = delete;
        ReasonScope& operator=(const ReasonScope&) = delete;

    private:
        RunningMarker& mMarker;
        Reason mBefore;
    };
    Reason reason() const { return mReason; }

    // A command waits for the person in front of it: from now on a process that vanishes is not its doing.
    void noteWaiting();

    // The rest is safe in a signal handler.

    // What is at work; the texts are pieces of the file. False when nothing is, or in a child process.
    struct AtWork
    {
        Deed deed;
        Reason reason;
        bool waitsForPerson;
        std::string_view path;
        std::string_view detail;
    };
    bool innermost(AtWork& work) const noexcept;
    void noteEnding(int ending) noexcept;

private:
    struct Slot;
    struct Page;
    struct OpenFile
    {
        std::filesystem::path path;
        int descriptor = -1;
    };

    bool holds(const std::filesystem::path& path) const;
    void collect(const std::filesystem::path& folder);
    void make(const std::filesystem::path& folder);
    Result<> keepIn(const std::filesystem::path& folder);
    bool map(int flags, int file);
    bool marks() const;

    Result<> mOutlivesProcess;
    Page* mPage = nullptr;
    OpenFile mFile;
    std::vector<OpenFile> mOld; // held, so that no other session reads them as well
    std::vector<Leftover> mLeftovers;
    Reason mReason = Reason::kByHand;
};

// The words for these, as parts of a sentence; the detail is the name of a command.
std::wstring wordsFor(RunningMarker::Deed deed, const std::wstring& detail);
std::wstring wordsForEnding(int ending);
} // namespace tessel
