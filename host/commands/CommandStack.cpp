#include "host/commands/CommandStack.h"

#include <algorithm>
#include <cwctype>
#include <exception>

#include "host/commands/CallingApplication.h"
#include "host/commands/Command.h"
#include "host/text/CommandLine.h"
#include "host/text/Unicode.h"

bool TsEdCommandStack::isKindOf(const wchar_t* className) const
{
    return className && std::wstring_view(className) == kClassName;
}

namespace tessel
{
namespace
{
// The global name may be typed with this in front, whatever language the local names are in.
constexpr wchar_t kGlobalNameMark = L'_';

bool isBlank(wchar_t character)
{
    return character == L' ' || character == L'\t' || character == L'\r' || character == L'\n';
}

bool isName(const wchar_t* text)
{
    const std::wstring_view name = text ? text : L"";
    return !name.empty() &&
           std::ranges::none_of(name, [](wchar_t c) { return std::iswspace(static_cast<wint_t>(c)); });
}

bool answersTo(const TsEdCommand& command, std::wstring_view typedName)
{
    if (equalIgnoringCase(command.localName, typedName))
        return true;
    return typedName.starts_with(kGlobalNameMark) &&
           equalIgnoringCase(command.globalName, typedName.substr(1));
}

bool isIn(const TsEdCommand& command, const wchar_t* group)
{
    return group && equalIgnoringCase(command.group, group);
}

bool isOwn(const TsEdCommand& command)
{
    return static_cast<bool>(command.builtIn);
}

Failure failed(const std::wstring& name, const std::wstring& reason)
{
    return {L"The command \"" + name + L"\" failed: " + reason};
}

// What runs here may come from anybody's application: whatever it throws ends with the command.
Result<> call(const TsEdCommand& command, const CommandStack::Arguments& arguments, CallingApplication& calls)
{
    try
    {
        if (isOwn(command))
            return command.builtIn(arguments);
        if (!arguments.empty())
            return failed(command.localName, L"it takes no arguments.");
        const CallingApplication::Scope calling(calls, command.owner, RunningMarker::Deed::kCommand,
                                                command.localName);
        command.handler();
        return {};
    }
    catch (const std::exception& error)
    {
        return failed(command.localName, toWide(error.what()));
    }
    catch (...)
    {
        return failed(command.localName, L"it threw something that is not an error of the standard library.");
    }
}
} // namespace

CommandStack::CommandStack(CommandLine& commandLine, CallingApplication& calls)
    : mCommandLine(commandLine), mCalls(calls)
{
}

CommandStack::~CommandStack() = default;

void CommandStack::setLoader(Loader loader)
{
    mLoader = std::move(loader);
}

void CommandStack::setAfterLine(AfterLine afterLine)
{
    mAfterLine = std::move(afterLine);
}

void CommandStack::addBuiltIn(const Description& description, BuiltIn handler)
{
    auto command = std::make_shared<TsEdCommand>();
    command->group = description.group;
    command->globalName = command->localName = description.name;
    command->usage = description.usage;
    command->summary = description.summary;
    command->builtIn = std::move(handler);
    mCommands.push_back(std::move(command));
}

int CommandStack::addCommand(const wchar_t* group, const wchar_t* globalName, const wchar_t* localName, int,
                             TsEdCommandHandler handler, TsEdUIContext*, int, void*, TsEdCommand** command)
{
    if (!isName(group) || !isName(globalName) || !isName(localName) || !handler)
        return TSED_COMMAND_INVALID;
    const bool exists = std::ranges::any_of(
        mCommands, [&](const auto& other)
        { return isIn(*other, group) && equalIgnoringCase(other->globalName, globalName); });
    if (exists)
        return TSED_COMMAND_DUPLICATE;
    auto added = std::make_shared<TsEdCommand>();
    added->group = group;
    added->globalName = globalName;
    added->localName = localName;
    added->owner = mCalls.path();
    added->handler = handler;
    if (command)
        *command = added.get();
    mCommands.push_back(std::move(added));
    return TSED_COMMAND_OK;
}

int CommandStack::removeCommand(const wchar_t* group, const wchar_t* globalName)
{
    const auto removed = removeIf(
        [&](const TsEdCommand& command)
        { return globalName && isIn(command, group) && equalIgnoringCase(command.globalName, globalName); });
    return removed ? TSED_COMMAND_OK : TSED_COMMAND_UNKNOWN;
}

int CommandStack::removeGroup(const wchar_t* group)
{
    const auto removed = removeIf([&](const TsEdCommand& command) { return isIn(command, group); });
    return removed ? TSED_COMMAND_OK : TSED_COMMAND_UNKNOWN;
}

std::size_t CommandStack::removeIf(const std::function<bool(const TsEdCommand&)>& goes)
{
    return std::erase_if(mCommands,
                         [&](const Command& command) { return !isOwn(*command) && goes(*command); });
}

bool CommandStack::run(std::wstring_view line)
{
    const Arguments parts = splitLine(line);
    if (parts.empty())
        return true;
    const bool done = mCommandLine.tell(runParts(parts));
    const bool finished = !mAfterLine || mAfterLine();
    return done && finished;
}

Result<> CommandStack::runParts(const Arguments& parts) const
{
    // Kept alive here: the handler may unload the application and so remove its own command.
    if (const Command command = findOrLoad(parts.front()))
        return call(*command, Arguments(parts.begin() + 1, parts.end()), mCalls);
    return Failure{L"Unknown command \"" + parts.front() + L"\". Type HELP for the list of commands."};
}

CommandStack::Command CommandStack::find(std::wstring_view typedName) const
{
    const auto found = std::ranges::find_if(mCommands, [&](const Command& command)
                                            { return answersTo(*command, typedName); });
    return found == mCommands.end() ? nullptr : *found;
}

CommandStack::Command CommandStack::findOrLoad(const std::wstring& typedName) const
{
    Command command = find(typedName);
    if (!command && mLoader && mLoader(typedName))
        command = find(typedName);
    return command;
}

std::vector<CommandStack::Names> CommandStack::commandsOf(const std::wstring& applicationPath) const
{
    std::vector<Names> result;
    for (const auto& command : mCommands)
        if (!isOwn(*command) && command->owner == applicationPath)
            result.emplace_back(command->globalName, command->localName);
    return result;
}

void CommandStack::removeCommandsOf(const std::wstring& applicationPath)
{
    removeIf([&](const TsEdCommand& command) { return command.owner == applicationPath; });
}

std::vector<std::wstring> CommandStack::names() const
{
    std::vector<std::wstring> result;
    for (const auto& command : mCommands)
        result.push_back(command->localName);
    std::ranges::sort(result);
    result.erase(std::unique(result.begin(), result.end()), result.end());
    return result;
}

std::vector<CommandStack::Description> CommandStack::descriptions() const
{
    std::vector<Description> result;
    for (const auto& command : mCommands)
    {
        const auto lastOfGroup =
            std::find_if(result.rbegin(), result.rend(),
                         [&](const Description& other) { return isIn(*command, other.group.c_str()); });
        const auto place = lastOfGroup == result.rend() ? result.end() : lastOfGroup.base();
        result.insert(place, {command->group, command->localName, command->usage, command->summary});
    }
    return result;
}

CommandStack::Arguments splitLine(std::wstring_view line)
{
    CommandStack::Arguments parts;
    bool quoted = false;
    bool inPart = false; // also true for a pair of quotes with nothing between them
    for (std::size_t at = 0; at < line.size(); ++at)
    {
        const bool separates = !quoted && isBlank(line[at]);
        if (!separates && !inPart)
            parts.emplace_back();
        inPart = !separates;
        const bool doubled = quoted && line.substr(at).starts_with(L"\"\"");
        if (line[at] == L'"' && !doubled)
            quoted = !quoted;
        else if (!separates)
            parts.back() += line[at];
        at += doubled ? 1 : 0;
    }
    return parts;
}
} // namespace tessel
