// The dialog with a long History: opening its table, its window on the screen, and what it takes in memory.
#pragma once

#include <string>

void addHistoryDialogBenchmarks();

// What the program does when it starts itself again: one measurement, whose figure it prints. Answers what
// the program ends with.
int runHistoryPart(const std::string& part, std::size_t entries);
