#include "host/applications/ApplicationRecords.h"

#include <tessel/tsappinfo.h>
#include <tessel/tsed.h>
#include <tessel/tshostservices.h>

#include <charconv>
#include <optional>

#include "host/Services.h"
#include "host/commands/CommandStack.h"
#include "host/registry/Registry.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr const wchar_t* kModule = L"Module";
constexpr const wchar_t* kDescription = L"Description";
constexpr const wchar_t* kLoadReasons = L"LoadReasons";
constexpr const wchar_t* kCommands = L"\\Commands";

std::wstring recordsKey()
{
    const TsDbHostApplicationServices* application = tsdbHostApplicationServices();
    return (application ? application->productRegistryRoot() : L"") + std::wstring(L"\\Applications");
}

std::wstring keyOf(const std::wstring& name)
{
    return recordsKey() + L"\\" + name;
}

// A name with a separator would file the record below another one, where nobody looks for it.
bool isRecordName(const std::wstring& name)
{
    return !name.empty() && name.find(L'\\') == std::wstring::npos;
}

std::optional<unsigned> parseReasons(const std::wstring& text)
{
    const std::string digits = toUtf8(text);
    unsigned reasons = 0;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), reasons);
    return error == std::errc() && end == digits.data() + digits.size() ? std::optional(reasons)
                                                                        : std::nullopt;
}

// A record without a module or readable load reasons is none: somebody else's key, or half of one.
std::optional<ApplicationRecord> readRecord(Registry& registry, const std::wstring& name)
{
    const std::wstring key = keyOf(name);
    const auto module = registry.read(key, kModule);
    const auto reasons = parseReasons(registry.read(key, kLoadReasons).value_or(L""));
    if (!module || !reasons)
        return std::nullopt;
    ApplicationRecord record;
    record.name = name;
    record.module = *module;
    record.description = registry.read(key, kDescription).value_or(L"");
    record.loadReasons = *reasons;
    return record;
}

void readCommands(Registry& registry, ApplicationRecord& record)
{
    const Registry::Key key = registry.find(keyOf(record.name) + kCommands);
    if (key == Registry::kNoKey)
        return;
    for (const Registry::Value& value : registry.values(key))
        record.commands.emplace_back(value.name, value.data);
}

Result<> writeRecord(Registry& registry, const ApplicationRecord& record)
{
    const std::wstring key = keyOf(record.name);
    Result<> written = registry.write(key, kModule, record.module);
    if (written)
        written = registry.write(key, kDescription, record.description);
    if (written)
        written = registry.write(key, kLoadReasons, std::to_wstring(record.loadReasons));
    return written;
}

// The commands replace those of an earlier version of the application.
Result<> writeCommandsOfCaller(Registry& registry, const std::wstring& name)
{
    const std::wstring key = keyOf(name) + kCommands;
    if (const Registry::Key old = registry.find(key); old != Registry::kNoKey)
        if (auto removed = registry.removeKey(old); !removed)
            return removed;
    if (!services().commands)
        return {};
    for (const auto& [global, local] : services().commands->commandsOf(tsedGetAppName()))
        if (auto written = registry.write(key, global, local); !written)
            return written;
    return {};
}
} // namespace

std::vector<ApplicationRecord> allApplicationRecords()
{
    std::vector<ApplicationRecord> records;
    Registry* registry = services().registry;
    const Registry::Key key = registry ? registry->find(recordsKey()) : Registry::kNoKey;
    if (key == Registry::kNoKey)
        return records;
    for (const std::wstring& name : registry->subKeys(key))
    {
        auto record = readRecord(*registry, name);
        if (!record)
            continue;
        readCommands(*registry, *record);
        records.push_back(*std::move(record));
    }
    return records;
}
} // namespace tessel

struct TesselAppInfo::Record : tessel::ApplicationRecord
{
};

TesselAppInfo::TesselAppInfo() : mRecord(std::make_unique<Record>())
{
}
TesselAppInfo::~TesselAppInfo() = default;

void TesselAppInfo::setAppName(const wchar_t* name)
{
    mRecord->name = name ? name : L"";
}

void TesselAppInfo::setModuleName(const wchar_t* path)
{
    mRecord->module = path ? path : L"";
}

void TesselAppInfo::setDescription(const wchar_t* description)
{
    mRecord->description = description ? description : L"";
}

void TesselAppInfo::setLoadReason(unsigned reasons)
{
    mRecord->loadReasons = reasons;
}

const wchar_t* TesselAppInfo::appName() const
{
    return mRecord->name.c_str();
}

const wchar_t* TesselAppInfo::moduleName() const
{
    return mRecord->module.c_str();
}

const wchar_t* TesselAppInfo::description() const
{
    return mRecord->description.c_str();
}

unsigned TesselAppInfo::loadReason() const
{
    return mRecord->loadReasons;
}

int TesselAppInfo::readFromRegistry()
{
    tessel::Registry* registry = tessel::services().registry;
    if (!registry || !tessel::isRecordName(mRecord->name))
        return TSRX_APPINFO_ERROR;
    const auto found = tessel::readRecord(*registry, mRecord->name);
    if (!found)
        return TSRX_APPINFO_NOT_FOUND;
    static_cast<tessel::ApplicationRecord&>(*mRecord) = *found;
    return TSRX_APPINFO_OK;
}

int TesselAppInfo::writeToRegistry(bool, bool withCommands)
{
    // This host has one user's registry only: a record for all users is stored there too.
    tessel::Registry* registry = tessel::services().registry;
    if (!registry || !tessel::isRecordName(mRecord->name) || !tessel::writeRecord(*registry, *mRecord))
        return TSRX_APPINFO_ERROR;
    if (withCommands && !tessel::writeCommandsOfCaller(*registry, mRecord->name))
        return TSRX_APPINFO_ERROR;
    return TSRX_APPINFO_OK;
}
