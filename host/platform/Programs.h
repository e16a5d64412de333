// Other programs, looked for along PATH and started without a shell. But for those that show something they
// have nothing to do with the terminal: there is nothing for them to read, what they complain of goes
// nowhere, and Ctrl-C at the prompt is not for them.
#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace tessel
{
// A program's name and its arguments.
using ProgramWords = std::vector<std::string>;

// Starts the program and leaves it to itself. False when there is no such program.
bool startProgram(ProgramWords words);

// Waits for the program's end and answers what it has written; nothing when there is no such program.
std::string outputOfProgram(ProgramWords words);

// Gives the program the terminal and the text to read, and waits for its end. Answers its status as `waitpid`
// has it; nothing when there is no such program.
std::optional<int> showByProgram(ProgramWords words, std::string_view text);
} // namespace tessel
