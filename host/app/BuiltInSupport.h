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

// Says that a command has done what it was to do; those who want it quiet know.
Result<> confirm(Parts& parts, const std::wstring& sentence);

// Says the sentence that a command was to find out.
Result<> succeed(Parts& parts, const std::wstring& sentence);

// How the command is to be typed.
Failure wrongUsage(const Parts& parts, const std::wstring& command);

// The path that was typed as an argument. A tilde at its beginning stands for a home folder, unless something
// has just that name.
std::filesystem::path typedPath(const std::wstring& typed);

// The one argument of a command that takes one file; otherwise how it is to be typed.
Result<std::wstring> onlyFile(const Parts& parts, const std::wstring& command,
                              const CommandStack::Arguments& arguments);

// Where the file is, along the host's search path; a file that is not found is looked for where the user is,
// so that what is said about it names a whole path.
std::wstring fullPath(const Parts& parts, const std::wstring& typed);

std::filesystem::path toPath(const std::wstring& text);
std::wstring toText(const std::filesystem::path& path);
} // namespace tessel
