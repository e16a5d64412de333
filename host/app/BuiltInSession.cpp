#include <algorithm>
#include <system_error>

#include "host/app/BuiltIn.h"
#include "host/app/BuiltInSupport.h"
#include "host/app/Parts.h"

namespace tessel
{
namespace
{
constexpr wchar_t kSessionGroup[] = L"Session";
constexpr std::size_t kUsageColumn = 49;

void sayCommand(Parts& parts, const CommandStack::Description& command)
{
    const std::wstring usage = command.name + (command.usage.empty() ? L"" : L" ") + command.usage;
    const bool isShort = usage.size() <= kUsageColumn;
    sayLine(parts, L"  " + (isShort && !command.summary.empty()
                                ? padded(usage, kUsageColumn) + L" " + command.summary
                                : usage));
    if (!isShort)
        sayLine(parts, std::wstring(kUsageColumn + 3, L' ') + command.summary);
}

Result<> listCommands(Parts& parts)
{
    sayLine(parts, toWide(versionLine()));
    std::wstring group;
    for (const auto& command : parts.commands->descriptions())
    {
        if (!equalIgnoringCase(command.group, group))
            sayLine(parts, command.group);
        group = command.group;
        sayCommand(parts, command);
    }
    return {};
}

// A name is that of a command, or else a topic of the help book.
Result<> help(Parts& parts, const CommandStack::Arguments& arguments)
{
    if (arguments.empty())
        return listCommands(parts);
    const auto known = parts.commands->descriptions();
    const auto found = std::ranges::find_if(known, [&](const auto& command)
                                            { return equalIgnoringCase(command.name, arguments.front()); });
    if (found == known.end())
    {
        const auto shown = parts.help->show(arguments.front());
        return shown ? succeed(parts, *shown) : shown.failure();
    }
    sayCommand(parts, *found);
    return {};
}

Result<> changeFolder(Parts& parts, const CommandStack::Arguments& arguments)
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
    return succeed(parts, toText(folder));
}

Result<> tellVersion(Parts& parts, const CommandStack::Arguments&)
{
    return succeed(parts, toWide(versionLine()));
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
        return arguments.size() == 1 ? run(toPath(arguments.front())) : wrongUsage(parts, L"SCRIPT");
    };
    addBuiltIn(parts,
               {kSessionGroup, L"HELP", L"[name]", L"Lists the commands, or tells about one or a help topic"},
               help);
    parts.commands->addBuiltIn({kSessionGroup, L"QUIT", L"", L"Ends the session"}, quit);
    parts.commands->addBuiltIn({kSessionGroup, L"EXIT", L"", L"Ends the session"}, quit);
    parts.commands->addBuiltIn({kSessionGroup, L"SCRIPT", L"file", L"Runs the commands in a file"}, script);
    addBuiltIn(parts, {kSessionGroup, L"CD", L"[folder]", L"Shows or changes the current folder"},
               changeFolder);
    addBuiltIn(parts, {kSessionGroup, L"VERSION", L"", L"Shows the version"}, tellVersion);
}
} // namespace tessel
