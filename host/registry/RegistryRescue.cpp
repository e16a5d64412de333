// The copy of a registry's last sound state, and what takes the place of one that is damaged.
#include <sqlite3.h>

#include "host/registry/Journals.h"
#include "host/registry/Registry.h"
#include "host/registry/SoundCopy.h"
#include "host/registry/StoreFailure.h"
#include "host/text/Translation.h"

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
    return {
        translated(L"The registry {} is damaged: {}. It was left as it is, and nothing will be stored. {}",
                   mFile, found.sentence, helpAgainstDamage(mFile)),
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
    return translated(L"{} If that does not help: {}", whatHelpsAtStart(code), helpAgainstDamage(mFile));
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
                : Failure{translated(L"The copy of the registry {} could not be made: {}.", mFile,
                                     made.sentence())};
}

Result<> Registry::checkIsDamaged() const
{
    if (mDamaged || mUnreadable)
        return {};
    return Failure{translated(L"The registry {} is not known to be damaged; it was left as it is.", mFile)};
}

Result<std::wstring> Registry::restoreCopy()
{
    if (const auto damaged = checkIsDamaged(); !damaged)
        return damaged.failure();
    const std::wstring time = timeOfCopy(mFile);
    const auto kept = replaceWith(putSoundCopyBack);
    if (!kept)
        return kept.failure();
    return kept->empty() ? translated(L"The registry {} was restored from the copy of {}. Start Tessel "
                                      L"again: this session stores nothing more.",
                                      mFile, time)
                         : translated(L"The registry {} was restored from the copy of {}; what stood there "
                                      L"is kept as {}. Start Tessel again: this session stores nothing more.",
                                      mFile, time, *kept);
}

Result<std::wstring> Registry::beginEmpty()
{
    if (const auto damaged = checkIsDamaged(); !damaged)
        return damaged.failure();
    if (const auto sound = checkSoundCopy(mFile))
        return Failure{translated(L"The registry {} was left as it is: {}", mFile, helpAgainstDamage(mFile))};
    const auto kept = replaceWith(setAside);
    if (!kept)
        return kept.failure();
    return kept->empty()
               ? translated(
                     L"The registry {} is empty now. Start Tessel again: this session stores nothing more.",
                     mFile)
               : translated(L"The registry {} is empty now; what stood there is kept as {}. Start Tessel "
                            L"again: this session stores nothing more.",
                            mFile, *kept);
}

// Answers where what stood there is kept, if anything did. What applications have read is not what is there
// now.
Result<std::filesystem::path>
Registry::replaceWith(Result<std::filesystem::path> (*replace)(const std::filesystem::path&))
{
    forgetAll();
    close();
    auto kept = replace(mFile);
    mCanStore = {};
    mNotice.reset();
    open();
    if (kept)
        mCanStore = Failure{translated(L"Nothing is stored in the registry {} before Tessel is started "
                                       L"again, since another one was put in its place.",
                                       mFile),
                            ERROR_ACCESS_DENIED};
    return kept;
}
} // namespace tessel
