#include "lists/History.h"

#include "lists/StoredList.h"
#include "module/Globals.h"

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
