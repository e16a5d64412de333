// Hears from the system what happens in a folder.
#pragma once

#include <string>
#include <vector>

namespace tessel::filepanel
{
struct FolderChanges
{
    bool isOther = false;             // files came or went, or the folder itself is somewhere else
    std::vector<std::string> written; // names of files that were changed where they are; some more than once

    void add(FolderChanges more);
};

class FolderWatch
{
public:
    FolderWatch() = default;
    ~FolderWatch() { stop(); }
    FolderWatch(const FolderWatch&) = delete;
    FolderWatch& operator=(const FolderWatch&) = delete;

    // Watches this folder instead of any other, and whether it stays where it is. Answers false where nothing
    // will be heard: the system has no more watches, or the folder is on another computer.
    bool start(const std::string& folder);
    void stop();

    // Can be read when something has happened; -1 when nothing is watched.
    int descriptor() const { return mDescriptor; }

    // What has happened since the last question.
    FolderChanges take();

private:
    bool watch(const std::string& folder);

    int mDescriptor = -1;
    int mFolder = -1; // the watch of the folder itself; the others are of those on the way
};
} // namespace tessel::filepanel
