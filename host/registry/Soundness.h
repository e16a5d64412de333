// The full look at a registry's file: whether every page, every index and every row is what was written.
// Used by the Registry's own files alone.
#pragma once

#include <sqlite3.h>

#include "host/text/Result.h"

namespace tessel
{
// Looks at all of it, with the checksums of the rows where the version has them; needs `addChecksum`. What is
// damaged is the end of a sentence. The codes are the store's.
Result<> checkSoundness(sqlite3* database, int version);

// How many starts may pass between two looks, so that they cost less than a tenth of the starts' time: 1 up
// to some thousand values.
unsigned startsBetweenLooks(sqlite3* database);
} // namespace tessel
