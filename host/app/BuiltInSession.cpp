#include <algorithm>
#include <system_error>

#include "host/app/BuiltIn.h"
#include "host/app/BuiltInSupport.h"
#include "host/app/Parts.h"
#include "host/commands/CommandTexts.h"
#include "host/platform/SystemFailure.h"
#include "host/text/Nearest.h"
#include "host/text/Table.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
constexpr std::size_t kCommandColumn = 12;

Result<> listCommands(Parts& parts)
{
    Table table({kCommandColumn});
    table.addHeading(versionSentence());
    std::wstring group;
    for (const auto& command : parts.commands->descriptions())
    {
        if (!equalIgnoringCase(command.group, group))
            table.addHeading(inPersonsLanguage(command.group));
        group = command.group;
        table.add({command.name, inPersonsLanguage(command.summary)});
    }
    table.addHeading(translated(L"HELP and a name, such as HELP LOAD, tells how a command is typed."));
    parts.commandLine->show(table);
    return {};
}

void describeCommand(Parts& parts, const CommandStack::Description& command)
{
    Table table({});
    if (!command.summary.empty())
        table.addHeading(command.name + L": " + inPersonsLanguage(command.summary));
    for (const auto& line : usageLines(command.name, command.usage))
        table.addHeading(line);
    if (!command.example.empty())
        table.addHeading(translated(L"Example: {}", command.example));
    parts.commandLine->show(table);
}

// Of an application that is not loaded yet there is what the host has of its own to say, or whose it is.
void describeCommandToCome(Parts& parts, const std::wstring& name, const std::wstring& module)
{
    if (const CommandText* text = findCommandText(name))
        describeCommand(parts, CommandStack::descriptionOf(*text));
    else
        sayLine(
            parts,
            translated(L"The application {} is loaded when {} is typed, and HELP tells more about it then.",
                       module, name));
}

// False when no application is loaded by that name.
bool describeCommandToCome(Parts& parts, const std::wstring& typed)
{
    for (const auto& record : parts.records->all())
        for (const auto& [globalName, name] : record.commands)
            if (equalIgnoringCase(name, typed))
            {
                describeCommandToCome(parts, name, record.module);
                return true;
            }
    return false;
}

Failure noHelp(Parts& parts, const std::wstring& name, const Failure& noTopic)
{
    const auto meant = nearest(name, parts.commandNames());
    if (!meant)
        return noTopic;
    return {translated(L"There is no help on \"{}\". Did you mean {}?", name, *meant)};
}

// A name is that of a command, or else a topic of the help book.
Result<> help(Parts& parts, const CommandStack::Arguments& arguments)
{
    if (arguments.empty())
        return listCommands(parts);
    const std::wstring& name = arguments.front();
    const auto command = parts.commands->description(name);
    if (command)
        describeCommand(parts, *command);
    if (command || describeCommandToCome(parts, name))
        return {};
    const auto shown = parts.help->show(name);
    return shown ? succeed(parts, *shown) : noHelp(parts, name, shown.failure());
}

Result<> changeFolder(Parts& parts, const CommandStack::Arguments& arguments)
{
    const auto typed =
        arguments.empty() ? Result<std::wstring>(std::wstring()) : onlyFile(parts, L"CD", arguments);
    if (!typed)
        return typed.failure();
    std::error_code error;
    if (!typed->empty())
        std::filesystem::current_path(typedPath(*typed), error);
    if (error)
        return Failure{translated(L"The folder {} cannot be entered: {}.", *typed,
                                  systemFailure(error.value()).sentence)};
    const auto folder = std::filesystem::current_path(error);
    if (error)
        return Failure{translated(L"The current folder is gone.")};
    return succeed(parts, toText(folder));
}

Result<> tellVersion(Parts& parts, const CommandStack::Arguments& arguments)
{
    return arguments.empty() ? succeed(parts, versionSentence()) : wrongUsage(parts, L"VERSION");
}
} // namespace

void addSessionCommands(Parts& parts, SessionActions actions)
{
    const auto quit = [leave = std::move(actions.quit)](const auto&)
    {
        leave();
        return Result<>();
    };
    const auto script = [&parts, run = std::move(actions.runScript)](const CommandStack::Arguments& arguments)
    {
        const auto file = onlyFile(parts, L"SCRIPT", arguments);
        return file ? run(typedPath(*file)) : file.failure();
    };
    addBuiltIn(parts, L"HELP", help);
    addBuiltIn(parts, L"?", help);
    addBuiltIn(parts, L"QUIT", quit);
    addBuiltIn(parts, L"EXIT", quit);
    addBuiltIn(parts, L"SCRIPT", script);
    addBuiltIn(parts, L"CD", changeFolder);
    addBuiltIn(parts, L"VERSION", tellVersion);
}
} // namespace tessel
