// The whole host in one object: the composition root. The program Tessel is this and a console; a test starts
// the same host in its own process:
//
//     std::string output;
//     HostOptions options;
//     options.profileFolder = folder / "profile";
//     options.output = [&](std::string_view text) { output += text; };
//     Host host(options);
//     ASSERT_TRUE(host.start());
//     EXPECT_TRUE(host.run(L"VERSION"));
//     host.end();
//
// One host at a time in a process, and everything on the thread that makes it. The SDK's functions answer for
// the host that is running.
#pragma once

#include <atomic>
#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "host/app/Export.h"
#include "host/app/WindowQuestions.h"
#include "host/commands/EndRequest.h"
#include "host/commands/Interruption.h"
#include "host/console/Completion.h"
#include "host/console/LineRunner.h"
#include "host/files/RemoteFiles.h"
#include "host/messages/Questions.h"
#include "host/text/CommandLine.h"
#include "host/text/Translation.h"

namespace tessel
{
class LispInterpreter;
class Registry;
class RunningMarker;
struct LoadOutcome;
struct Parts;

struct HostOptions
{
    std::filesystem::path profileFolder; // made when it is missing
    // Where values for everybody are laid out; those of later ones stand before those of earlier.
    std::vector<std::filesystem::path> layoutFolders = {};
    bool safe = false;                  // load no application by itself
    CommandLine::Sink output;           // receives everything that the host says
    OutputSurroundings outputTo = {};   // what is known about where that goes
    RemoteFiles::Limits downloads = {}; // of the files that are fetched for applications
};

class TESSEL_PROGRAM_API Host : public LineRunner
{
public:
    explicit Host(HostOptions options);
    ~Host() override; // ends a session that runs

    // Makes the parts and, unless `safe`, loads the applications that are to be loaded at start. False when
    // the host cannot run at all; a sentence then says why. A registry that cannot be opened or written is
    // told about and does not keep the host from running.
    bool start();

    // Runs one line: a command, or Lisp when it begins with a parenthesis. Afterwards what the line wrote to
    // the registry is stored, and the queued Lisp is evaluated; a store that fails makes the line fail.
    bool run(const std::wstring& input) override;

    // Shows in windows which changes were not taken or not stored so far, and why. For whoever has no command
    // line to read it on.
    void showWhatWasNotTaken();

    // Runs a file of lines as if typed. Scripts may run scripts, to a sensible depth. Fails without a
    // sentence when a line of it did: each has been told.
    Result<> runScript(const std::filesystem::path& script);

    // Unloads every application, stores the registry, and takes the parts down.
    void end();

    void lineBegins() override { mTypedLine.emplace(mInterruption); }
    bool isLineInterrupted() const override { return mTypedLine && mTypedLine->isThere(); }
    bool isEnding() const override { return mEndRequest.isMade(); }
    bool interrupt() noexcept override;
    void noteEndByKey() noexcept override;
    void requestEnd() noexcept override;
    bool runsLisp() const noexcept override;

    // Can be read from when the session is to end (see EndRequest).
    int endRequest() const { return mEndRequest.descriptor(); }

    CommandLine& commandLine() { return mCommandLine; }
    Questions& questions() { return mQuestions; }

    // What the Tab key completes; for as long as the host runs.
    CompletionSources completionSources();

private:
    Result<> makeParts();
    void tellOfRegistry();
    Result<> prepareProfileFolder();
    void judgeEarlierSessions();
    void tellOfApplicationsFolder();
    void tellWhoElseWritesTheProfile();
    bool tellWhoElseWrites(Sentence<1> kind, const std::filesystem::path& path);
    void tellOfStart();
    void explainPlaces();
    void explainLoad(const LoadOutcome& outcome);
    bool runLisp(const std::wstring& input, const Interruption::Wish& wish);
    OutputSurroundings withPagerForPersons(OutputSurroundings surroundings);
    void addShippedRecords();
    void addCommands();
    bool finishLine();
    bool tellOfStoring();

    HostOptions mOptions;
    CommandLine mCommandLine;
    std::unique_ptr<Parts> mParts;
    std::atomic<LispInterpreter*> mInterruptible = nullptr; // read by a signal handler, as the next two
    std::atomic<Registry*> mInterruptibleRegistry = nullptr;
    std::atomic<RunningMarker*> mMarker = nullptr;
    EndRequest mEndRequest;
    Interruption mInterruption{mEndRequest};
    WindowQuestions mWindowQuestions;
    Questions mQuestions{mCommandLine, mInterruption, &mWindowQuestions};
    std::optional<Interruption::Wish> mTypedLine; // that it is not run; until it is
    int mScriptDepth = 0;
};
} // namespace tessel
