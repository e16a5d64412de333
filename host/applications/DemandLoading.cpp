#include "host/applications/DemandLoading.h"

#include <algorithm>
#include <set>
#include <utility>

#include <tessel/tsappinfo.h>

#include "host/applications/Admission.h"
#include "host/applications/ApplicationFiles.h"
#include "host/applications/ApplicationRecords.h"
#include "host/applications/DynamicLinker.h"
#include "host/commands/CommandStack.h"
#include "host/platform/RealPath.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
// Not there, and not merely out of reach.
bool isGone(const std::wstring& module)
{
    std::error_code unreachable;
    return !std::filesystem::exists(toUtf8(module), unreachable) && !unreachable;
}

bool lists(const ApplicationRecord& record, std::wstring_view typedName)
{
    const bool isGlobal = typedName.starts_with(kGlobalNameMark);
    const std::wstring_view globalName = isGlobal ? typedName.substr(1) : typedName;
    return std::ranges::any_of(record.commands,
                               [&](const auto& command) {
                                   return equalIgnoringCase(command.first, globalName) ||
                                          equalIgnoringCase(command.second, typedName);
                               });
}
} // namespace

DemandLoading::DemandLoading(std::filesystem::path plugInsFolder, ApplicationRecords& records,
                             const DynamicLinker& linker, const Admission& admission, Loader load)
    : mPlugInsFolder(std::move(plugInsFolder)), mRecords(records), mLinker(linker), mAdmission(admission),
      mLoad(std::move(load))
{
}

void DemandLoading::loadAtStart(bool withNews) const
{
    // Asked before anything is loaded: what is loaded may write a record of its own.
    const auto plugIns = unrecordedPlugIns();
    for (const auto& record : mRecords.all())
        if (isDueAtStart(record, withNews) && isWorthTrying(record))
            mLoad(record.module);
    for (const auto& plugIn : plugIns)
        mLoad(toWide(plugIn.native()));
}

bool DemandLoading::isDueAtStart(const ApplicationRecord& record, bool withNews) const
{
    if ((record.loadReasons & TSRX_LOAD_AT_HOST_START) != 0)
        return true;
    // A record that comes with Tessel is nothing that the application has decided.
    return withNews && (record.loadReasons & TSRX_LOAD_ON_COMMAND) != 0 && mRecords.read(record.name) &&
           realPath(std::filesystem::path(toUtf8(record.module)).parent_path()) == realPath(mPlugInsFolder);
}

bool DemandLoading::standsInAnotherHost(const std::wstring& module) const
{
    const auto folder = std::filesystem::path(toUtf8(module)).parent_path();
    return folder.filename() == mPlugInsFolder.filename() && realPath(folder) != realPath(mPlugInsFolder);
}

std::vector<std::wstring> DemandLoading::takeRecordsAlong() const
{
    auto left = mRecords.all();
    std::erase_if(left, [this](const ApplicationRecord& record)
                  { return !isGone(record.module) && !standsInAnotherHost(record.module); });
    std::vector<std::wstring> sentences;
    if (left.empty()) // as at most starts: nobody needs to look through the folder
        return sentences;
    const auto plugIns = unrecordedPlugIns();
    for (const ApplicationRecord& record : left)
    {
        const auto name = std::filesystem::path(toUtf8(record.module)).filename();
        const auto namesake = std::ranges::find(plugIns, name, &std::filesystem::path::filename);
        if (namesake != plugIns.end())
            sentences.push_back(takeAlong(record, toWide(namesake->native())));
    }
    std::erase(sentences, std::wstring());
    return sentences;
}

// What is to be told; nothing when all is as before.
std::wstring DemandLoading::takeAlong(ApplicationRecord record, const std::wstring& plugIn) const
{
    const bool gone = isGone(record.module);
    const std::wstring before = std::exchange(record.module, plugIn);
    if (const auto written = mRecords.write(record); !written)
        return written.sentence();
    return gone ? translated(L"The application \"{}\" is {} now; {} is not there any more.", record.name,
                             plugIn, before)
                : std::wstring();
}

// What cannot be stored costs no more than being told once more.
bool DemandLoading::isWorthTrying(ApplicationRecord record) const
{
    const std::wstring gone = isGone(record.module) ? record.module : L"";
    const std::wstring told = std::exchange(record.toldGone, gone);
    if (gone != told)
        static_cast<void>(mRecords.writeToldGone(record));
    return gone.empty() || gone != told;
}

bool DemandLoading::loadNamesake(std::wstring_view command) const
{
    if (command.starts_with(kGlobalNameMark))
        command.remove_prefix(1);
    return std::ranges::any_of(plugIns(),
                               [&](const std::filesystem::path& plugIn)
                               {
                                   const std::wstring path = toWide(plugIn.native());
                                   return equalIgnoringCase(toWide(plugIn.stem().native()), command) &&
                                          mAdmission.keptOutAtStart(path) &&
                                          !mLinker.isModuleLoaded(path.c_str()) && mLoad(path);
                               });
}

std::vector<std::filesystem::path> DemandLoading::unrecordedPlugIns() const
{
    std::set<std::filesystem::path> recorded;
    for (const auto& record : mRecords.all())
        recorded.insert(realPath(toUtf8(record.module)));
    auto result = plugIns();
    std::erase_if(result, [&](const auto& plugIn) { return recorded.contains(realPath(plugIn)); });
    return result;
}

// By name.
std::vector<std::filesystem::path> DemandLoading::plugIns() const
{
    std::vector<std::filesystem::path> result;
    std::error_code failed; // without a PlugIns folder there are no plug-ins
    for (std::filesystem::directory_iterator entry(mPlugInsFolder, failed), end; !failed && entry != end;
         entry.increment(failed))
        if (isCalledAsModule(entry->path()))
            result.push_back(entry->path());
    std::ranges::sort(result);
    return result;
}

bool DemandLoading::isDue(const ApplicationRecord& record, std::wstring_view command) const
{
    return (record.loadReasons & TSRX_LOAD_ON_COMMAND) != 0 && lists(record, command) &&
           !mLinker.isModuleLoaded(record.module.c_str());
}

bool DemandLoading::loadForCommand(std::wstring_view name) const
{
    const RunningMarker::ReasonScope onCommand(mAdmission.marker(), RunningMarker::Reason::kOnCommand);
    const auto records = mRecords.all();
    return std::ranges::any_of(records, [&](const ApplicationRecord& record)
                               { return isDue(record, name) && mLoad(record.module); }) ||
           loadNamesake(name);
}
} // namespace tessel
