#include <algorithm>
#include <system_error>

#include "host/Services.h"
#include "host/app/BuiltIn.h"
#include "host/app/BuiltInSupport.h"
#include "host/messages/Help.h"
#include "host/text/Unicode.h"
#include "host/text/Version.h"

namespace tessel
{
namespace
{
constexpr wchar_t kGroup[] = L"Session";
constexpr std::size_t kUsageColumn = 50;

void sayCommand(const CommandStack::Description& command)
{
    const std::wstring usage = command.name + (command.usage.empty() ? L"" : L" ") + command.usage;
    sayLine(L"  " + (command.summary.empty() ? usage : padded(usage, kUsageColumn) + command.summary));
}

Result<> listCommands()
{
    std::wstring group;
    for (const auto& command : services().commands->descriptions())
    {
        if (!equalIgnoringCase(command.group, group))
            sayLine(command.group);
        group = command.group;
        sayCommand(command);
    }
    return {};
}

// A name is that of a command, or else a topic of the help book.
Result<> help(const CommandStack::Arguments& arguments)
{
    if (arguments.empty())
        return listCommands();
    const auto known = services().commands->descriptions();
    const auto found = std::ranges::find_if(known, [&](const auto& command)
                                            { return equalIgnoringCase(command.name, arguments.front()); });
    if (found == known.end())
    {
        const auto shown = services().help->show(arguments.front());
        return shown ? succeed(*shown) : shown.failure();
    }
    sayCommand(*found);
    return {};
}

Result<> changeFolder(const CommandStack::Arguments& arguments)
{
    std::error_code error;
    if (!arguments.empty())
        std::filesystem::current_path(toPath(arguments.front()), error);
    if (error)
        return Failure{L"The folder " + arguments.front() + L" cannot be entered: " +
                       toWide(error.message()) + L"."};
    const auto folder = std::filesystem::current_path(error);
    if (error)
        return Failure{L"The current folder is gone."};
    return succeed(toText(folder));
}
} // namespace

void addSessionCommands(CommandStack& commands, SessionActions actions)
{
    const auto quit = [leave = std::move(actions.quit)](const auto&)
    {
        leave();
        return Result<>();
    };
    const auto script = [run = std::move(actions.runScript)](const CommandStack::Arguments& arguments)
    {
        return arguments.size() == 1 ? run(toPath(arguments.front())) : wrongUsage(L"SCRIPT");
    };
    const auto version = [](const auto&)
    {
        return succeed(toWide(kVersionLine));
    };
    commands.addBuiltIn(
        {kGroup, L"HELP", L"[name]", L"Lists the commands, or tells about one or a help topic"}, help);
    commands.addBuiltIn({kGroup, L"QUIT", L"", L"Ends the session"}, quit);
    commands.addBuiltIn({kGroup, L"EXIT", L"", L"Ends the session"}, quit);
    commands.addBuiltIn({kGroup, L"SCRIPT", L"file", L"Runs the commands in a file"}, script);
    commands.addBuiltIn({kGroup, L"CD", L"[folder]", L"Shows or changes the current folder"}, changeFolder);
    commands.addBuiltIn({kGroup, L"VERSION", L"", L"Shows the version"}, version);
}
} // namespace tessel
