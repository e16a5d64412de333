#include "host/commands/CommandStack.h"

#include <algorithm>
#include <cwctype>

#include "host/commands/CallingApplication.h"
#include "host/commands/Command.h"
#include "host/commands/CommandTexts.h"
#include "host/text/Running.h"
#include "host/text/Unicode.h"

bool TsEdCommandStack::isKindOf(const wchar_t* className) const
{
    return className && std::wstring_view(className) == kClassName;
}

namespace tessel
{
namespace
{
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

bool isOneLine(std::wstring_view text)
{
    return !text.empty() &&
           std::ranges::none_of(text, [](wchar_t c) { return std::iswcntrl(static_cast<wint_t>(c)); });
}

bool isIn(const TsEdCommand& command, const wchar_t* group)
{
    return group && equalIgnoringCase(command.group, group);
}

// After the last one of its group; a new group comes last.
void insertIntoGroup(std::vector<CommandStack::Description>& all, CommandStack::Description added)
{
    const auto lastOfGroup = std::find_if(all.rbegin(), all.rend(),
                                          [&](const CommandStack::Description& other)
                                          { return equalIgnoringCase(other.group, added.group); });
    all.insert(lastOfGroup == all.rend() ? all.end() : lastOfGroup.base(), std::move(added));
}

bool isOwn(const TsEdCommand& command)
{
    return static_cast<bool>(command.builtIn);
}
} // namespace

CommandStack::Description CommandStack::descriptionOf(const CommandText& text)
{
    return {text.group.english, text.name, text.usage.english, text.summary.english, text.example};
}

CommandStack::Description CommandStack::descriptionOf(const TsEdCommand& command)
{
    return {command.group, command.localName, command.usage, command.summary, command.example};
}

CommandStack::CommandStack(const CallingApplication& calls) : mCalls(calls)
{
}

CommandStack::~CommandStack() = default;

void CommandStack::addBuiltIn(const Description& description, BuiltIn handler)
{
    auto command = std::make_shared<TsEdCommand>();
    command->group = description.group;
    command->globalName = command->localName = description.name;
    command->usage = description.usage;
    command->summary = description.summary;
    command->example = description.example;
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
    if (const CommandText* text = find(globalName) ? nullptr : findCommandText(globalName)) // Modrig's
    {
        added->summary = text->summary.english;
        added->usage = text->usage.english;
        added->example = text->example;
    }
    added->owner = mCalls.path();
    added->handler = handler;
    if (command)
        *command = added.get();
    mCommands.push_back(std::move(added));
    return TSED_COMMAND_OK;
}

void CommandStack::addListing(std::wstring_view name, BuiltIn handler)
{
    for (const auto& command : mCommands)
        if (isOwn(*command) && command->localName == name)
            command->listing = handler;
}

void CommandStack::announce(const Description& description)
{
    mAnnounced.push_back(description);
}

int CommandStack::describe(const wchar_t* group, const wchar_t* globalName, std::wstring_view description)
{
    return setLine(group, globalName, &TsEdCommand::summary, description);
}

int CommandStack::takeArguments(const wchar_t* group, const wchar_t* globalName, std::wstring_view usage)
{
    return setLine(group, globalName, &TsEdCommand::usage, usage);
}

int CommandStack::offerEntries(const wchar_t* group, const wchar_t* globalName, TsEdEntries entries)
{
    if (!entries)
        return TSED_COMMAND_INVALID;
    TsEdCommand* command = applications(group, globalName);
    if (!command)
        return TSED_COMMAND_UNKNOWN;
    command->entries = entries;
    return TSED_COMMAND_OK;
}

// Null where no application has such a command.
TsEdCommand* CommandStack::applications(const wchar_t* group, const wchar_t* globalName) const
{
    const auto found = std::ranges::find_if(mCommands,
                                            [&](const auto& command)
                                            {
                                                return !isOwn(*command) && globalName &&
                                                       isIn(*command, group) &&
                                                       equalIgnoringCase(command->globalName, globalName);
                                            });
    return found == mCommands.end() ? nullptr : found->get();
}

int CommandStack::setLine(const wchar_t* group, const wchar_t* globalName, std::wstring TsEdCommand::*line,
                          std::wstring_view text)
{
    if (!isOneLine(text))
        return TSED_COMMAND_INVALID;
    TsEdCommand* command = applications(group, globalName);
    if (!command)
        return TSED_COMMAND_UNKNOWN;
    command->*line = text;
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
    return std::erase_if(mCommands, [&](const auto& command) { return !isOwn(*command) && goes(*command); });
}

CommandStack::Command CommandStack::find(std::wstring_view typedName) const
{
    const auto found =
        std::ranges::find_if(mCommands, [&](const auto& command) { return answersTo(*command, typedName); });
    return found == mCommands.end() ? nullptr : *found;
}

std::optional<CommandStack::Description> CommandStack::description(std::wstring_view typedName) const
{
    if (const Command found = find(typedName))
        return descriptionOf(*found);
    const auto announced = std::ranges::find_if(mAnnounced, [&](const Description& other)
                                                { return equalIgnoringCase(other.name, typedName); });
    return announced == mAnnounced.end() ? std::nullopt : std::optional(*announced);
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
    for (const auto& announced : mAnnounced)
        result.push_back(announced.name);
    std::ranges::sort(result);
    result.erase(std::unique(result.begin(), result.end()), result.end());
    return result;
}

std::vector<CommandStack::Description> CommandStack::descriptions() const
{
    std::vector<Description> result;
    for (const auto& command : mCommands)
        insertIntoGroup(result, descriptionOf(*command));
    for (const auto& announced : mAnnounced)
        if (!find(announced.name))
            insertIntoGroup(result, announced);
    return result;
}
} // namespace tessel

int tsedDescribeCommand(const wchar_t* group, const wchar_t* globalName, const wchar_t* description)
{
    auto* commands = tessel::running<tessel::CommandStack>();
    return commands ? commands->describe(group, globalName, description ? description : L"")
                    : TSED_COMMAND_UNKNOWN;
}

int tsedTakeArguments(const wchar_t* group, const wchar_t* globalName, const wchar_t* usage)
{
    auto* commands = tessel::running<tessel::CommandStack>();
    return commands ? commands->takeArguments(group, globalName, usage ? usage : L"") : TSED_COMMAND_UNKNOWN;
}

int tsedOfferEntries(const wchar_t* group, const wchar_t* globalName, TsEdEntries entries)
{
    auto* commands = tessel::running<tessel::CommandStack>();
    return commands ? commands->offerEntries(group, globalName, entries) : TSED_COMMAND_UNKNOWN;
}
