// A list as applications keep it in the registry: a count and numbered values, rewritten as a whole. All
// values of one writing carry its generation, so that a torn list shows.
#pragma once

#include <filesystem>
#include <string>

#include "host/registry/Registry.h"

// Removes the old list and writes `count` entries and the count, value by value. False at the first write
// that failed; the command is left to be ended by the caller.
bool rewriteList(tessel::Registry& registry, int generation, int count, std::size_t entryLength = 60);

// The second half of it.
bool writeList(tessel::Registry& registry, int generation, int count, std::size_t entryLength = 60);

// The key of the list.
extern const wchar_t* const kListKey;

// The generation of the stored list when it is whole and nothing else stands beside it, 0 when there is
// none, and -1 when it is torn.
int generationOf(tessel::Registry& registry);

// The same of the file as it is at one moment, however long the look takes.
int generationInOneLook(const std::filesystem::path& file);
