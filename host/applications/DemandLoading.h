// Loads applications that nobody has asked for by name: at the host's start, and when one of their commands
// is typed. The host's records say which; what lies in the host's PlugIns folder and has no record yet is
// loaded at every start, because only then can it tell how it wants to be loaded.
#pragma once

#include <filesystem>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace tessel
{
class Admission;
class ApplicationRecords;
class DynamicLinker;
struct ApplicationRecord;

class DemandLoading
{
public:
    // Loads the application at the path, if it can be loaded, and tells why not if it cannot. True when it
    // is loaded.
    using Loader = std::function<bool(const std::wstring& path)>;

    DemandLoading(std::filesystem::path plugInsFolder, ApplicationRecords& records,
                  const DynamicLinker& linker, const Admission& admission, Loader load);

    // To be called before the next two. A record whose file is gone becomes that of a plug-in of the same
    // name which has none: the host was moved as a whole. Answers what the person is to be told.
    std::vector<std::wstring> takeRecordsAlong() const;

    // Loads what is due at the start: by the records, in their order, then from the PlugIns folder, by name.
    // What cannot be loaded does not keep the start from going on.
    //
    // Of a record whose file is gone it is told once, and not at every start.
    //
    // With news in the registry, what stands in the PlugIns folder is loaded even if its record has it wait
    // for a command: what it found there made it content with that, and it may find something else now.
    void loadAtStart(bool withNews) const;

    // Loads the application that has such a command, by its local or its global name, in any case of letters,
    // and that wants to be loaded for it. A "_" in front means the global name alone. False when nothing was
    // loaded: nobody has such a command, its application is loaded already, or it cannot be loaded, which the
    // loader has then told.
    //
    // What stands in the PlugIns folder, is called like the command and was kept out at the start is loaded
    // for it as well: the dialog that could mend things must be there, whatever the records say.
    bool loadForCommand(std::wstring_view name) const;

private:
    std::vector<std::filesystem::path> plugIns() const;
    std::vector<std::filesystem::path> unrecordedPlugIns() const;
    bool loadNamesake(std::wstring_view command) const;
    bool isDueAtStart(const ApplicationRecord& record, bool withNews) const;
    bool standsInAnotherHost(const std::wstring& module) const;
    std::wstring takeAlong(ApplicationRecord record, const std::wstring& plugIn) const;
    bool isWorthTrying(ApplicationRecord record) const;

    bool isDue(const ApplicationRecord& record, std::wstring_view command) const;

    std::filesystem::path mPlugInsFolder;
    ApplicationRecords& mRecords;
    const DynamicLinker& mLinker;
    const Admission& mAdmission;
    Loader mLoad;
};
} // namespace tessel
