// What the host's own commands share.
#pragma once

#include <filesystem>
#include <string>

#include "host/commands/CommandStack.h"
#include "host/text/Result.h"

namespace tessel
{
struct Parts;

// Under which `HELP` lists the commands that load and keep out.
inline constexpr wchar_t kApplicationsGroup[] = L"Applications";

using BuiltInCommand = Result<>(Parts& parts, const CommandStack::Arguments& arguments);

// Adds a command that works on the parts.
void addBuiltIn(Parts& parts, const CommandStack::Description& description, BuiltInCommand* command);

void sayLine(Parts& parts, const std::wstring& sentence);

// Says the sentence with which a command ends well.
Result<> succeed(Parts& parts, const std::wstring& sentence);

// How the command is to be typed.
Failure wrongUsage(const Parts& parts, const std::wstring& command);

// Where the file is, along the host's search path; a file that is not found is looked for where the user is,
// so that what is said about it names a whole path.
std::wstring fullPath(const Parts& parts, const std::wstring& typed);

std::filesystem::path toPath(const std::wstring& text);
std::wstring toText(const std::filesystem::path& path);

// The text, filled up with blanks to the width of a column.
std::wstring padded(std::wstring text, std::size_t width);
} // namespace tessel
