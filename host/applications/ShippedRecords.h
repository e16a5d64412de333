// The records of applications that come with the host: they stand beside the plug-ins, in registry files, so
// that an application which waits for its commands need not be loaded once to tell of them.
#pragma once

#include <filesystem>
#include <string>
#include <vector>

#include "host/applications/ApplicationRecords.h"
#include "host/commands/CommandStack.h"

namespace tessel
{
struct ShippedRecord
{
    ApplicationRecord record;
    std::vector<CommandStack::Description> commands; // as `HELP` tells of them
};

// From the files `*.reg` in the folder, by name. `Module` is a file of that folder. Beside what every record
// has, such a one may have a `Group` and the keys `Usage` and `Summaries` with a value for each command. A
// record that is not whole is passed over.
std::vector<ShippedRecord> readShippedRecords(const std::filesystem::path& folder,
                                              const std::wstring& productRoot);
} // namespace tessel
