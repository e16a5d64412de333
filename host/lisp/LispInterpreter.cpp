#include "host/lisp/LispInterpreter.h"

#include <utility>

#include <tessel/tsdefs.h>

#include "host/applications/Document.h"
#include "host/commands/EndRequest.h"
#include "host/lisp/LispMachine.h"
#include "host/text/CommandLine.h"

namespace tessel
{
namespace
{
void mark(LispSurroundings& surroundings, RunningMarker& marker)
{
    surroundings.fileBegins = [&marker](const std::wstring&, const std::filesystem::path& file)
    {
        marker.begin(RunningMarker::Deed::kLispFile, file.native());
        return Result<>();
    };
    surroundings.filesOpen = [&marker]
    {
        return marker.depth();
    };
    surroundings.filesEnd = [&marker](std::size_t depth)
    {
        marker.endTo(depth);
    };
}

LispSurroundings surroundings(const LispInterpreter::Options& options, CommandLine& commandLine,
                              Document& document)
{
    LispSurroundings surroundings = {.removingTsLisp = options.removingTsLisp,
                                     .heapBytes = options.heapBytes != 0 ? options.heapBytes : kLispHeapBytes,
                                     .write = [&commandLine](std::wstring_view text)
                                     { commandLine.print(text); },
                                     .column = [&commandLine] { return commandLine.openLine().size(); },
                                     .fileLoaded =
                                         [&document](const std::wstring& path)
                                     {
                                         document.add(path);
                                     }};
    if (options.marker)
        mark(surroundings, *options.marker);
    return surroundings;
}
} // namespace

LispInterpreter::LispInterpreter(std::unique_ptr<LispMachine> machine, const Options& options,
                                 CommandLine& commandLine, const EndRequest& endRequest)
    : mMachine(std::move(machine)), mRemovingTsLisp(options.removingTsLisp), mCommandLine(commandLine),
      mEndRequest(endRequest), mMarker(options.marker ? *options.marker : mNoMarker)
{
}

Result<std::unique_ptr<LispInterpreter>> LispInterpreter::start(const Options& options,
                                                                CommandLine& commandLine, Document& document,
                                                                const EndRequest& endRequest)
{
    auto machine = LispMachine::start(surroundings(options, commandLine, document));
    if (!machine)
        return machine.failure();
    return std::unique_ptr<LispInterpreter>(
        new LispInterpreter(*std::move(machine), options, commandLine, endRequest));
}

LispInterpreter::~LispInterpreter() = default;

Result<std::wstring> LispInterpreter::evaluate(std::wstring_view expressions)
{
    const std::size_t depth = mMarker.depth();
    auto value = mMachine->evaluate(expressions);
    mMarker.endTo(depth); // Lisp may have been left by a jump
    return value;
}

void LispInterpreter::queue(std::wstring expression)
{
    mQueue.push_back({std::move(expression), mMarker.reason()});
}

bool LispInterpreter::runQueue()
{
    if (mRunningQueue)
        return true;
    mRunningQueue = true;
    bool allRan = true;
    while (!mQueue.empty() && !mEndRequest.isMade())
    {
        const Queued next = std::move(mQueue.front());
        mQueue.pop_front();
        const RunningMarker::ReasonScope reason(mMarker, next.reason);
        allRan = mCommandLine.tell(evaluate(next.expression)) && allRan;
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
} // namespace tessel
