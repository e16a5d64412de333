// The applications that the host does not load by itself: those that ended it, and those that a person keeps
// out. They stay in every list that they are in.
//
// What ended the host is kept out at the next start, and tried once more at the one after that: a power cut
// must not cost an application for good. If it ends the host again, it stays out until a person loads it with
// success or lets it in, or until its file is another one. An application on trial is forgotten here when the
// session that tries it ends in good order, whether it was loaded or not: nothing more can be learnt of an
// application that nothing loads by itself.
//
// All of it stands in a text file of the profile, which several sessions may change.
#pragma once

#include <cstdint>
#include <filesystem>
#include <functional>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "host/commands/RunningMarker.h"
#include "host/platform/FileFacts.h"
#include "host/text/Result.h"

namespace tessel
{
struct KeptOutApplication
{
    // The numbers stand in the file.
    enum class Stage : std::uint32_t
    {
        kThisTime = 1, // it has ended the host once, in the last session
        kOnTrial,      // it is let in once more
        kForGood,      // it has ended the host again
        kByPerson
    };

    std::string path; // full
    std::string realPath;
    Stage stage = Stage::kThisTime;
    std::int64_t since = 0; // seconds of the calendar
    RunningMarker::Deed deed = RunningMarker::Deed::kLoading;
    RunningMarker::Reason reason = RunningMarker::Reason::kByHand;
    int ending = RunningMarker::kVanished;
    std::string detail;
    FileFacts facts;
    std::optional<std::uint64_t> hash; // known once it is on trial

    // It is not loaded by itself.
    bool isOut() const { return stage != Stage::kOnTrial; }
};

class KeptOut
{
public:
    static constexpr char kFileName[] = "kept-out"; // in its folder

    // Keeps nothing out and stores nothing.
    KeptOut() = default;
    // Of the folder, which is there; a file that is damaged is left as it is, and nothing is kept out.
    explicit KeptOut(std::filesystem::path folder);

    // A start, with what earlier sessions have left: judges them, and gives those a trial whose time has
    // come, unless nothing will be loaded by itself anyway. What was judged now waits for the next start.
    struct Start
    {
        std::vector<std::wstring> sentences; // that a person is to be told
        Result<> stored;                     // all that was learnt
    };
    Start begin(const std::vector<RunningMarker::Leftover>& leftovers, bool givesTrials);
    // Whether it was judged at this start, and a person was told.
    bool wasTold(const KeptOutApplication& application) const;

    // What a person is to be told when the application at that full path is about to be loaded without being
    // asked for, if this is its trial; once.
    std::optional<std::wstring> takeTrialSentence(const std::string& path);

    // What is known of the application at that full path, links followed; null for most.
    const KeptOutApplication* find(const std::string& path) const;
    const std::vector<KeptOutApplication>& all() const { return mApplications; }

    // A person keeps it out, or lets it in whatever kept it out. The first fails where there is no
    // application, the second when nothing keeps it out.
    Result<> keepOut(const std::string& path);
    Result<> letIn(const std::string& path);

    // It was loaded, by a person's wish or without, and the host is still there.
    void noteLoaded(const std::string& path, bool byHand);
    // The session ends in good order.
    void noteGoodEnd();

private:
    using Applications = std::vector<KeptOutApplication>;

    Result<Applications> read() const;
    // Changes what is stored now, which another session may have changed since it was read.
    Result<> change(const std::function<void(Applications&)>& work);
    static std::wstring judge(const RunningMarker::Leftover& leftover, std::size_t sessions,
                              Applications& applications);
    void giveTrials(Applications& applications);

    std::filesystem::path mFile;
    Applications mApplications;
    std::vector<std::string> mTold;  // those judged at this start, links followed
    std::vector<std::string> mTried; // of those whose trial this session is
    std::set<std::string> mTrialsTold;
};
} // namespace tessel
