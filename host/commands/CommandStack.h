// The commands that a person can type: those of the host and those that applications register.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include <tessel/tsedcommands.h>

#include "host/text/Result.h"

namespace tessel
{
class CallingApplication;
class CommandLine;

class CommandStack : public TsEdCommandStack
{
public:
    using Arguments = std::vector<std::wstring>;
    using BuiltIn = std::function<Result<>(const Arguments&)>;
    using Names = std::pair<std::wstring, std::wstring>; // a global and a local name

    struct Description
    {
        std::wstring group;
        std::wstring name;    // what a person types
        std::wstring usage;   // the arguments, for commands of the host
        std::wstring summary; // one line, for commands of the host
    };

    // Asked with the typed name when nobody has registered it; true when it has loaded an application that
    // may have done so.
    using Loader = std::function<bool(const std::wstring& name)>;

    // Called at the end of every line that ran, whatever came of it; false makes the line one that failed.
    using AfterLine = std::function<bool()>;

    // Says on the command line what became of a line, and tells `calls` whose command runs.
    CommandStack(CommandLine& commandLine, CallingApplication& calls);
    ~CommandStack() override;

    void setLoader(Loader loader);
    void setAfterLine(AfterLine afterLine);

    // A command of the host itself: its arguments follow on the line, and no application can remove it.
    void addBuiltIn(const Description& description, BuiltIn handler);

    // The command belongs to the application that is being called.
    int addCommand(const wchar_t* group, const wchar_t* globalName, const wchar_t* localName, int flags,
                   TsEdCommandHandler handler, TsEdUIContext* uiContext, int functionCode, void* resources,
                   TsEdCommand** command) override;
    int removeCommand(const wchar_t* group, const wchar_t* globalName) override;
    int removeGroup(const wchar_t* group) override;

    // Runs one line: a command's name and its arguments (see `splitLine`). A blank line does nothing. Where
    // several commands share a name, the one registered first runs, so that nobody can take the host's own
    // away. False when the command is unknown or failed, which has been told by then. Nothing that a
    // handler throws comes out of here.
    bool run(std::wstring_view line);

    // The commands that the application at that path has registered, in the order of registration.
    std::vector<Names> commandsOf(const std::wstring& applicationPath) const;

    // An application that is unloaded takes its commands along.
    void removeCommandsOf(const std::wstring& applicationPath);

    // What a person may type now, sorted, in the spelling of registration.
    std::vector<std::wstring> names() const;

    // Every command, group by group, groups in the order in which they were made.
    std::vector<Description> descriptions() const;

private:
    using Command = std::shared_ptr<TsEdCommand>; // shared: a handler may remove the command that runs it

    Command find(std::wstring_view typedName) const;
    Command findOrLoad(const std::wstring& typedName) const;
    Result<> runParts(const Arguments& parts) const;
    std::size_t removeIf(const std::function<bool(const TsEdCommand&)>& goes);

    CommandLine& mCommandLine;
    CallingApplication& mCalls;
    std::vector<Command> mCommands;
    Loader mLoader;
    AfterLine mAfterLine;
};

// The parts of a line: split at blanks; double quotes keep blanks together and are taken away. Within them a
// doubled quote stands for one, so that a file with a quote in its name can be named. A quote that is not
// closed reaches to the end of the line.
CommandStack::Arguments splitLine(std::wstring_view line);
} // namespace tessel
