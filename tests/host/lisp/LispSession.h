// An interpreter with the parts of the host that it needs, the output in a text.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include <gtest/gtest.h>
#include <tessel/tsed.h>

#include "host/applications/Document.h"
#include "host/commands/EndRequest.h"
#include "host/lisp/LispInterpreter.h"
#include "host/text/CommandLine.h"
#include "host/text/Running.h"
#include "host/text/Unicode.h"

// Small enough to be filled quickly.
inline constexpr std::size_t kTestHeapBytes = std::size_t{64} << 20;

class LispSession
{
public:
    explicit LispSession(bool removingTsLisp = true)
        : mLisp(
              tessel::LispInterpreter::Options{.removingTsLisp = removingTsLisp, .heapBytes = kTestHeapBytes},
              *mCommandLine, *mDocument, mEndRequest)
    {
    }
    LispSession(const LispSession&) = delete;
    LispSession& operator=(const LispSession&) = delete;

    tessel::LispInterpreter& lisp() { return *mLisp; }
    tessel::Document& document() { return *mDocument; }
    tessel::CommandLine& commandLine() { return *mCommandLine; }
    const std::string& output() const { return mOutput; }
    void clearOutput() { mOutput.clear(); }

    // Called with every piece of output, while Lisp runs.
    void onOutput(std::function<void(std::string_view)> listener) { mListener = std::move(listener); }

    // The printed value; a failure fails the test.
    std::string value(const std::string& expression)
    {
        const auto value = mLisp->evaluate(tessel::toWide(expression));
        EXPECT_TRUE(value) << expression << ": " << tessel::toUtf8(value.sentence());
        return tessel::toUtf8(value ? *value : value.sentence());
    }

    // The line of error text; success fails the test, and so does more than one line.
    std::string error(const std::string& expression)
    {
        const auto value = mLisp->evaluate(tessel::toWide(expression));
        EXPECT_FALSE(value) << expression << ": " << (value ? tessel::toUtf8(*value) : "");
        EXPECT_EQ(value.sentence().find(L'\n'), std::wstring::npos) << tessel::toUtf8(value.sentence());
        return tessel::toUtf8(value.sentence());
    }

    std::vector<std::string> documentNames() const
    {
        std::vector<std::string> names;
        for (int index = 0; index < mDocument->loadedApplicationCount(); ++index)
            names.push_back(tessel::toUtf8(mDocument->loadedApplicationName(index)));
        return names;
    }

private:
    void receive(std::string_view piece)
    {
        mOutput += piece;
        if (mListener)
            mListener(piece);
    }

    std::string mOutput;
    std::function<void(std::string_view)> mListener;
    tessel::Owned<tessel::CommandLine> mCommandLine{[this](std::string_view piece)
                                                    {
                                                        receive(piece);
                                                    }};
    tessel::Owned<tessel::Document> mDocument;
    tessel::EndRequest mEndRequest;
    tessel::Owned<tessel::LispInterpreter> mLisp;
};
