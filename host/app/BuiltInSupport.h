// What the host's own commands share.
#pragma once

#include <filesystem>
#include <string>

#include "host/commands/CommandStack.h"
#include "host/text/Result.h"

namespace tessel
{
struct Parts;

using BuiltInCommand = Result<>(Parts& parts, const CommandStack::Arguments& arguments);

// Adds a command of the host, which `CommandTexts` has a row about.
void addBuiltIn(Parts& parts, const std::wstring& name, CommandStack::BuiltIn command);
// The same with one that works on the parts.
void addBuiltIn(Parts& parts, const std::wstring& name, BuiltInCommand* command);

void sayLine(Parts& parts, const std::wstring& sentence);

// Says the sentence with which a command ends well.
Result<> succeed(Parts& parts, const std::wstring& sentence);

// The ways in which a command is typed, a line each, the first after the label.
std::vector<std::wstring> usageLines(const CommandStack::Description& command);
// The same for who has typed it otherwise.
Failure wrongUsage(const Parts& parts, const std::wstring& command);

// Where the file is, along the host's search path; a file that is not found is looked for where the user is,
// so that what is said about it names a whole path.
std::wstring fullPath(const Parts& parts, const std::wstring& typed);

std::filesystem::path toPath(const std::wstring& text);
std::wstring toText(const std::filesystem::path& path);
} // namespace tessel
