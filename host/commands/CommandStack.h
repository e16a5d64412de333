// The commands that a person can type: those of the host and those that applications register.
#pragma once

#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include <tessel/tsedcommands.h>

namespace tessel
{
class CommandStack : public TsEdCommandStack
{
public:
    using Arguments = std::vector<std::wstring>;
    using BuiltIn = std::function<bool(const Arguments&)>; // false: the command failed, and has said why

    // A global and a local name.
    using Names = std::pair<std::wstring, std::wstring>;

    struct Description
    {
        std::wstring group;
        std::wstring name;    // what a person types
        std::wstring usage;   // the arguments, for built-in commands
        std::wstring summary; // one line, for built-in commands
    };

    // Asked with a command's name when nobody has registered it; true when it has loaded an application that
    // may have done so.
    using Loader = std::function<bool(const std::wstring& name)>;

    // Called at the end of every line that ran, whatever came of it.
    using AfterLine = std::function<void()>;

    CommandStack();
    ~CommandStack() override;

    void setLoader(Loader loader);
    void setAfterLine(AfterLine afterLine);

    // A command of the host itself. Its arguments follow on the line.
    void addBuiltIn(const Description& description, BuiltIn handler);

    int addCommand(const wchar_t* group, const wchar_t* globalName, const wchar_t* localName, int flags,
                   TsEdCommandHandler handler, TsEdUIContext* uiContext, int functionCode, void* resources,
                   TsEdCommand** command) override;
    int removeCommand(const wchar_t* group, const wchar_t* globalName) override;
    int removeGroup(const wchar_t* group) override;

    // Runs one line: a command's name and its arguments (double quotes keep blanks together). A blank line
    // does nothing. False when the command is unknown or failed; a sentence has then been said. Nothing that
    // a handler throws comes out of here.
    bool run(std::wstring_view line);

    // The commands that the application at that path has registered, in the order of registration.
    std::vector<Names> commandsOf(const std::wstring& applicationPath) const;

    // An application that is unloaded takes its commands along.
    void removeCommandsOf(const std::wstring& applicationPath);

    // What a person may type now, sorted, in the spelling of registration.
    std::vector<std::wstring> names() const;

    // Every command by group, groups in the order in which they were made.
    std::vector<Description> descriptions() const;

private:
    struct Command;
    using Commands = std::vector<std::shared_ptr<Command>>;

    std::shared_ptr<Command> find(std::wstring_view typedName) const;
    std::shared_ptr<Command> findOrLoad(const std::wstring& typedName);
    bool runParts(const Arguments& parts);
    bool removeIf(const std::function<bool(const Command&)>& goes);

    Commands mCommands; // shared: a handler may remove the command that is running
    Loader mLoader;
    AfterLine mAfterLine;
};

// The parts of a line: split at blanks, double quotes keep blanks together and are taken away. A quote that
// is not closed reaches to the end of the line.
CommandStack::Arguments splitLine(std::wstring_view line);
} // namespace tessel
