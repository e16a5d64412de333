#include "host/registry/LongStatements.h"

#include <utility>

namespace tessel
{
namespace
{
constexpr int kStepsBetweenLooks = 10'000; // of the store's own machine: less than a thousandth of a second
constexpr int kGoOn = 0;
constexpr int kStop = 1;
} // namespace

LongStatements::LongStatements(sqlite3* database, LongWork& work, std::wstring sentence,
                               IsUnwanted isUnwanted)
    : mDatabase(database), mWork(work), mSentence(std::move(sentence)), mIsUnwanted(std::move(isUnwanted))
{
    mWork.begin();
    sqlite3_progress_handler(mDatabase, kStepsBetweenLooks, look, this);
}

LongStatements::~LongStatements()
{
    sqlite3_progress_handler(mDatabase, 0, nullptr, nullptr);
}

int LongStatements::look(void* object)
{
    auto& self = *static_cast<LongStatements*>(object);
    if (self.mWork.isLong() && !std::exchange(self.mSaid, true))
        self.mWork.say(self.mSentence);
    return self.mIsUnwanted && self.mIsUnwanted() ? kStop : kGoOn;
}
} // namespace tessel
