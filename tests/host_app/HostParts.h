// The parts that the tests of this folder need from a host, with the output in a text.
#pragma once

#include <string>

#include "host/Services.h"
#include "host/text/CommandLine.h"

class CapturedOutput
{
public:
    CapturedOutput() { tessel::services().commandLine = &mCommandLine; }
    ~CapturedOutput() { tessel::services() = {}; }
    CapturedOutput(const CapturedOutput&) = delete;
    CapturedOutput& operator=(const CapturedOutput&) = delete;

    tessel::CommandLine& commandLine() { return mCommandLine; }
    const std::string& text() const { return mText; }
    void clear() { mText.clear(); }

private:
    std::string mText;
    tessel::CommandLine mCommandLine{[this](std::string_view piece)
                                     {
                                         mText += piece;
                                     }};
};
