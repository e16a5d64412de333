#include "tests/support/recording/RecordingServices.h"

#include "tests/support/RecordingHost.h"

TsRxObject* RecordingServices::at(const wchar_t* name) const
{
    RecordingHost& host = recordingHost();
    host.journal.add(L"at", {name});
    asked.emplace_back(name);
    if (const auto told = mObjects.find(name); told != mObjects.end())
        return told->second;
    if (std::wstring_view(name) == TSRX_DYNAMIC_LINKER)
        return &host.linker;
    return std::wstring_view(name) == TSED_REGISTERED_COMMANDS ? static_cast<TsRxObject*>(&host.commands)
                                                               : nullptr;
}

TsRxSysRegistry* tsrxSysRegistry()
{
    return &recordingHost().services;
}
