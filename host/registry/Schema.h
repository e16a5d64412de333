// The tables of a registry's file, and the checksum that stands in each of their rows. Used by the Registry's
// own files alone.
#pragma once

#include <sqlite3.h>

#include <cstdint>
#include <string>

#include "host/text/Result.h"

namespace tessel
{
inline constexpr int kSchemaVersion = 2;
inline constexpr int kVersionWithoutChecksums = 1;

// Lets statements call row_sum(...): the checksum of what it is given, numbers and texts in their order.
// Answers the store's status.
int addChecksum(sqlite3* database);

// Whether the tables are those of this version and nothing stands beside them: what somebody else has put
// there, such as a trigger, could run with the next write. Why not is the end of a sentence; the codes are
// the store's.
Result<> checkTables(sqlite3* database, int version);

// Makes the tables in a file that is empty, unless another process has by now; or gives the rows of an older
// version their checksums, in one transaction. Both need `addChecksum`.
Result<> makeTables(sqlite3* database);
Result<> addChecksums(sqlite3* database);

// The bytes of a new registry.
Result<std::string> emptyRegistry();

// The first number or text that a statement answers; the codes are the store's.
Result<std::int64_t> firstNumber(sqlite3* database, const char* sql);
Result<std::wstring> firstText(sqlite3* database, const char* sql);
} // namespace tessel
