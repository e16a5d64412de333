#include "host/registry/LongStatements.h"

#include <utility>

namespace tessel
{
namespace
{
constexpr int kStepsBetweenLooks = 10'000; // of the store's own machine: less than a thousandth of a second
constexpr int kGoOn = 0;
} // namespace

LongStatements::LongStatements(sqlite3* database, const LongWork& work, std::wstring sentence)
    : mDatabase(database), mWork(work), mSentence(std::move(sentence)),
      mEnd(std::chrono::steady_clock::now() + LongWork::kPatience)
{
    sqlite3_progress_handler(mDatabase, kStepsBetweenLooks, look, this);
}

LongStatements::~LongStatements()
{
    sqlite3_progress_handler(mDatabase, 0, nullptr, nullptr);
}

int LongStatements::look(void* object)
{
    auto& self = *static_cast<LongStatements*>(object);
    if (self.mSaid || std::chrono::steady_clock::now() < self.mEnd)
        return kGoOn;
    self.mSaid = true;
    self.mWork.say(self.mSentence);
    return kGoOn;
}
} // namespace tessel
