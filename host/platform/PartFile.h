// A file that comes into being under a name of its own, and takes its place when all of it is there.
#pragma once

#include <filesystem>
#include <string>
#include <string_view>

#include "host/platform/Descriptor.h"
#include "host/text/Result.h"

namespace tessel
{
// Nobody else can have made the file, and only the person can read it. A part that has not taken its place is
// removed at the end; a lock tells what a running process writes from what a killed one has left.
class PartFile
{
public:
    // In that folder, which is on the same file system as the place where the file will stand.
    explicit PartFile(const std::filesystem::path& folder);
    ~PartFile();
    PartFile(const PartFile&) = delete;
    PartFile& operator=(const PartFile&) = delete;

    // Why it could not be made; the system's words.
    const Result<>& made() const { return mMade; }

    // Both fail with the system's words.
    Result<> write(std::string_view bytes);
    // Gives others the rights that they have to the file at the place, or, where none stands, those that are
    // usual for the person's new files.
    Result<> letOthersRead(const std::filesystem::path& place);

    // Puts it in place of what stands there: from then on all of it is on the disk, by that name. Fails with
    // the system's words.
    Result<> moveTo(const std::filesystem::path& place);

    // The same where nothing stands; what does stand there stays, and all is well.
    Result<> moveToOnce(const std::filesystem::path& place);

    // Removes what killed processes have left in the folder.
    static void clearLeftOvers(const std::filesystem::path& folder);

private:
    void make(const std::filesystem::path& folder);
    Result<> name(const std::filesystem::path& place, int (*naming)(const char* part, const char* place));

    Result<> mMade;
    std::string mPath; // empty when there is nothing to remove
    Descriptor mFile{-1};
};

// The file at that place holds these bytes, or what it held before, whatever happens meanwhile; the person
// alone can read it. Clears left-overs away. Fails with the system's words.
Result<> replaceFile(const std::filesystem::path& place, std::string_view bytes);

// The same for a file that the person has named: others may read it as they could read what stood there, or
// as is usual for new files.
Result<> replacePersonsFile(const std::filesystem::path& place, std::string_view bytes);
} // namespace tessel
