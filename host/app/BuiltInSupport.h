// What the host's own commands share.
#pragma once

#include <filesystem>
#include <string>

#include "host/commands/CommandStack.h"

namespace tessel
{
void sayLine(const std::wstring& sentence);

// Says the sentence and answers whether the command succeeded: its end.
bool succeed(const std::wstring& sentence);
bool fail(const std::wstring& sentence);

// Says how the command is to be typed, and answers false.
bool failWithUsage(const std::wstring& command);

std::filesystem::path toPath(const std::wstring& text);
std::wstring toText(const std::filesystem::path& path);

// The text, filled up with blanks to the width of a column.
std::wstring padded(std::wstring text, std::size_t width);
} // namespace tessel
