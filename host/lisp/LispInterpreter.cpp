#include "host/lisp/LispInterpreter.h"

#include <utility>

#include <tessel/tsdefs.h>

#include "host/applications/Document.h"
#include "host/commands/EndRequest.h"
#include "host/lisp/LispLoads.h"
#include "host/lisp/LispMachine.h"
#include "host/text/CommandLine.h"

namespace tessel
{
namespace
{
LispSurroundings surroundings(const LispInterpreter::Options& options, CommandLine& commandLine,
                              Document& document, LispLoads& loads)
{
    return {.removingTsLisp = options.removingTsLisp,
            .heapBytes = options.heapBytes != 0 ? options.heapBytes : kLispHeapBytes,
            .write = [&commandLine](std::wstring_view text) { commandLine.print(text); },
            .column = [&commandLine] { return commandLine.openLine().size(); },
            .fileLoaded =
                [&document, &loads](const std::wstring& path)
            {
                document.add(path);
                loads.loaded(path);
            },
            .fileAsked =
                [&loads](const std::wstring& path)
            {
                loads.asked(path);
            }};
}
} // namespace

LispInterpreter::LispInterpreter(std::unique_ptr<LispMachine> machine, std::unique_ptr<LispLoads> loads,
                                 bool removingTsLisp, CommandLine& commandLine, const EndRequest& endRequest)
    : mLoads(std::move(loads)), mMachine(std::move(machine)), mRemovingTsLisp(removingTsLisp),
      mCommandLine(commandLine), mEndRequest(endRequest)
{
}

Result<std::unique_ptr<LispInterpreter>> LispInterpreter::start(const Options& options,
                                                                CommandLine& commandLine, Document& document,
                                                                const EndRequest& endRequest)
{
    auto loads = std::make_unique<LispLoads>(options.outcomes);
    auto machine = LispMachine::start(surroundings(options, commandLine, document, *loads));
    if (!machine)
        return machine.failure();
    return std::unique_ptr<LispInterpreter>(new LispInterpreter(
        *std::move(machine), std::move(loads), options.removingTsLisp, commandLine, endRequest));
}

LispInterpreter::~LispInterpreter() = default;

Result<std::wstring> LispInterpreter::evaluate(std::wstring_view expressions)
{
    mLoads->begin();
    auto value = mMachine->evaluate(expressions);
    mLoads->end(value);
    return value;
}

void LispInterpreter::queue(std::wstring expression)
{
    mQueue.push_back(std::move(expression));
}

bool LispInterpreter::runQueue()
{
    if (mRunningQueue)
        return true;
    mRunningQueue = true;
    bool allRan = true;
    while (!mQueue.empty() && !mEndRequest.isMade())
    {
        const std::wstring expression = std::move(mQueue.front());
        mQueue.pop_front();
        allRan = mCommandLine.tell(evaluate(expression)) && allRan;
    }
    mRunningQueue = false;
    return allRan;
}

bool LispInterpreter::idle() const
{
    return mQueue.empty() && !running();
}

int LispInterpreter::invoke(const TsResultBuffer* call, TsResultBuffer** result)
{
    const auto values = mMachine->call(call);
    *result = values ? *values : nullptr;
    return mCommandLine.tell(values) ? TS_NORMAL : TS_ERROR;
}

void LispInterpreter::interrupt() noexcept
{
    mMachine->interrupt();
}

bool LispInterpreter::running() const noexcept
{
    return mMachine->running();
}

unsigned LispInterpreter::evaluations() const noexcept
{
    return mMachine->evaluations();
}
} // namespace tessel
