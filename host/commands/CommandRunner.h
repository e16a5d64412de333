// Runs the lines that a person types, but for those of Lisp: the commands of the stack, with their arguments.
#pragma once

#include <functional>
#include <string>
#include <string_view>

#include "host/commands/CommandStack.h"
#include "host/text/Result.h"

namespace tessel
{
class CallingApplication;
class CommandLine;

class CommandRunner
{
public:
    // Asked with the typed name when nobody has registered it; true when it has loaded an application that
    // may have done so.
    using Loader = std::function<bool(const std::wstring& name)>;

    // Called at the end of every line that ran, whatever came of it; false makes the line one that failed.
    using AfterLine = std::function<bool()>;

    // What can be typed, to find what was meant by a name that is unknown.
    using Names = std::function<std::vector<std::wstring>()>;

    // Says on the command line what became of a line, and tells `calls` whose command runs. Without a loader
    // there are the commands of the stack and no more.
    CommandRunner(const CommandStack& commands, CommandLine& commandLine, CallingApplication& calls,
                  Loader loader = {}, AfterLine afterLine = {}, Names names = {});

    // Runs one line: a command's name and its arguments (see TypedLine.h). A blank line does nothing. False
    // when the command is unknown or failed, which has been told by then. Nothing that a handler throws comes
    // out of here.
    bool run(std::wstring_view line);

    // What there is to name as an argument of the command in the first part, after the others: what its
    // application offers (`tsedOfferEntries`), which is loaded for that.
    CommandStack::Arguments entries(const CommandStack::Arguments& parts) const;

private:
    CommandStack::Command findOrLoad(const std::wstring& typedName) const;
    Failure unknown(const std::wstring& typedName) const;
    Result<> runParts(const CommandStack::Arguments& parts) const;

    const CommandStack& mCommands;
    CommandLine& mCommandLine;
    CallingApplication& mCalls;
    Loader mLoader;
    AfterLine mAfterLine;
    Names mNames;
};
} // namespace tessel
