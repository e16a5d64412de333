// The dialog with a long History: opening its table, its window on the screen, and what it takes in memory.
#pragma once

#include <cstddef>
#include <string>

#include <sys/types.h>

// `display`: the process of the display, 0 when that is not ours.
void addHistoryDialogBenchmarks(pid_t display);

// What the program does when it starts itself again: one part of it, whose figure it tells. Answers what it
// ends with.
int runHistoryPart(const std::string& part, std::size_t entries, pid_t display);
