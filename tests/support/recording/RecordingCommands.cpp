#include "tests/support/recording/RecordingCommands.h"

#include <algorithm>
#include <cwctype>
#include <iterator>
#include <sstream>

#include "host/text/Unicode.h"
#include "tests/support/RecordingHost.h"

namespace
{
bool isName(const std::wstring& text)
{
    return !text.empty() &&
           std::none_of(text.begin(), text.end(),
                        [](wchar_t character) { return std::iswspace(static_cast<wint_t>(character)) != 0; });
}

bool isCommand(const TsEdCommand& command, const std::wstring& group, const std::wstring& globalName)
{
    return tessel::equalIgnoringCase(command.group, group) &&
           tessel::equalIgnoringCase(command.globalName, globalName);
}
} // namespace

bool RecordingCommands::type(const std::wstring& line)
{
    std::wistringstream words(line);
    std::wstring name;
    words >> name;
    const std::vector<std::wstring> typed{std::istream_iterator<std::wstring, wchar_t>(words), {}};
    const TsEdCommand* found = find(name);
    if (!found || (!typed.empty() && found->usage.empty()))
        return false;
    const TsEdCommandHandler handler = found->handler; // the handler may remove its own command
    const RecordingCaller caller(found->owner);
    failure.reset();
    arguments = typed;
    handler();
    arguments.clear();
    return !failure;
}

void RecordingCommands::removeCommandsOf(const std::wstring& applicationPath)
{
    std::erase_if(mCommands, [&](const auto& command) { return command->owner == applicationPath; });
}

int RecordingCommands::addCommand(const wchar_t* group, const wchar_t* globalName, const wchar_t* localName,
                                  int flags, TsEdCommandHandler handler, TsEdUIContext* uiContext,
                                  int functionCode, void* resources, TsEdCommand** command)
{
    recordingHost().journal.add(L"addCommand", {group, globalName, localName, flags, functionCode});
    TsEdCommand asked{.group = orEmpty(group),
                      .globalName = orEmpty(globalName),
                      .localName = orEmpty(localName),
                      .flags = flags,
                      .handler = handler,
                      .uiContext = uiContext,
                      .functionCode = functionCode,
                      .resources = resources,
                      .hasResult = command != nullptr,
                      .owner = recordingHost().loadedModules.applicationName};
    asked.status = answerToAdd ? *answerToAdd : statusOfAdding(asked);
    added.push_back(asked);
    if (answerToAdd || asked.status != TSED_COMMAND_OK)
        return asked.status;
    mCommands.push_back(std::make_unique<TsEdCommand>(asked));
    if (command)
        *command = mCommands.back().get();
    return TSED_COMMAND_OK;
}

int RecordingCommands::removeCommand(const wchar_t* group, const wchar_t* globalName)
{
    recordingHost().journal.add(L"removeCommand", {group, globalName});
    const auto gone = std::erase_if(mCommands, [&](const auto& command)
                                    { return isCommand(*command, orEmpty(group), orEmpty(globalName)); });
    return gone > 0 ? TSED_COMMAND_OK : TSED_COMMAND_UNKNOWN;
}

int RecordingCommands::removeGroup(const wchar_t* group)
{
    recordingHost().journal.add(L"removeGroup", {group});
    const auto gone = std::erase_if(mCommands, [&](const auto& command)
                                    { return tessel::equalIgnoringCase(command->group, orEmpty(group)); });
    return gone > 0 ? TSED_COMMAND_OK : TSED_COMMAND_UNKNOWN;
}

int RecordingCommands::describe(const std::wstring& group, const std::wstring& globalName,
                                const std::wstring& description)
{
    recordingHost().journal.add(L"tsedDescribeCommand", {group, globalName, description});
    return setLine(group, globalName, &TsEdCommand::description, description);
}

int RecordingCommands::takeArguments(const std::wstring& group, const std::wstring& globalName,
                                     const std::wstring& usage)
{
    recordingHost().journal.add(L"tsedTakeArguments", {group, globalName, usage});
    return setLine(group, globalName, &TsEdCommand::usage, usage);
}

int RecordingCommands::setLine(const std::wstring& group, const std::wstring& globalName,
                               std::wstring TsEdCommand::*line, const std::wstring& text)
{
    const bool isOneLine =
        std::none_of(text.begin(), text.end(),
                     [](wchar_t character) { return std::iswcntrl(static_cast<wint_t>(character)) != 0; });
    if (text.empty() || !isOneLine)
        return TSED_COMMAND_INVALID;
    for (const auto& command : mCommands)
        if (isCommand(*command, group, globalName))
        {
            (*command).*line = text;
            return TSED_COMMAND_OK;
        }
    return TSED_COMMAND_UNKNOWN;
}

int RecordingCommands::offerEntries(const std::wstring& group, const std::wstring& globalName,
                                    TsEdEntries entries)
{
    recordingHost().journal.add(L"tsedOfferEntries", {group, globalName});
    if (!entries)
        return TSED_COMMAND_INVALID;
    for (const auto& command : mCommands)
        if (isCommand(*command, group, globalName))
        {
            command->entries = entries;
            return TSED_COMMAND_OK;
        }
    return TSED_COMMAND_UNKNOWN;
}

std::vector<std::wstring> RecordingCommands::offered(const std::wstring& name,
                                                     const std::vector<std::wstring>& typed)
{
    const TsEdCommand* found = find(name);
    if (!found || !found->entries)
        return {};
    const RecordingCaller caller(found->owner);
    arguments = typed;
    TsResultBuffer* list = found->entries();
    arguments.clear();
    std::vector<std::wstring> texts;
    for (const TsResultBuffer* value = list; value; value = value->next)
        texts.emplace_back(value->value.string);
    tsutRelRb(list);
    return texts;
}

std::wstring RecordingCommands::descriptionOf(const std::wstring& globalName) const
{
    const TsEdCommand* found = find(L"_" + globalName);
    return found ? found->description : std::wstring();
}

const TsEdCommand* RecordingCommands::find(const std::wstring& typedName) const
{
    for (const auto& command : mCommands)
        if (tessel::equalIgnoringCase(command->localName, typedName) ||
            tessel::equalIgnoringCase(L"_" + command->globalName, typedName))
            return command.get();
    return nullptr;
}

int RecordingCommands::statusOfAdding(const TsEdCommand& command) const
{
    if (!isName(command.group) || !isName(command.globalName) || !isName(command.localName) ||
        !command.handler)
        return TSED_COMMAND_INVALID;
    const bool isTaken = std::any_of(mCommands.begin(), mCommands.end(),
                                     [&command](const auto& other)
                                     { return isCommand(*other, command.group, command.globalName); });
    return isTaken ? TSED_COMMAND_DUPLICATE : TSED_COMMAND_OK;
}

bool TsEdCommandStack::isKindOf(const wchar_t* className) const
{
    return className && std::wstring_view(className) == kClassName;
}

int tsedDescribeCommand(const wchar_t* group, const wchar_t* globalName, const wchar_t* description)
{
    return recordingHost().commands.describe(orEmpty(group), orEmpty(globalName), orEmpty(description));
}

int tsedTakeArguments(const wchar_t* group, const wchar_t* globalName, const wchar_t* usage)
{
    return recordingHost().commands.takeArguments(orEmpty(group), orEmpty(globalName), orEmpty(usage));
}

int tsedOfferEntries(const wchar_t* group, const wchar_t* globalName, TsEdEntries entries)
{
    return recordingHost().commands.offerEntries(orEmpty(group), orEmpty(globalName), entries);
}

TsResultBuffer* tsedCommandArguments()
{
    TsResultBuffer* list = nullptr;
    TsResultBuffer** end = &list;
    for (const std::wstring& argument : recordingHost().commands.arguments)
    {
        *end = tsutBuildList({TsRbValue::String(argument.c_str())});
        end = &(*end)->next;
    }
    return list;
}

void tsedFailCommand(const wchar_t* sentence)
{
    recordingHost().commands.failure = orEmpty(sentence);
}
