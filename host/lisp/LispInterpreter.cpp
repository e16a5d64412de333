#include "host/lisp/LispInterpreter.h"

#include <utility>

#include "host/applications/Admission.h"
#include "host/applications/Document.h"
#include "host/commands/EndRequest.h"
#include "host/lisp/LispFile.h"
#include "host/lisp/LispLoads.h"
#include "host/lisp/LispMachine.h"
#include "host/text/CommandLine.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
void admitFilesBy(Admission& admission, LispLoads& loads, LispSurroundings& surroundings)
{
    surroundings.fileBegins = [&admission, &loads](const std::wstring& name,
                                                   const std::filesystem::path& file) -> Result<>
    {
        const auto admitted = admission.check(toWide(file.native()));
        if (admitted)
        {
            admission.marker().begin(RunningMarker::Deed::kLispFile, file.native());
            return {};
        }
        loads.refused(admitted);
        return refusedLispFile(name, admitted.sentence() + L".");
    };
    surroundings.filesOpen = [&admission]
    {
        return admission.marker().depth();
    };
    surroundings.filesEnd = [&admission](std::size_t depth)
    {
        admission.marker().endTo(depth);
    };
}

LispSurroundings surroundings(const LispInterpreter::Options& options, CommandLine& commandLine,
                              Document& document, LispLoads& loads)
{
    const auto fileLoaded = [&document, &loads, admission = options.admission](const std::wstring& path)
    {
        document.add(path);
        loads.loaded(path);
        RunningMarker::AtWork file{};
        if (admission && admission->marker().innermost(file))
            admission->noteLoaded(toWide(file.path));
    };
    const auto fileAsked = [&loads](const std::wstring& path)
    {
        loads.asked(path);
    };
    LispSurroundings surroundings = {.removingTsLisp = options.removingTsLisp,
                                     .heapBytes = options.heapBytes != 0 ? options.heapBytes : kLispHeapBytes,
                                     .write = [&commandLine](std::wstring_view text)
                                     { commandLine.print(text); },
                                     .column = [&commandLine] { return commandLine.openLine().size(); },
                                     .fileLoaded = fileLoaded,
                                     .fileAsked = fileAsked};
    if (options.admission)
        admitFilesBy(*options.admission, loads, surroundings);
    return surroundings;
}
} // namespace

LispInterpreter::LispInterpreter(std::unique_ptr<LispMachine> machine, std::unique_ptr<LispLoads> loads,
                                 const Options& options, CommandLine& commandLine,
                                 const EndRequest& endRequest)
    : mLoads(std::move(loads)), mMachine(std::move(machine)), mRemovingTsLisp(options.removingTsLisp),
      mCommandLine(commandLine), mEndRequest(endRequest), mAdmission(options.admission),
      mMarker(options.admission ? options.admission->marker() : mNoMarker)
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
    return std::unique_ptr<LispInterpreter>(
        new LispInterpreter(*std::move(machine), std::move(loads), options, commandLine, endRequest));
}

LispInterpreter::~LispInterpreter() = default;

Result<std::wstring> LispInterpreter::evaluate(std::wstring_view expressions)
{
    const std::size_t depth = mMarker.depth();
    mLoads->begin();
    auto value = mMachine->evaluate(expressions);
    const int code = mLoads->end(value);
    mMarker.endTo(depth); // Lisp may have been left by a jump
    if (code == Admission::kToldAtStart)
        return Failure{{}, code};
    return value;
}

void LispInterpreter::queue(std::wstring expression)
{
    if (mAdmission)
        mAdmission->noteCarrier();
    mQueue.push_back({std::move(expression), mMarker.reason()});
}

void LispInterpreter::runQueue()
{
    if (mRunningQueue)
        return;
    mRunningQueue = true;
    while (!mQueue.empty() && !mEndRequest.isMade())
    {
        const Queued next = std::move(mQueue.front());
        mQueue.pop_front();
        const RunningMarker::ReasonScope reason(mMarker, next.reason);
        mCommandLine.tell(evaluate(next.expression));
    }
    mRunningQueue = false;
}

Result<TsResultBuffer*> LispInterpreter::invoke(const TsResultBuffer* call)
{
    return mMachine->call(call);
}

void LispInterpreter::interrupt() noexcept
{
    mMachine->interrupt();
}

void LispInterpreter::interruptUntilItEnds() noexcept
{
    mMachine->interruptUntilItEnds();
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
