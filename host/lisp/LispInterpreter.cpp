#include "host/lisp/LispInterpreter.h"

#include <utility>

#include <tessel/tsdefs.h>

#include "host/Services.h"
#include "host/applications/Document.h"
#include "host/commands/EndRequest.h"
#include "host/lisp/LispMachine.h"
#include "host/text/CommandLine.h"

namespace tessel
{
namespace
{
LispSurroundings surroundings(const LispInterpreter::Options& options)
{
    return {.removingTsLisp = options.removingTsLisp,
            .heapBytes = options.heapBytes != 0 ? options.heapBytes : kLispHeapBytes,
            .write = [](std::wstring_view text) { services().commandLine->print(text); },
            .column = [] { return services().commandLine->openLine().size(); },
            .fileLoaded =
                [](const std::wstring& path)
            {
                if (services().document)
                    services().document->add(path);
            }};
}

bool isToEnd()
{
    return services().endRequest && services().endRequest->isMade();
}
} // namespace

LispInterpreter::LispInterpreter(std::unique_ptr<LispMachine> machine) : mMachine(std::move(machine))
{
}

Result<std::unique_ptr<LispInterpreter>> LispInterpreter::start(const Options& options)
{
    auto machine = LispMachine::start(surroundings(options));
    if (!machine)
        return machine.failure();
    return std::unique_ptr<LispInterpreter>(new LispInterpreter(*std::move(machine)));
}

LispInterpreter::~LispInterpreter() = default;

Result<std::wstring> LispInterpreter::evaluate(std::wstring_view expressions)
{
    return mMachine->evaluate(expressions);
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
    while (!mQueue.empty() && !isToEnd())
    {
        const std::wstring expression = std::move(mQueue.front());
        mQueue.pop_front();
        allRan = services().commandLine->tell(evaluate(expression)) && allRan;
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
    return services().commandLine->tell(values) ? TS_NORMAL : TS_ERROR;
}

void LispInterpreter::interrupt() noexcept
{
    mMachine->interrupt();
}

bool LispInterpreter::running() const noexcept
{
    return mMachine->running();
}
} // namespace tessel
