#include "host/app/BuiltInSupport.h"

#include <algorithm>
#include <functional>

#include "host/app/Parts.h"

namespace tessel
{
void addBuiltIn(Parts& parts, const CommandStack::Description& description, BuiltInCommand* command)
{
    parts.commands->addBuiltIn(description, std::bind_front(command, std::ref(parts)));
}

void sayLine(Parts& parts, const std::wstring& sentence)
{
    parts.commandLine->say(sentence);
}

Result<> succeed(Parts& parts, const std::wstring& sentence)
{
    sayLine(parts, sentence);
    return {};
}

Failure wrongUsage(const Parts& parts, const std::wstring& command)
{
    const auto known = parts.commands->descriptions();
    const auto found = std::ranges::find_if(known, [&](const auto& entry) { return entry.name == command; });
    return {L"Usage: " + command + L" " + (found == known.end() ? L"" : found->usage)};
}

std::wstring fullPath(const Parts& parts, const std::wstring& typed)
{
    if (const auto found = parts.files->find(toPath(typed)))
        return toText(*found);
    std::error_code currentFolderIsGone;
    const auto path = std::filesystem::absolute(toPath(typed), currentFolderIsGone);
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

std::wstring padded(std::wstring text, std::size_t width)
{
    text.resize(std::max(text.size(), width), L' ');
    return text;
}
} // namespace tessel
