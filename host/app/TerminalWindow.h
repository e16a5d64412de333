// Tessel is a program of the terminal. A desktop that starts it without one gets a window of its terminal
// with Tessel in it.
#pragma once

#include <sys/types.h>

#include "host/platform/Programs.h"

namespace tessel
{
// What a program finds at its start.
struct ProgramStart
{
    int words = 0; // of the command line, its own name among them
    pid_t parent = 0;
    bool hasInput = false; // more than the file that is always empty
    bool hasScreen = false;
};

// Of this program.
ProgramStart startOfProgram(int words);

// Lets what these words start go on in a window of a terminal when a desktop did it. No words: this
// platform's desktops give their programs a terminal themselves. False when the program is to go on by
// itself.
[[nodiscard]] bool goesOnInTerminal(const ProgramStart& start, const ProgramWords& words);
} // namespace tessel
