#include "tests/support/recording/RecordingKeptOut.h"

const wchar_t* RecordingKeptOut::whyKeptOut(const wchar_t* path)
{
    const auto found = reasons.find(path);
    return found == reasons.end() ? nullptr : found->second.c_str();
}

bool RecordingKeptOut::keepOut(const wchar_t* path)
{
    keptOut.emplace_back(path);
    reasons[path] = L"This application is kept out.";
    return true;
}

bool RecordingKeptOut::letIn(const wchar_t* path)
{
    letInAgain.emplace_back(path);
    return reasons.erase(path) != 0;
}

bool TsRxKeptOut::isKindOf(const wchar_t* className) const
{
    return className && std::wstring(className) == kClassName;
}
