// Statements of the store that go through very much: a person is told, once, that this goes on, and may be
// able to stop it. Used by the Registry's own files alone.
#pragma once

#include <sqlite3.h>

#include <functional>
#include <string>

#include "host/registry/LongWork.h"

namespace tessel
{
// For as long as it lives; the database is not closed meanwhile.
class LongStatements
{
public:
    using IsUnwanted = std::function<bool()>;

    // A statement that has become unwanted fails with SQLITE_INTERRUPT; none does without the function.
    LongStatements(sqlite3* database, LongWork& work, std::wstring sentence, IsUnwanted isUnwanted);
    ~LongStatements();
    LongStatements(const LongStatements&) = delete;
    LongStatements& operator=(const LongStatements&) = delete;

private:
    static int look(void* object);

    sqlite3* mDatabase;
    LongWork& mWork;
    const std::wstring mSentence;
    const IsUnwanted mIsUnwanted;
    bool mSaid = false;
};
} // namespace tessel
