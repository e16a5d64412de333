#include "tests/support/recording/RecordingLoadedModules.h"

#include <tessel/tsed.h>

#include "host/text/Unicode.h"
#include "tests/support/RecordingHost.h"

namespace
{
std::wstring fileName(const std::wstring& path)
{
    return path.substr(path.find_last_of(L"/\\") + 1);
}
} // namespace

void RecordingLoadedModules::add(const std::wstring& path)
{
    add(fileName(path), path);
}

void RecordingLoadedModules::add(const std::wstring& name, const std::wstring& path)
{
    mEntries.push_back({RecordingValue::String(name), path});
}

void RecordingLoadedModules::addOther(const RecordingValue& value)
{
    mEntries.push_back({value, {}});
}

void RecordingLoadedModules::remove(const std::wstring& path)
{
    std::erase_if(mEntries, [&path](const Entry& entry) { return entry.path == path; });
}

TsResultBuffer* RecordingLoadedModules::list() const
{
    if (reportsNothing)
        return nullptr;
    std::vector<RecordingValue> values;
    for (const Entry& entry : mEntries)
        values.push_back(entry.value);
    return resultBuffer(values);
}

const std::wstring* RecordingLoadedModules::pathOf(const std::wstring& name) const
{
    if (namesWithoutPath.contains(name))
        return nullptr;
    for (const Entry& entry : mEntries)
        if (entry.value.type == TS_STRING && tessel::equalIgnoringCase(entry.value.text, name))
            return &entry.path;
    return nullptr;
}

TsResultBuffer* tsedQmbLoaded()
{
    recordingHost().journal.add(L"tsedQmbLoaded");
    return recordingHost().loadedModules.list();
}

int tsedGetModuleFileName(const wchar_t* moduleName, wchar_t* path, std::size_t capacity)
{
    recordingHost().journal.add(L"tsedGetModuleFileName", {moduleName});
    const std::wstring* found = recordingHost().loadedModules.pathOf(moduleName);
    return found && copyText(*found, path, capacity) ? 0 : recordingHost().loadedModules.failure;
}

const wchar_t* tsedGetAppName()
{
    recordingHost().journal.add(L"tsedGetAppName");
    return recordingHost().loadedModules.applicationName.c_str();
}
