#include "host/commands/CommandRunner.h"

#include <exception>
#include <utility>

#include "host/commands/CallingApplication.h"
#include "host/commands/Command.h"
#include "host/commands/CommandTexts.h"
#include "host/commands/TypedLine.h"
#include "host/text/CommandLine.h"
#include "host/text/Nearest.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
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
    const TypedLine typed = takeApart(line);
    const CommandStack::Arguments parts = typed.allParts();
    if (parts.empty())
        return true;
    if (typed.last.isInQuotes)
        mCommandLine.warn(
            translated(L"The last quote in the line is not closed. What follows it was taken as {}.",
                       asPart(typed.last.text)));
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
} // namespace tessel
