#include "host/applications/KeptOutService.h"

#include <string_view>

#include "host/applications/Admission.h"
#include "host/applications/KeptOut.h"
#include "host/text/CommandLine.h"
#include "host/text/Unicode.h"

bool TsRxKeptOut::isKindOf(const wchar_t* className) const
{
    return className && std::wstring_view(className) == kClassName;
}

namespace tessel
{
const wchar_t* KeptOutService::whyKeptOut(const wchar_t* path)
{
    mSentence = mAdmission.whyKeptOut(path ? path : L"");
    return mSentence.empty() ? nullptr : mSentence.c_str();
}

bool KeptOutService::keepOut(const wchar_t* path)
{
    return path && mCommandLine.tell(mKeptOut.keepOut(toUtf8(path)));
}

bool KeptOutService::letIn(const wchar_t* path)
{
    return path && mCommandLine.tell(mKeptOut.letIn(toUtf8(path)));
}
} // namespace tessel
