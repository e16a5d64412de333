// Lisp without an interpreter: expressions are kept, functions answer as told.
#pragma once

#include <functional>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "tests/support/recording/RecordingValue.h"

// What `RemovingTsLISP` answers until a test sets something else: from static initialisation on, so that it
// is linked, not set. A program links one of the object libraries `recording_host_removing` (true) and
// `recording_host_not_removing` (false).
extern const bool recordingHostRemovesTsLisp;

class RecordingLisp
{
public:
    // The expressions given to `qxr_queueexpr`, in order.
    std::vector<std::wstring> queued;

    // The lists given to `tsedInvoke`, in order.
    std::vector<std::vector<RecordingValue>> invoked;

    // What `tsedInvoke` answers. Without an own answer for the function's name it is the status below with no
    // list. A function may do anything a test wants before it answers; nothing means a Lisp error.
    using Values = std::vector<RecordingValue>;
    using Function = std::function<std::optional<Values>(const Values& arguments)>;
    void setFunction(const std::wstring& name, Function function);
    int invokeStatus = TS_NORMAL;

    // What evaluating an expression does when the queue is run; one that nobody has told about does nothing.
    void setEvaluation(const std::wstring& expression, std::function<void()> evaluation);
    // Takes the queued expressions, in order, until there are none; also those queued meanwhile.
    void runQueued();

    bool removing = recordingHostRemovesTsLisp;
    // How often `RemovingTsLISP` was asked since the process began; `reset` does not touch it.
    static unsigned timesAskedForRemoving();

    // What `tsedInvoke` does.
    int invoke(const TsResultBuffer* call, TsResultBuffer** result);

private:
    std::map<std::wstring, Function> mFunctions;
    std::map<std::wstring, std::function<void()>> mEvaluations;
};
