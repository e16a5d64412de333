#include "host/app/BuiltInSupport.h"

#include <algorithm>

#include "host/Services.h"
#include "host/text/CommandLine.h"
#include "host/text/Unicode.h"

namespace tessel
{
void sayLine(const std::wstring& sentence)
{
    services().commandLine->say(sentence);
}

Result<> succeed(const std::wstring& sentence)
{
    sayLine(sentence);
    return {};
}

Failure wrongUsage(const std::wstring& command)
{
    const auto known = services().commands->descriptions();
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
