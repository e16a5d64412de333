// The applications that a host keeps out; a test sets it into the services of the recording host, which has
// none.
#pragma once

#include <map>
#include <string>
#include <vector>

#include <tessel/tsrxkeptout.h>

class RecordingKeptOut : public TsRxKeptOut
{
public:
    std::map<std::wstring, std::wstring> reasons; // by path
    std::vector<std::wstring> keptOut;            // what was asked for, in order
    std::vector<std::wstring> letInAgain;

    const wchar_t* whyKeptOut(const wchar_t* path) override;
    bool keepOut(const wchar_t* path) override;
    bool letIn(const wchar_t* path) override;
};
