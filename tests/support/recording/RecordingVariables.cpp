#include "tests/support/recording/RecordingVariables.h"

#include <tessel/tsed.h>

#include "host/text/Unicode.h"
#include "tests/support/RecordingHost.h"

void RecordingVariables::set(const std::wstring& name, const RecordingValue& value)
{
    mValues[tessel::foldCase(name)] = value;
}

void RecordingVariables::remove(const std::wstring& name)
{
    mValues.erase(tessel::foldCase(name));
}

const RecordingValue* RecordingVariables::find(const std::wstring& name) const
{
    const auto found = mValues.find(tessel::foldCase(name));
    return found == mValues.end() ? nullptr : &found->second;
}

int tsedGetVar(const wchar_t* name, TsResultBuffer* result)
{
    RecordingHost& host = recordingHost();
    host.journal.add(L"tsedGetVar", {name});
    host.variables.asked.emplace_back(name);
    const RecordingValue* value = host.variables.find(name);
    if (!value)
        return TS_ERROR;
    // The caller owns the string of its own buffer; the list around it goes.
    TsResultBuffer* made = resultBuffer({*value});
    *result = *made;
    made->type = TS_NIL;
    tsutRelRb(made);
    return TS_NORMAL;
}
