#include "host/app/BuiltInSupport.h"

#include <functional>
#include <utility>

#include "host/app/Parts.h"
#include "host/commands/CommandTexts.h"
#include "host/commands/TypedLine.h"
#include "host/files/TypedPath.h"
#include "host/text/Joined.h"
#include "host/text/Translation.h"

namespace tessel
{
void addBuiltIn(Parts& parts, const std::wstring& name, CommandStack::BuiltIn command)
{
    parts.commands->addBuiltIn(CommandStack::descriptionOf(*findCommandText(name)), std::move(command));
}

void addBuiltIn(Parts& parts, const std::wstring& name, BuiltInCommand* command)
{
    addBuiltIn(parts, name, CommandStack::BuiltIn(std::bind_front(command, std::ref(parts))));
}

void sayLine(Parts& parts, const std::wstring& sentence)
{
    parts.commandLine->say(sentence);
}

Result<> confirm(Parts& parts, const std::wstring& sentence)
{
    parts.commandLine->confirm(sentence);
    return {};
}

Result<> succeed(Parts& parts, const std::wstring& sentence)
{
    sayLine(parts, sentence);
    return {};
}

Failure wrongUsage(const Parts& parts, const std::wstring& command)
{
    return {usageText(command, parts.commands->description(command)->usage)};
}

std::filesystem::path typedPath(const std::wstring& typed)
{
    return withTilde(toPath(typed));
}

Result<std::wstring> onlyFile(const Parts& parts, const std::wstring& command,
                              const CommandStack::Arguments& arguments)
{
    if (arguments.size() == 1 && !arguments.front().empty())
        return arguments.front();
    const Failure usage = wrongUsage(parts, command);
    if (arguments.size() < 2)
        return usage;
    return Failure{usage.sentence + L"\n" +
                   translated(L"A name with blanks in it is typed in quotes: {}",
                              command + L" " + asPart(joined(arguments, L" ")))};
}

std::wstring fullPath(const Parts& parts, const std::wstring& typed)
{
    const auto meant = typedPath(typed);
    if (const auto found = parts.files->find(meant))
    {
        if (*found != meant)
            parts.commandLine->explain([&] { return translated(L"{} is the file {}.", typed, *found); });
        return toText(*found);
    }
    std::error_code currentFolderIsGone;
    const auto path = std::filesystem::absolute(meant, currentFolderIsGone);
    return toText(path.has_filename() ? path : path.parent_path());
}

std::filesystem::path toPath(const std::wstring& text)
{
    return toUtf8(text);
}

std::wstring toText(const std::filesystem::path& path)
{
    return toWide(path.string());
}
} // namespace tessel
