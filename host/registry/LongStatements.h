// Statements of the store that go through very much: a person is told, once, that this goes on. Used by the
// Registry's own files alone.
#pragma once

#include <sqlite3.h>

#include <chrono>
#include <string>

#include "host/registry/LongWork.h"

namespace tessel
{
// For as long as it lives; the database is not closed meanwhile.
class LongStatements
{
public:
    LongStatements(sqlite3* database, const LongWork& work, std::wstring sentence);
    ~LongStatements();
    LongStatements(const LongStatements&) = delete;
    LongStatements& operator=(const LongStatements&) = delete;

private:
    static int look(void* object);

    sqlite3* mDatabase;
    const LongWork& mWork;
    const std::wstring mSentence;
    const std::chrono::steady_clock::time_point mEnd; // of patience
    bool mSaid = false;
};
} // namespace tessel
