// Why the store does not do what it was asked, in words for a person, and what helps. Used by the Registry's
// own files alone.
#pragma once

#include <sqlite3.h>

#include <string>

#include "host/text/Result.h"

namespace tessel
{
// The end of a sentence, in the system's words where the system is the reason. The code is the status, or the
// one that says more: SQLITE_FULL where there is no room, SQLITE_TOOBIG where a limit is in force,
// SQLITE_PERM, or a code of this kind, where rights are missing.
Failure storeFailure(sqlite3* database, int status);

// The same for a call of the system itself.
Failure fileFailure(int systemError);

bool isDamage(int code);

// What the disk did not give back; it may do so another time.
bool isUnreadable(int code);

// What may be so because nothing can be written where the file is.
bool isRefusal(int code);

// Codes of what the store itself does not tell.
inline constexpr int kOfAnotherProgram = SQLITE_AUTH;
inline constexpr int kOfANewerTessel = SQLITE_MISMATCH;
inline constexpr int kInTheWay = SQLITE_NOLFS; // what stands where a journal is to be

// What a person can do about a failure with that code, and begin the session again, or the command: one
// sentence. Nothing is known to help the command: empty.
std::wstring whatHelpsAtStart(int code);
std::wstring whatHelpsInSession(int code);
} // namespace tessel
