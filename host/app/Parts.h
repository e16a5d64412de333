// The parts of the running host, listed once: in the order in which they are made, each given those before it
// that it needs. They are taken down in the reverse order.
//
// The owned and the published ones are also what the SDK's free functions find (see `running` in
// host/text/Running.h).
#pragma once

#include <algorithm>
#include <filesystem>
#include <memory>

#include "host/app/WindowBox.h"
#include "host/applications/Admission.h"
#include "host/applications/ApplicationRecords.h"
#include "host/applications/Bisecting.h"
#include "host/applications/DemandLoading.h"
#include "host/applications/Document.h"
#include "host/applications/DynamicLinker.h"
#include "host/applications/KeptOut.h"
#include "host/applications/KeptOutService.h"
#include "host/applications/LoadOutcomes.h"
#include "host/commands/CallingApplication.h"
#include "host/commands/CommandRunner.h"
#include "host/commands/CommandStack.h"
#include "host/commands/EndRequest.h"
#include "host/commands/Interruption.h"
#include "host/commands/RunningMarker.h"
#include "host/files/FileSearch.h"
#include "host/files/HostInformation.h"
#include "host/files/RemoteFiles.h"
#include "host/lisp/LispInterpreter.h"
#include "host/messages/Browser.h"
#include "host/messages/Help.h"
#include "host/messages/MessageBox.h"
#include "host/messages/Questions.h"
#include "host/platform/ProductFolders.h"
#include "host/registry/LayeredRegistry.h"
#include "host/registry/Profiles.h"
#include "host/registry/Registry.h"
#include "host/registry/RegistryNews.h"
#include "host/registry/SystemVariables.h"
#include "host/resources/ResourceModules.h"
#include "host/text/CommandLine.h"
#include "host/text/Languages.h"
#include "host/text/Running.h"
#include "host/text/Unicode.h"
#include "host/text/Version.h"

namespace tessel
{
// In the profile: what is at work, and what is kept out; what the host and the applications store.
inline constexpr char kApplicationsFolder[] = "applications";
inline constexpr char kRegistryFile[] = "registry.db";

// What the parts are made from.
struct Foundations
{
    CommandLine& commandLine;
    Questions& questions;
    EndRequest& endRequest;
    Interruption& interruption;
    const std::filesystem::path& profileFolder; // is there
    const std::vector<std::filesystem::path>& layoutFolders;
    const RemoteFiles::Limits& downloads;
    bool safe; // load nothing by itself
    CommandRunner::AfterLine afterLine;
};

struct Parts
{
    explicit Parts(const Foundations& given) : foundations(given) {}
    Parts(const Parts&) = delete;
    Parts& operator=(const Parts&) = delete;

    const Foundations foundations;
    const ProductFolders& folders = runningProductFolders();
    Published<CommandLine> commandLine{foundations.commandLine};
    Published<Questions> questions{foundations.questions};
    Published<EndRequest> endRequest{foundations.endRequest};
    Owned<Registry> registry{foundations.profileFolder / kRegistryFile, Registry::kBusyTimeout,
                             [this](const std::wstring& sentence) { foundations.commandLine.warn(sentence); },
                             [wish = Interruption::Wish(foundations.interruption)]
                             {
                                 return wish.isThere();
                             }};
    std::vector<std::wstring> notTaken; // which changes do not count, and why
    Owned<LayeredRegistry> layered{*registry, readRegistryLayers(foundations.layoutFolders),
                                   [this](const std::wstring& sentence)
                                   {
                                       foundations.commandLine.warn(sentence);
                                       notTaken.push_back(sentence);
                                   }};
    Profiles profiles{*layered, kProductRegistryRoot};
    RegistryNews registryNews{*layered, kProductRegistryRoot};
    Owned<SystemVariables> variables{&*layered, kProductRegistryRoot};
    Owned<RunningMarker> marker{foundations.profileFolder / kApplicationsFolder};
    KeptOut keptOut{foundations.profileFolder / kApplicationsFolder};
    Bisecting bisecting{foundations.profileFolder / kApplicationsFolder, !foundations.safe};
    Admission admission{*commandLine, *marker, keptOut, bisecting, foundations.safe};
    Owned<KeptOutService> keptOutService{keptOut, admission, *commandLine};
    Owned<CallingApplication> callingApplication{*marker};
    Owned<CommandStack> commands{*callingApplication};
    Owned<ResourceModules> resources{toWide(folders.resources.string()), *callingApplication,
                                     personsLanguages()};
    Owned<MessageBox> messageBox{*commandLine, quietWhenSafe(windowBoxes(folders.binaries), admission)};
    LoadOutcomes loadOutcomes;
    Owned<DynamicLinker> linker{*commandLine, *callingApplication, *commands,
                                *messageBox,  loadOutcomes,        admission};
    Owned<ApplicationRecords> records{*layered, *commands, *callingApplication, kProductRegistryRoot};
    DemandLoading demandLoading{folders.plugIns, *records, *linker, admission,
                                [this](const std::wstring& path)
                                {
                                    const auto loaded = linker->load(path, kResolveNow);
                                    return loadOutcomes.willBeTold(loaded.code()) ? static_cast<bool>(loaded)
                                                                                  : commandLine->tell(loaded);
                                }};
    Owned<Document> document;
    Owned<FileSearch> files{folders.resources, *variables};
    Owned<RemoteFiles> remote{foundations.profileFolder / "remote-files", foundations.downloads,
                              foundations.interruption,
                              [this](const std::wstring& sentence)
                              {
                                  foundations.commandLine.warn(sentence);
                              }};
    Owned<HostInformation> information{toWide(foundations.profileFolder.string()), *remote, *commandLine};
    Owned<Help> help{folders.resources / "help", openInBrowser, personsLanguages()};
    // The variable is read here, before any application is loaded, and holds for the session.
    Owned<LispInterpreter> lisp{
        LispInterpreter::Options{.removingTsLisp = variables->number(kRemovingTsLisp) != 0,
                                 .outcomes = &loadOutcomes,
                                 .admission = &admission},
        *commandLine, *document, *endRequest};
    CommandRunner commandRunner{*commands,
                                *commandLine,
                                *callingApplication,
                                [this](const std::wstring& name)
                                {
                                    sayRecordsTakenAlong();
                                    return demandLoading.loadForCommand(name);
                                },
                                foundations.afterLine,
                                [this]
                                {
                                    return commandNames();
                                }};

    void sayRecordsTakenAlong()
    {
        for (const auto& sentence : demandLoading.takeRecordsAlong())
            commandLine->warn(sentence);
    }

    // What can be typed: the commands that are there or that the host knows how to load; sorted.
    std::vector<std::wstring> commandNames()
    {
        std::vector<std::wstring> names = commands->names();
        for (const auto& record : records->all())
            for (const auto& command : record.commands)
                names.push_back(command.second);
        registry->storeSoFar(); // the next command is to read what is stored by then
        std::ranges::sort(names);
        names.erase(std::unique(names.begin(), names.end()), names.end());
        return names;
    }
};
} // namespace tessel
