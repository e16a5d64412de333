// What is kept out, for applications that show it.
#pragma once

#include <string>

#include <tessel/tsrxkeptout.h>

#include "host/text/Result.h"

namespace tessel
{
class Admission;
class CommandLine;
class KeptOut;

class KeptOutService : public TsRxKeptOut
{
public:
    KeptOutService(KeptOut& keptOut, const Admission& admission, CommandLine& commandLine)
        : mKeptOut(keptOut), mAdmission(admission), mCommandLine(commandLine)
    {
    }

    const wchar_t* whyKeptOut(const wchar_t* path) override;
    bool keepOut(const wchar_t* path) override;
    bool letIn(const wchar_t* path) override;

private:
    KeptOut& mKeptOut;
    const Admission& mAdmission;
    CommandLine& mCommandLine;
    std::wstring mSentence;
};
} // namespace tessel
