#include "host/app/Host.h"

#include <algorithm>
#include <optional>
#include <utility>

#include "host/Services.h"
#include "host/app/ApplicationServices.h"
#include "host/app/BuiltIn.h"
#include "host/app/Layout.h"
#include "host/applications/ApplicationRecords.h"
#include "host/applications/DemandLoading.h"
#include "host/applications/Document.h"
#include "host/applications/DynamicLinker.h"
#include "host/commands/CallingApplication.h"
#include "host/commands/CommandStack.h"
#include "host/console/Console.h"
#include "host/files/FileSearch.h"
#include "host/files/RemoteFiles.h"
#include "host/lisp/LispInterpreter.h"
#include "host/messages/Help.h"
#include "host/messages/WindowBox.h"
#include "host/platform/AutoreleasePool.h"
#include "host/platform/ToolkitPlaces.h"
#include "host/registry/Registry.h"
#include "host/registry/SystemVariables.h"
#include "host/resources/ResourceModules.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr char kRegistryFile[] = "registry.db";
constexpr char kRemoteFilesFolder[] = "remote-files";
constexpr int kDeepestScript = 16;

std::wstring wideText(const std::filesystem::path& path)
{
    return toWide(path.string());
}
} // namespace

// Taken down in the reverse order: what comes later may use what comes before.
struct Host::Parts
{
    Layout layout = runningLayout();
    std::optional<ApplicationServices> application;
    std::optional<Registry> registry;
    std::optional<SystemVariables> variables;
    CallingApplication callingApplication;
    CommandStack commands;
    std::optional<ResourceModules> resources;
    DynamicLinker linker;
    std::optional<DemandLoading> demandLoading;
    std::optional<FileSearch> files;
    std::optional<RemoteFiles> remote;
    Document document;
    MessageBox messageBox;
    std::optional<Help> help;
    std::unique_ptr<LispInterpreter> lisp;
};

Host::Host(HostOptions options) : mOptions(std::move(options)), mCommandLine(mOptions.output)
{
}

Host::~Host()
{
    end();
}

bool Host::start()
{
    const AutoreleasePool pool;
    if (!mCommandLine.tell(makeParts()))
        return false;
    if (!mOptions.safe)
        mParts->demandLoading->loadAtStart();
    finishLine();
    return true;
}

Result<> Host::makeParts()
{
    if (services().commandLine)
        return Failure{L"Another session runs in this process already."};
    if (auto prepared = prepareProfileFolder(); !prepared)
        return prepared;
    // The applications that are loaded next may bring Objective-C along.
    static_cast<void>(keepToolkitFilesIn(mOptions.profileFolder / kToolkitFolder));
    services().commandLine = &mCommandLine;
    services().endRequest = &mEndRequest;
    mParts = std::make_unique<Parts>();
    makeStore();
    if (auto made = makeApplicationParts(); !made)
        return made;
    makeUserParts();
    addCommands();
    return {};
}

Result<> Host::prepareProfileFolder()
{
    if (mOptions.profileFolder.empty())
        return Failure{
            L"Tessel does not know where to keep its profile: HOME is not set, and no folder was given."};
    std::error_code error;
    std::filesystem::create_directories(mOptions.profileFolder, error);
    if (!error)
        mOptions.profileFolder = std::filesystem::canonical(mOptions.profileFolder, error);
    if (!error)
        return {};
    return Failure{L"The profile folder " + wideText(mOptions.profileFolder) + L" cannot be made: " +
                   toWide(error.message()) + L"."};
}

// What is stored, and what is read from it before any application can ask.
void Host::makeStore()
{
    services().application = &mParts->application.emplace(wideText(mOptions.profileFolder));
    services().registry = &mParts->registry.emplace(mOptions.profileFolder / kRegistryFile);
    mCommandLine.tell(mParts->registry->canStore());
    ensureCurrentProfile(*mParts->registry, mParts->application->productRegistryRoot());
    services().variables = &mParts->variables.emplace();
    services().removingTsLisp = mParts->variables->number(kRemovingTsLisp) != 0;
}

Result<> Host::makeApplicationParts()
{
    services().callingApplication = &mParts->callingApplication;
    services().commands = &mParts->commands;
    services().resources = &mParts->resources.emplace(wideText(mParts->layout.resources));
    services().linker = &mParts->linker;
    services().document = &mParts->document;
    services().files = &mParts->files.emplace(mParts->layout.resources);
    services().remote =
        &mParts->remote.emplace(mOptions.profileFolder / kRemoteFilesFolder, RemoteFiles::Limits());
    mParts->demandLoading.emplace(mParts->layout.plugIns);
    auto lisp = LispInterpreter::start({services().removingTsLisp});
    if (!lisp)
        return lisp.failure();
    mParts->lisp = *std::move(lisp);
    services().lisp = mParts->lisp.get();
    mInterruptible = services().lisp;
    return {};
}

void Host::makeUserParts()
{
    mParts->messageBox.setPresenter(windowBoxes(mParts->layout.binaries));
    services().messageBox = &mParts->messageBox;
    services().help = &mParts->help.emplace(mParts->layout.resources / "help", openInBrowser);
}

void Host::addCommands()
{
    CommandStack& commands = mParts->commands;
    addSessionCommands(commands, {[this] { mEndRequest.make(); },
                                  [this](const std::filesystem::path& script)
                                  {
                                      return runScript(script);
                                  }});
    addApplicationCommands(commands);
    addSettingCommands(commands);
    addRegistryCommands(commands);
    commands.setLoader([this](const std::wstring& name)
                       { return mParts->demandLoading->loadForCommand(name); });
    commands.setAfterLine([this] { return finishLine(); });
}

bool Host::run(const std::wstring& input)
{
    const AutoreleasePool pool;
    if (!isLisp(input))
        return mParts->commands.run(input);
    const auto value = mParts->lisp->evaluate(input);
    if (mCommandLine.tell(value) && !value->empty())
        mCommandLine.say(*value);
    return finishLine() && value;
}

bool Host::finishLine()
{
    // What the line wrote is stored before the queue runs: queued Lisp may take its time, or never end.
    const bool stored = mCommandLine.tell(mParts->registry->endOfCommand());
    mParts->lisp->runQueue();
    return mCommandLine.tell(mParts->registry->endOfCommand()) && stored;
}

Result<> Host::runScript(const std::filesystem::path& script)
{
    if (mScriptDepth == kDeepestScript)
        return Failure{L"The script " + wideText(script) +
                       L" is not run: it seems to be a script that runs itself."};
    ++mScriptDepth;
    auto done = Console(mCommandLine, *this).runScript(script);
    --mScriptDepth;
    return done;
}

void Host::end()
{
    if (!mParts)
        return;
    const AutoreleasePool pool;
    // A Lisp file may have left its prompt behind; what applications say at the end is not part of it.
    if (!mCommandLine.atLineStart())
        mCommandLine.print(L"\n");
    mParts->linker.unloadAll();
    mCommandLine.tell(mParts->registry->endOfCommand());
    mInterruptible = nullptr;
    mParts.reset();
    services() = {};
}

void Host::interrupt() noexcept
{
    if (LispInterpreter* lisp = mInterruptible)
        lisp->interrupt();
}

void Host::requestEnd() noexcept
{
    mEndRequest.make();
    interrupt();
}

std::vector<std::wstring> Host::commandNames() const
{
    std::vector<std::wstring> names = mParts->commands.names();
    for (const auto& record : allApplicationRecords())
        for (const auto& command : record.commands)
            names.push_back(command.second);
    mParts->registry->storeSoFar(); // the next command is to read what is stored by then
    std::ranges::sort(names);
    names.erase(std::unique(names.begin(), names.end()), names.end());
    return names;
}
} // namespace tessel
