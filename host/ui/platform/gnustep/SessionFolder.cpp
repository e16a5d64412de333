#include "host/ui/platform/gnustep/SessionFolder.h"

#include <cstdlib>
#include <string>

#include <fcntl.h>
#include <sys/file.h>
#include <sys/stat.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace tessel::windowing
{
namespace
{
constexpr char kStart[] = "tessel-";
constexpr char kPattern[] = "tessel-XXXXXX";
constexpr int kAttempts = 10;

// Another user's folder may look like one of ours, and lead to who knows where.
int openOwnFolder(const fs::path& path)
{
    const int folder = open(path.c_str(), O_RDONLY | O_DIRECTORY | O_NOFOLLOW | O_CLOEXEC);
    struct stat found = {};
    if (folder < 0 || (fstat(folder, &found) == 0 && found.st_uid == geteuid()))
        return folder;
    close(folder);
    return -1;
}

void removeIfLeft(const fs::path& path)
{
    const int folder = openOwnFolder(path);
    if (folder < 0)
        return;
    std::error_code ignored; // the next session tries again
    if (flock(folder, LOCK_EX | LOCK_NB) == 0)
        fs::remove_all(path, ignored);
    close(folder);
}

void removeWhatIsLeft(const fs::path& temporaryFiles)
{
    std::error_code ignored;
    for (fs::directory_iterator entry(temporaryFiles, ignored), end; entry != end; entry.increment(ignored))
        if (entry->path().filename().string().starts_with(kStart))
            removeIfLeft(entry->path());
}
} // namespace

SessionFolder::SessionFolder(const fs::path& temporaryFiles)
{
    removeWhatIsLeft(temporaryFiles);
    for (int attempt = 0; attempt < kAttempts; ++attempt)
        if (make(temporaryFiles))
            return;
}

SessionFolder::~SessionFolder()
{
    std::error_code ignored; // the next session tries again
    if (!mPath.empty())
        fs::remove_all(mPath, ignored);
    if (mLock >= 0)
        close(mLock);
}

bool SessionFolder::make(const fs::path& temporaryFiles)
{
    std::string name = (temporaryFiles / kPattern).string();
    if (!mkdtemp(name.data()))
        return false;
    const int folder = openOwnFolder(name);
    // Before it had its lock another session may have taken it for a left one.
    if (folder >= 0 && flock(folder, LOCK_EX) == 0 && fs::exists(name))
    {
        mPath = name;
        mLock = folder;
        return true;
    }
    if (folder >= 0)
        close(folder);
    return false;
}
} // namespace tessel::windowing
