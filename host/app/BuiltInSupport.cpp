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
