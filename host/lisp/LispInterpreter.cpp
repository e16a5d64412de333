#include "host/lisp/LispInterpreter.h"

#include <sstream>
#include <utility>

#include "host/applications/Admission.h"
#include "host/applications/Document.h"
#include "host/commands/EndRequest.h"
#include "host/lisp/LispLoads.h"
#include "host/lisp/LispMachine.h"
#include "host/text/CommandLine.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
void admitFilesBy(Admission& admission, LispSurroundings& surroundings)
{
    surroundings.fileBegins = [&admission](const std::filesystem::path& file)
    {
        auto admitted = admission.check(toWide(file.native()));
        if (admitted)
            admission.marker().begin(RunningMarker::Deed::kLispFile, file.native());
        return admitted;
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
} // namespace

LispInterpreter::LispInterpreter(const Options& options, CommandLine& commandLine, Document& document,
                                 const EndRequest& endRequest)
    : mOptions(options), mCommandLine(commandLine), mDocument(document), mEndRequest(endRequest),
      mMarker(options.admission ? options.admission->marker() : mNoMarker),
      mLoads(std::make_unique<LispLoads>(options.outcomes))
{
}

LispInterpreter::~LispInterpreter() = default;

LispSurroundings LispInterpreter::surroundings()
{
    LispSurroundings surroundings;
    surroundings.removingTsLisp = mOptions.removingTsLisp;
    if (mOptions.heapBytes != 0)
        surroundings.heapBytes = mOptions.heapBytes;
    surroundings.write = [this](std::wstring_view text)
    {
        mCommandLine.print(text);
    };
    surroundings.column = [this]
    {
        return mCommandLine.openLine().size();
    };
    surroundings.fileAsked = [this](const std::wstring& path)
    {
        mLoads->asked(path);
    };
    surroundings.fileRefused = [this](const Failure& reason)
    {
        mLoads->refused(reason);
    };
    surroundings.fileFailed = [this](const std::wstring& path, const std::wstring& words)
    {
        mLoads->failed(path, words);
    };
    surroundings.fileLoaded = [this](const std::wstring& path)
    {
        mDocument.add(path);
        mLoads->loaded(path);
        RunningMarker::AtWork file{};
        if (mOptions.admission && mMarker.innermost(file))
            mOptions.admission->noteLoaded(toWide(file.path));
    };
    if (mOptions.admission)
        admitFilesBy(*mOptions.admission, surroundings);
    return surroundings;
}

Result<LispMachine*> LispInterpreter::machine()
{
    if (!mMachine)
    {
        auto started = LispMachine::start(surroundings());
        if (!started)
            return started.failure();
        mMachine = *std::move(started);
        mStarted = mMachine.get();
    }
    return mMachine.get();
}

Result<std::wstring> LispInterpreter::evaluate(std::wstring_view expressions, const Interruption::Wish* wish)
{
    const std::size_t depth = mMarker.depth();
    mLoads->begin();
    const auto machine = this->machine();
    auto value = machine ? (*machine)->evaluate(expressions, wish) : machine.failure();
    const int code = mLoads->end(value);
    mMarker.endTo(depth); // Lisp may have been left by a jump
    const bool isTold = mOptions.outcomes && code != 0 && mOptions.outcomes->willBeTold(code);
    if (code == Admission::kAlreadyTold || isTold)
        return Failure{{}, code};
    return value;
}

void LispInterpreter::queue(std::wstring expression)
{
    if (mOptions.admission)
        mOptions.admission->noteCarrier();
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
    const auto machine = this->machine();
    return machine ? (*machine)->call(call) : machine.failure();
}

std::vector<std::wstring> LispInterpreter::symbolsBeginning(std::wstring_view beginning)
{
    std::vector<std::wstring> symbols;
    const auto machine = this->machine();
    const auto found = machine ? (*machine)->symbolsBeginning(beginning) : machine.failure();
    std::wistringstream lines(found ? *found : L"");
    for (std::wstring line; std::getline(lines, line);)
        symbols.push_back(line);
    return symbols;
}

void LispInterpreter::interrupt() noexcept
{
    if (LispMachine* started = mStarted)
        started->interrupt();
}

void LispInterpreter::interruptUntilItEnds() noexcept
{
    if (LispMachine* started = mStarted)
        started->interruptUntilItEnds();
}

bool LispInterpreter::running() const noexcept
{
    const LispMachine* started = mStarted;
    return started && started->running();
}

unsigned LispInterpreter::evaluations() const noexcept
{
    const LispMachine* started = mStarted;
    return started ? started->evaluations() : 0;
}
} // namespace tessel
