// Other programs, looked for along PATH and started without a shell. They have nothing to do with the
// terminal: there is nothing for them to read, what they complain of goes nowhere, and Ctrl-C at the prompt
// is not for them.
#pragma once

#include <string>
#include <vector>

namespace tessel
{
// A program's name and its arguments.
using ProgramWords = std::vector<std::string>;

// Starts the program and leaves it to itself. False when there is no such program.
bool startProgram(ProgramWords words);

// Waits for the program's end and answers what it has written; nothing when there is no such program.
std::string outputOfProgram(ProgramWords words);
} // namespace tessel
