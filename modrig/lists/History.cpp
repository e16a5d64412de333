#include "modrig/lists/History.h"

#include "modrig/lists/Globals.h"
#include "modrig/lists/StoredList.h"

namespace ModrigUtils
{
void InitializeHistoryFiles()
{
    ReadStoredList(kStoredHistory, gHistoryList, [](const CStdStr&) {});
}

void WriteHistoryFilesToRegistry()
{
    WriteStoredList(kStoredHistory, gHistoryList);
}
} // namespace ModrigUtils
