// The part that most tests of the host need from it: the command line, with the output in a text.
#pragma once

#include <string>

#include "host/text/CommandLine.h"
#include "host/text/Running.h"

class CapturedOutput
{
public:
    CapturedOutput() = default;
    CapturedOutput(const CapturedOutput&) = delete;
    CapturedOutput& operator=(const CapturedOutput&) = delete;

    tessel::CommandLine& commandLine() { return *mCommandLine; }
    const std::string& text() const { return mText; }
    void clear() { mText.clear(); }

private:
    std::string mText;
    tessel::Owned<tessel::CommandLine> mCommandLine{[this](std::string_view piece)
                                                    {
                                                        mText += piece;
                                                    }};
};
