// Statements of the store that go through very much: a person is told, once, that this goes on. Used by the
// Registry's own files alone.
#pragma once

#include <sqlite3.h>

#include <string>

#include "host/registry/LongWork.h"

namespace tessel
{
// For as long as it lives; the database is not closed meanwhile.
class LongStatements
{
public:
    LongStatements(sqlite3* database, LongWork& work, std::wstring sentence);
    ~LongStatements();
    LongStatements(const LongStatements&) = delete;
    LongStatements& operator=(const LongStatements&) = delete;

private:
    static int look(void* object);

    sqlite3* mDatabase;
    LongWork& mWork;
    const std::wstring mSentence;
    bool mSaid = false;
};
} // namespace tessel
