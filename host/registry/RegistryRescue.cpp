// The copy of a registry's last sound state, and what takes the place of one that is damaged.
#include <sqlite3.h>

#include "host/registry/Journals.h"
#include "host/registry/Registry.h"
#include "host/registry/SoundCopy.h"
#include "host/registry/StoreFailure.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
bool isNewer(const std::filesystem::path& file, const std::filesystem::path& other)
{
    std::error_code missing;
    const auto time = std::filesystem::last_write_time(file, missing);
    return !missing && time > std::filesystem::last_write_time(other, missing) && !missing;
}

bool standsThere(const std::filesystem::path& file)
{
    std::error_code missing;
    return std::filesystem::exists(file, missing);
}
} // namespace

// Found when the file was looked at as a whole: it is damaged, or the look itself failed.
Failure Registry::whatIsWrong(const Failure& found)
{
    if (!isDamage(found.code))
        return unreadable(found);
    mDamaged = true;
    return {L"The registry " + toWide(mFile.string()) + L" is damaged: " + found.sentence +
                L". It was left as it is, and nothing will be stored. " + helpAgainstDamage(mFile),
            ERROR_ACCESS_DENIED};
}

// A disk that does not answer may do so the next time.
std::wstring Registry::whatHelps(int code)
{
    if (isDamage(code))
        return helpAgainstDamage(mFile);
    if (!isUnreadable(code))
        return whatHelpsAtStart(code);
    mUnreadable = true;
    return whatHelpsAtStart(code) + L" If that does not help: " + helpAgainstDamage(mFile);
}

// A session that ended in good order has made its copy; one that did not has left the file newer than that.
void Registry::renewCopy(bool changed)
{
    if (!mLookedAt || !mCanStore || mReadOnly)
        return;
    const auto copy = soundCopyOf(mFile);
    mHasStored =
        changed || (mLeftOpen && (!standsThere(copy) || isNewer(mFile, copy) || isNewer(logOf(mFile), copy)));
    static_cast<void>(keepCopy()); // the session's end makes it, and tells
}

Result<> Registry::keepCopy()
{
    if (!mDatabase || !mCanStore || !mLookedAt || !mHasStored)
        return {};
    const auto made = makeSoundCopy(mDatabase, mFile);
    mHasStored = !made;
    return made ? made
                : Failure{L"The copy of the registry " + toWide(mFile.string()) + L" could not be made: " +
                          made.sentence() + L"."};
}

Result<> Registry::checkIsDamaged() const
{
    if (mDamaged || mUnreadable)
        return {};
    return Failure{L"The registry " + toWide(mFile.string()) +
                   L" is not known to be damaged; it was left as it is."};
}

Result<std::wstring> Registry::restoreCopy()
{
    if (const auto damaged = checkIsDamaged(); !damaged)
        return damaged.failure();
    const std::wstring time = timeOfCopy(mFile);
    const auto kept = replaceWith(putSoundCopyBack);
    if (!kept)
        return kept.failure();
    return L"The registry " + toWide(mFile.string()) + L" was restored from the copy of " + time + *kept;
}

Result<std::wstring> Registry::beginEmpty()
{
    if (const auto damaged = checkIsDamaged(); !damaged)
        return damaged.failure();
    if (const auto sound = checkSoundCopy(mFile))
        return Failure{L"The registry " + toWide(mFile.string()) + L" was left as it is: " +
                       helpAgainstDamage(mFile)};
    const auto kept = replaceWith(setAside);
    if (!kept)
        return kept.failure();
    return L"The registry " + toWide(mFile.string()) + L" is empty now" + *kept;
}

// Answers the end of the sentence about it. What applications have read is not what is there now.
Result<std::wstring>
Registry::replaceWith(Result<std::filesystem::path> (*replace)(const std::filesystem::path&))
{
    forgetAll();
    close();
    const auto kept = replace(mFile);
    mCanStore = {};
    mNotice.reset();
    open();
    if (!kept)
        return kept.failure();
    mCanStore = Failure{L"Nothing is stored in the registry " + toWide(mFile.string()) +
                            L" before Tessel is started again, since another one was put in its place.",
                        ERROR_ACCESS_DENIED};
    return (kept->empty() ? L"" : L"; what stood there is kept as " + toWide(kept->string())) +
           std::wstring(L". Start Tessel again: this session stores nothing more.");
}
} // namespace tessel
