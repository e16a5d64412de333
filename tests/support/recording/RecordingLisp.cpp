#include "tests/support/recording/RecordingLisp.h"

#include <tessel/tsed.h>

#include "tests/support/RecordingHost.h"

namespace
{
// Ready before the first object of static initialisation asks.
constinit unsigned timesAsked = 0;
} // namespace

void RecordingLisp::setFunction(const std::wstring& name, Function function)
{
    mFunctions[name] = std::move(function);
}

void RecordingLisp::setEvaluation(const std::wstring& expression, std::function<void()> evaluation)
{
    mEvaluations[expression] = std::move(evaluation);
}

void RecordingLisp::runQueued()
{
    while (!queued.empty())
    {
        const std::wstring expression = queued.front();
        queued.erase(queued.begin());
        if (const auto told = mEvaluations.find(expression); told != mEvaluations.end())
            told->second();
    }
}

unsigned RecordingLisp::timesAskedForRemoving()
{
    return timesAsked;
}

int RecordingLisp::invoke(const TsResultBuffer* call, TsResultBuffer** result)
{
    invoked.push_back(recordedValues(call));
    *result = nullptr;
    Values arguments = invoked.back();
    if (arguments.empty() || arguments.front().type != TS_STRING)
        return TS_ERROR;
    const auto function = mFunctions.find(arguments.front().text);
    if (function == mFunctions.end())
        return invokeStatus;
    arguments.erase(arguments.begin());
    const std::optional<Values> values = function->second(arguments);
    if (!values)
        return TS_ERROR;
    *result = resultBuffer(*values);
    return TS_NORMAL;
}

int tsedInvoke(const TsResultBuffer* call, TsResultBuffer** result)
{
    recordingHost().journal.add(L"tsedInvoke");
    return recordingHost().lisp.invoke(call, result);
}

void qxr_queueexpr(const wchar_t* expression)
{
    recordingHost().journal.add(L"qxr_queueexpr", {expression});
    recordingHost().lisp.queued.emplace_back(expression);
}

bool RemovingTsLISP()
{
    ++timesAsked;
    return recordingHost().lisp.removing;
}
