#include "host/app/Host.h"

#include <algorithm>
#include <utility>

#include "host/app/BuiltIn.h"
#include "host/app/BuiltInSupport.h"
#include "host/app/Listings.h"
#include "host/app/Parts.h"
#include "host/applications/ShippedRecords.h"
#include "host/applications/StartSummary.h"
#include "host/console/Console.h"
#include "host/console/FolderContent.h"
#include "host/platform/AutoreleasePool.h"
#include "host/platform/PrivateFolder.h"
#include "host/platform/ProductFolders.h"
#include "host/platform/SystemFailure.h"
#include "host/platform/ToolkitPlaces.h"
#include "host/text/Duration.h"
#include "host/text/Languages.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
constexpr int kDeepestScript = 16;

std::wstring durationSince(LoadOutcomes::Clock::time_point begun)
{
    return durationInWords(
        std::chrono::duration_cast<std::chrono::microseconds>(LoadOutcomes::Clock::now() - begun));
}

std::vector<std::wstring> namesOf(const std::vector<SystemVariables::Variable>& variables)
{
    std::vector<std::wstring> names;
    names.reserve(variables.size());
    for (const auto& variable : variables)
        names.push_back(variable.name);
    return names;
}

// Of the key of a path that ends with a backslash, or of the root. A read is no part of a command.
std::vector<Branch> keysBelow(LayeredRegistry& registry, std::wstring path)
{
    if (path.ends_with(L'\\'))
        path.pop_back();
    std::vector<Branch> keys;
    const auto key = registry.find(path);
    const auto names = key == Registry::kNoKey ? std::vector<std::wstring>() : registry.subKeys(key);
    keys.reserve(names.size());
    for (const std::wstring& name : names)
        keys.push_back({name, !registry.subKeys(registry.find(name, key)).empty()});
    registry.own().storeSoFar();
    return keys;
}
} // namespace

Host::Host(HostOptions options)
    : mOptions(std::move(options)), mCommandLine(mOptions.output, withPagerForPersons(mOptions.outputTo)),
      mWindowQuestions(runningProductFolders().binaries)
{
}

// A script, and whoever reads what it says, turns no pages.
OutputSurroundings Host::withPagerForPersons(OutputSurroundings surroundings)
{
    if (surroundings.pager)
        surroundings.pager = [this, show = std::move(surroundings.pager)](const std::string& list)
        {
            return mQuestions.asksPerson() && show(list);
        };
    return surroundings;
}

Host::~Host()
{
    end();
}

bool Host::start()
{
    const AutoreleasePool pool;
    const Interruption::Work work(mInterruption);
    const auto begun = LoadOutcomes::Clock::now();
    if (!mCommandLine.tell(makeParts()))
        return false;
    explainPlaces();
    judgeEarlierSessions();
    const RunningMarker::ReasonScope atStart(*mParts->marker, RunningMarker::Reason::kAtStart);
    mParts->messageBox->collect();
    mParts->loadOutcomes.expectSummary(true);
    if (!mOptions.safe)
    {
        mParts->sayRecordsTakenAlong();
        mParts->demandLoading.loadAtStart(mParts->registryNews.isThere());
        mParts->registryNews.noteRead();
    }
    finishLine();
    tellOfStart();
    mCommandLine.explain([&] { return translated(L"The start took {}.", durationSince(begun)); });
    return true;
}

void Host::explainPlaces()
{
    mCommandLine.explain([this]
                         { return translated(L"The profile is kept in {}.", mOptions.profileFolder); });
    for (const auto& folder : mOptions.layoutFolders)
        mCommandLine.explain([&]
                             { return translated(L"Values for everybody are looked for in {}.", folder); });
    mCommandLine.explain(
        [this] { return translated(L"Applications are looked for in {}.", mParts->folders.plugIns); });
}

void Host::explainLoad(const LoadOutcome& outcome)
{
    mCommandLine.explain(
        [&]
        {
            const std::wstring time = durationInWords(outcome.took);
            return outcome.loaded ? translated(L"{} was loaded in {}.", outcome.path, time)
                                  : translated(L"{} was not loaded, which took {}.", outcome.path, time);
        });
}

void Host::judgeEarlierSessions()
{
    // A search compares starts: nothing else is to change from one to the next.
    const bool givesTrials = !mOptions.safe && !mParts->bisecting.isGoingOn();
    const auto begun = mParts->keptOut.begin(mParts->marker->leftovers(), givesTrials);
    if (!mayBeEntered(mOptions.profileFolder / kApplicationsFolder))
        return; // that has been told
    for (const auto& sentence : begun.sentences)
        mCommandLine.warn(sentence);
    if (mCommandLine.tell(begun.stored))
        mParts->marker->forgetLeftovers();
    for (const auto& line : mParts->bisecting.sentencesAtStart([this](const std::string& suspect)
                                                               { return mParts->admission.whyOut(suspect); }))
        mCommandLine.warn(line);
}

// One sentence, although everything that stands in the folder is out of reach.
void Host::tellOfApplicationsFolder()
{
    const auto folder = mOptions.profileFolder / kApplicationsFolder;
    if (mayBeEntered(folder))
        mCommandLine.tell(mParts->marker->outlivesProcess());
    else
        mCommandLine.warn(
            translated(L"The folder {1} cannot be entered: what ends Tessel cannot be remembered, and "
                       L"nothing is kept out in this session. This puts it right: chmod 700 {1}",
                       folder));
}

void Host::tellOfStart()
{
    const auto boxes = mParts->messageBox->takeCollected();
    noteRefusedFiles(boxes, mParts->loadOutcomes);
    mParts->loadOutcomes.expectSummary(false);
    if (const auto summary = summarize(mParts->loadOutcomes.failed(), boxes))
        mParts->messageBox->show(summary->box, summary->lines, !summary->fits);
}

Result<> Host::makeParts()
{
    if (running<CommandLine>())
        return Failure{translated(L"Another session runs in this process already.")};
    if (auto prepared = prepareProfileFolder(); !prepared)
        return prepared;
    tellWhoElseWritesTheProfile();
    // The applications that are loaded next may bring Objective-C along.
    static_cast<void>(keepToolkitFilesIn(mOptions.profileFolder / kToolkitFolder));
    mParts = std::make_unique<Parts>(Foundations{mCommandLine, mQuestions, mEndRequest, mInterruption,
                                                 mOptions.profileFolder, mOptions.layoutFolders,
                                                 mOptions.downloads, mOptions.safe,
                                                 [this]
                                                 {
                                                     return finishLine();
                                                 }});
    mParts->loadOutcomes.tellBy([this](const LoadOutcome& outcome) { explainLoad(outcome); });
    tellOfRegistry();
    tellOfApplicationsFolder();
    mInterruptible = &*mParts->lisp;
    mInterruptibleRegistry = &*mParts->registry;
    mMarker = &*mParts->marker;
    addCommands();
    addShippedRecords();
    return {};
}

// The other parts have read it by now, and what they did not find is mostly why nothing can be stored.
void Host::tellOfRegistry()
{
    Registry& registry = *mParts->registry;
    if (!mCommandLine.tell(registry.canStore()))
        if (const auto read = registry.endOfCommand(); read.sentence() != registry.canStore().sentence())
            mCommandLine.tell(read);
    if (registry.notice())
        mCommandLine.warn(*registry.notice());
    for (const auto& sentence : mParts->layered->sentences())
        mCommandLine.warn(sentence);
}

Result<> Host::prepareProfileFolder()
{
    if (mOptions.profileFolder.empty())
        return Failure{translated(
            L"Tessel does not know where to keep its profile: HOME is not set, and no folder was given.")};
    const auto failed = [this](const std::wstring& reason)
    {
        return Failure{
            translated(L"The profile folder {} cannot be made: {}.", mOptions.profileFolder, reason)};
    };
    if (const auto made = makePrivateFolder(mOptions.profileFolder); !made)
        return failed(made.sentence());
    std::error_code error;
    mOptions.profileFolder = std::filesystem::canonical(mOptions.profileFolder, error);
    return error ? failed(systemFailure(error.value()).sentence) : Result<>();
}

// What stands in the profile decides which programs run. Nobody else reaches what is in a folder of the
// person's alone.
void Host::tellWhoElseWritesTheProfile()
{
    const auto& profile = mOptions.profileFolder;
    const auto applications = profile / kApplicationsFolder;
    if (!tellWhoElseWrites(Sentence<1>(L"The profile folder {}"), profile) || !othersMayEnter(profile))
        return;
    tellWhoElseWrites(Sentence<1>(L"The registry {}"), profile / kRegistryFile);
    if (tellWhoElseWrites(Sentence<1>(L"The folder {}"), applications))
        tellWhoElseWrites(Sentence<1>(L"The file {}"), applications / KeptOut::kFileName);
}

// True when there was nothing to tell. What is not there yet will be the person's own.
bool Host::tellWhoElseWrites(Sentence<1> kind, const std::filesystem::path& path)
{
    std::error_code unreachable;
    const auto checked = checkNobodyElseWrites(path);
    if (checked || !std::filesystem::exists(path, unreachable))
        return true;
    const bool isFolder = std::filesystem::is_directory(path, unreachable);
    const std::wstring what = translated(kind, path);
    mCommandLine.warn(
        checked.code() == kBelongsToAnother
            ? translated(L"{} is not safe: it belongs to another user, who could change what Tessel loads.",
                         what)
            : translated(L"{} is not safe: other users may write to it and so decide what Tessel loads. This "
                         L"puts it right: chmod {} {}",
                         what, isFolder ? L"700" : L"600", path));
    return false;
}

// What waits for its commands is listed with them from the beginning.
void Host::addShippedRecords()
{
    for (const auto& shipped :
         readShippedRecords(mParts->folders.plugIns, kProductRegistryRoot, personsLanguages()))
    {
        mParts->records->add(shipped.record);
        for (const auto& command : shipped.commands)
            mParts->commands->announce(command);
    }
}

void Host::addCommands()
{
    addSessionCommands(*mParts, {[this] { mEndRequest.make(); },
                                 [this](const std::filesystem::path& script)
                                 {
                                     return runScript(script);
                                 }});
    addApplicationCommands(*mParts);
    addKeptOutCommands(*mParts);
    addSettingCommands(*mParts);
    addRegistryCommands(*mParts);
    addListings(*mParts);
}

void Host::showWhatWasNotTaken()
{
    const auto show = [this](const std::wstring& sentence)
    {
        static_cast<void>(mParts->messageBox->show(sentence.c_str(), MB_OK | MB_ICONEXCLAMATION, nullptr));
    };
    for (const std::wstring& sentence : mParts->notTaken)
        show(sentence);
    // A module's own box, if it shows one, does not know why.
    if (const auto& canStore = mParts->registry->canStore(); !canStore)
        show(canStore.sentence());
}

bool Host::run(const std::wstring& input)
{
    const AutoreleasePool pool;
    const Interruption::Work work(mInterruption);
    const Interruption::Wish wish =
        std::exchange(mTypedLine, std::nullopt).value_or(Interruption::Wish(mInterruption));
    const auto begun = LoadOutcomes::Clock::now();
    const bool done = isLisp(input) ? runLisp(input, wish) : mParts->commandRunner.run(input);
    mCommandLine.explain([&] { return translated(L"That took {}.", durationSince(begun)); });
    return done;
}

bool Host::runLisp(const std::wstring& input, const Interruption::Wish& wish)
{
    const auto value = mParts->lisp->evaluate(input, &wish);
    if (mCommandLine.tell(value) && !value->empty())
        mCommandLine.say(*value);
    return finishLine() && value;
}

bool Host::finishLine()
{
    // What the line wrote is stored before the queue runs: queued Lisp may take its time, or never end.
    const bool stored = tellOfStoring();
    mParts->lisp->runQueue();
    return tellOfStoring() && stored;
}

bool Host::tellOfStoring()
{
    const auto stored = mParts->layered->endOfCommand();
    if (!stored && mParts->registry->canStore()) // otherwise it is known from the start on
        mParts->notTaken.push_back(stored.sentence());
    return mCommandLine.tell(stored);
}

Result<> Host::runScript(const std::filesystem::path& script)
{
    if (mScriptDepth == kDeepestScript)
        return Failure{
            translated(L"The script {} is not run: it seems to be a script that runs itself.", script)};
    ++mScriptDepth;
    auto done = Console(mCommandLine, mQuestions, *this).runScript(script);
    --mScriptDepth;
    return done;
}

void Host::end()
{
    if (!mParts)
        return;
    const AutoreleasePool pool;
    const Interruption::Work work(mInterruption);
    // A Lisp file may have left its prompt standing; what applications say at the end is not part of it.
    if (!mCommandLine.atLineStart())
        mCommandLine.print(L"\n");
    mParts->linker->unloadAll();
    mParts->keptOut.noteGoodEnd();
    mCommandLine.tell(mParts->layered->endOfCommand());
    mCommandLine.tell(mParts->registry->keepCopy());
    mInterruptible = nullptr;
    mInterruptibleRegistry = nullptr;
    mMarker = nullptr;
    mParts.reset();
}

bool Host::interrupt() noexcept
{
    LispInterpreter* lisp = mInterruptible;
    // First: what begins meanwhile finds the wish, or is found at work.
    const bool inVain = mInterruption.press(lisp ? lisp->evaluations() : 0);
    if (lisp)
        lisp->interrupt();
    if (Registry* registry = mInterruptibleRegistry)
        registry->interrupt();
    return inVain;
}

void Host::noteEndByKey() noexcept
{
    if (RunningMarker* marker = mMarker)
        marker->noteEnding(RunningMarker::kEndedByKey);
}

// The registry goes on: what an end in good order stores may be much.
void Host::requestEnd() noexcept
{
    mEndRequest.make();
    if (LispInterpreter* lisp = mInterruptible)
        lisp->interruptUntilItEnds();
}

bool Host::runsLisp() const noexcept
{
    const LispInterpreter* lisp = mInterruptible;
    return lisp && lisp->running();
}

CompletionSources Host::completionSources()
{
    CompletionSources sources;
    sources.commands = [this]
    {
        return mParts->commandNames();
    };
    sources.usage = [this](const std::wstring& command)
    {
        const auto known = mParts->commands->description(command);
        return known ? known->usage : std::wstring();
    };
    sources.variables = [this]
    {
        return namesOf(mParts->variables->all());
    };
    sources.files = contentOfFolder;
    sources.entries = [this](const CompletionSources::Names& parts)
    {
        const AutoreleasePool pool;
        const Interruption::Work work(mInterruption);
        auto entries = mParts->commandRunner.entries(parts);
        mParts->registry->storeSoFar(); // a look is no part of a command
        return entries;
    };
    sources.keys = [this](const std::wstring& key)
    {
        return keysBelow(*mParts->layered, key);
    };
    sources.lispSymbols = [this](const std::wstring& beginning)
    {
        const AutoreleasePool pool;
        const Interruption::Work work(mInterruption);
        return mParts->lisp->symbolsBeginning(beginning);
    };
    return sources;
}
} // namespace tessel
