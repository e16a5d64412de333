#include "host/commands/CommandRunner.h"

#include <exception>
#include <utility>

#include "host/commands/CallingApplication.h"
#include "host/commands/Command.h"
#include "host/commands/CommandTexts.h"
#include "host/text/CommandLine.h"
#include "host/text/Nearest.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr wchar_t kForPrograms[] = L"--json";

bool isBlank(wchar_t character)
{
    return character == L' ' || character == L'\t' || character == L'\r' || character == L'\n';
}

Failure failed(const std::wstring& name, const std::wstring& reason)
{
    return {translated(L"The command \"{}\" failed: {}", name, reason)};
}

Result<> callHandler(const TsEdCommand& command, const CommandStack::Arguments& arguments,
                     CallingApplication& calls)
{
    CommandCall typed{arguments};
    const CallingApplication::Scope calling(calls, command.owner, RunningMarker::Deed::kCommand,
                                            command.localName, &typed);
    command.handler();
    if (!typed.failure)
        return {};
    return Failure{typed.failure->empty() ? usageText(command.localName, command.usage) : *typed.failure};
}

CommandStack::Arguments takeTexts(TsResultBuffer* list)
{
    CommandStack::Arguments texts;
    for (const TsResultBuffer* value = list; value; value = value->next)
        if (value->type == TS_STRING && value->value.string)
            texts.emplace_back(value->value.string);
    tsutRelRb(list);
    return texts;
}

// What runs here may come from anybody's application: whatever it throws ends with the command.
Result<> call(const TsEdCommand& command, const CommandStack::Arguments& arguments, CallingApplication& calls)
{
    try
    {
        if (command.listing && !arguments.empty() && arguments.back() == kForPrograms)
            return command.listing({arguments.begin(), arguments.end() - 1});
        if (command.builtIn)
            return command.builtIn(arguments);
        if (!arguments.empty() && command.usage.empty())
            return failed(command.localName, translated(L"it takes no arguments."));
        return callHandler(command, arguments, calls);
    }
    catch (const std::exception& error)
    {
        return failed(command.localName, toWide(error.what()));
    }
    catch (...)
    {
        return failed(command.localName,
                      translated(L"it threw something that is not an error of the standard library."));
    }
}
} // namespace

CommandRunner::CommandRunner(const CommandStack& commands, CommandLine& commandLine,
                             CallingApplication& calls, Loader loader, AfterLine afterLine, Names names)
    : mCommands(commands), mCommandLine(commandLine), mCalls(calls), mLoader(std::move(loader)),
      mAfterLine(std::move(afterLine)), mNames(std::move(names))
{
}

bool CommandRunner::run(std::wstring_view line)
{
    const CommandStack::Arguments parts = splitLine(line);
    if (parts.empty())
        return true;
    const bool done = mCommandLine.tell(runParts(parts));
    const bool finished = !mAfterLine || mAfterLine();
    return done && finished;
}

Result<> CommandRunner::runParts(const CommandStack::Arguments& parts) const
{
    // Kept alive here: the handler may unload the application and so remove its own command.
    if (const CommandStack::Command command = findOrLoad(parts.front()))
        return call(*command, CommandStack::Arguments(parts.begin() + 1, parts.end()), mCalls);
    return unknown(parts.front());
}

CommandStack::Arguments CommandRunner::entries(const CommandStack::Arguments& parts) const
{
    const CommandStack::Command command = findOrLoad(parts.front());
    if (!command || !command->entries)
        return {};
    const CommandStack::Arguments arguments(parts.begin() + 1, parts.end());
    CommandCall typed{arguments};
    const CallingApplication::Scope calling(mCalls, command->owner, RunningMarker::Deed::kCommand,
                                            command->localName, &typed);
    try
    {
        return takeTexts(command->entries());
    }
    catch (...) // nobody asked for more than a help with typing
    {
        return {};
    }
}

Failure CommandRunner::unknown(const std::wstring& typedName) const
{
    const auto meant = nearest(typedName, mNames ? mNames() : mCommands.names());
    if (!meant)
        return {translated(L"Unknown command \"{}\". Type HELP for the list of commands.", typedName)};
    return {translated(L"Unknown command \"{}\". Did you mean {}? Type HELP for the list of commands.",
                       typedName, *meant)};
}

CommandStack::Command CommandRunner::findOrLoad(const std::wstring& typedName) const
{
    CommandStack::Command command = mCommands.find(typedName);
    if (!command && mLoader && mLoader(typedName))
        command = mCommands.find(typedName);
    return command;
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

bool isForPrograms(std::wstring_view line)
{
    const CommandStack::Arguments parts = splitLine(line);
    return parts.size() > 1 && parts.back() == kForPrograms;
}

std::wstring asPart(std::wstring_view text)
{
    std::wstring part = L"\"";
    for (const wchar_t character : text)
        part += character == L'"' ? std::wstring(L"\"\"") : std::wstring(1, character);
    return part + L"\"";
}
} // namespace tessel
