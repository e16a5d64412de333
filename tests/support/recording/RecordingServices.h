// The system registry of named services: the dynamic linker and the command stack, unless told otherwise.
#pragma once

#include <map>
#include <string>
#include <vector>

#include <tessel/tsrx.h>

class RecordingServices : public TsRxSysRegistry
{
public:
    // The service is missing, or is another object (null: missing). Objects stay the caller's.
    void miss(const std::wstring& name) { set(name, nullptr); }
    void set(const std::wstring& name, TsRxObject* object) { mObjects[name] = object; }

    // The names asked for, in order.
    mutable std::vector<std::wstring> asked;

    TsRxObject* at(const wchar_t* name) const override;

private:
    std::map<std::wstring, TsRxObject*> mObjects;
};
