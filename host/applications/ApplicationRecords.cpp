#include "host/applications/ApplicationRecords.h"

#include <tessel/tsappinfo.h>

#include <algorithm>
#include <charconv>

#include "host/commands/CallingApplication.h"
#include "host/commands/CommandStack.h"
#include "host/registry/LayeredRegistry.h"
#include "host/text/Running.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr const wchar_t* kModule = L"Module";
constexpr const wchar_t* kDescription = L"Description";
constexpr const wchar_t* kLoadReasons = L"LoadReasons";
constexpr const wchar_t* kToldGone = L"ToldGone";

// A name with a separator would file the record below another one, where nobody looks for it.
bool isRecordName(const std::wstring& name)
{
    return !name.empty() && name.find(L'\\') == std::wstring::npos;
}
} // namespace

std::optional<unsigned> parseLoadReasons(const std::wstring& text)
{
    const std::string digits = toUtf8(text);
    unsigned reasons = 0;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), reasons);
    return error == std::errc() && end == digits.data() + digits.size() ? std::optional(reasons)
                                                                        : std::nullopt;
}

ApplicationRecords::ApplicationRecords(LayeredRegistry& registry, const CommandStack& commands,
                                       const CallingApplication& calls, const std::wstring& productRoot)
    : mRegistry(registry), mCommands(commands), mCalls(calls), mKey(productRoot + L"\\Applications")
{
}

std::wstring ApplicationRecords::keyOf(const std::wstring& name) const
{
    return mKey + L"\\" + name;
}

std::wstring ApplicationRecords::commandsKeyOf(const std::wstring& name) const
{
    return keyOf(name) + L"\\Commands";
}

std::vector<ApplicationRecord> ApplicationRecords::all() const
{
    std::vector<ApplicationRecord> records;
    const Registry::Key key = mRegistry.find(mKey);
    if (key != Registry::kNoKey)
        for (const std::wstring& name : mRegistry.subKeys(key))
            if (auto record = read(name))
            {
                readCommands(*record);
                records.push_back(*std::move(record));
            }
    for (const ApplicationRecord& added : mAdded)
        if (std::ranges::none_of(records, [&](const auto& stored)
                                 { return equalIgnoringCase(stored.name, added.name); }))
            records.push_back(added);
    return records;
}

void ApplicationRecords::add(const ApplicationRecord& record)
{
    mAdded.push_back(record);
}

// A record without a module or readable load reasons is none: somebody else's key, or half of one.
std::optional<ApplicationRecord> ApplicationRecords::read(const std::wstring& name) const
{
    const std::wstring key = keyOf(name);
    const auto module = mRegistry.read(key, kModule);
    const auto reasons = parseLoadReasons(mRegistry.read(key, kLoadReasons).value_or(L""));
    if (!module || !reasons)
        return std::nullopt;
    ApplicationRecord record;
    record.name = name;
    record.module = *module;
    record.description = mRegistry.read(key, kDescription).value_or(L"");
    record.loadReasons = *reasons;
    record.toldGone = mRegistry.read(key, kToldGone).value_or(L"");
    return record;
}

void ApplicationRecords::readCommands(ApplicationRecord& record) const
{
    const Registry::Key key = mRegistry.find(commandsKeyOf(record.name));
    if (key == Registry::kNoKey)
        return;
    for (const LayeredRegistry::Value& value : mRegistry.values(key))
        record.commands.emplace_back(value.name, value.data);
}

Result<> ApplicationRecords::write(const ApplicationRecord& record)
{
    const std::wstring key = keyOf(record.name);
    Result<> written = mRegistry.write(key, kModule, record.module);
    if (written)
        written = mRegistry.write(key, kDescription, record.description);
    if (written)
        written = mRegistry.write(key, kLoadReasons, std::to_wstring(record.loadReasons));
    return written;
}

Result<> ApplicationRecords::writeToldGone(const ApplicationRecord& record)
{
    return mRegistry.write(keyOf(record.name), kToldGone, record.toldGone);
}

Result<> ApplicationRecords::writeCommandsOfCaller(const std::wstring& name)
{
    const std::wstring key = commandsKeyOf(name);
    if (const Registry::Key old = mRegistry.find(key); old != Registry::kNoKey)
        if (auto removed = mRegistry.removeKey(old); !removed)
            return removed;
    for (const auto& [global, local] : mCommands.commandsOf(mCalls.path()))
        if (auto written = mRegistry.write(key, global, local); !written)
            return written;
    return {};
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
    const auto* records = tessel::running<tessel::ApplicationRecords>();
    if (!records || !tessel::isRecordName(mRecord->name))
        return TSRX_APPINFO_ERROR;
    const auto found = records->read(mRecord->name);
    if (!found)
        return TSRX_APPINFO_NOT_FOUND;
    static_cast<tessel::ApplicationRecord&>(*mRecord) = *found;
    return TSRX_APPINFO_OK;
}

int TesselAppInfo::writeToRegistry(bool, bool withCommands)
{
    // This host has one user's registry only: a record for all users is stored there too.
    auto* records = tessel::running<tessel::ApplicationRecords>();
    if (!records || !tessel::isRecordName(mRecord->name) || !records->write(*mRecord))
        return TSRX_APPINFO_ERROR;
    if (withCommands && !records->writeCommandsOfCaller(mRecord->name))
        return TSRX_APPINFO_ERROR;
    return TSRX_APPINFO_OK;
}
