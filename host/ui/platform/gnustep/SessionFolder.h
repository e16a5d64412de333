// A folder for what serves this session alone.
#pragma once

#include <filesystem>

namespace tessel::windowing
{
// Made for this user only, in the folder for temporary files, and removed when its owner goes. What killed
// sessions left there is removed too: a session that runs holds a lock, and the system releases that of one
// that is gone.
class SessionFolder
{
public:
    explicit SessionFolder(const std::filesystem::path& temporaryFiles);
    ~SessionFolder();
    SessionFolder(const SessionFolder&) = delete;
    SessionFolder& operator=(const SessionFolder&) = delete;

    // Empty when it cannot be made.
    const std::filesystem::path& path() const { return mPath; }

private:
    bool make(const std::filesystem::path& temporaryFiles);

    std::filesystem::path mPath;
    int mLock = -1;
};
} // namespace tessel::windowing
