#include "host/ui/platform/gnustep/filepanel/FolderWatch.h"

#include <algorithm>
#include <cstdint>
#include <cstring>
#include <iterator>
#include <utility>

#include <linux/magic.h>
#include <sys/inotify.h>
#include <sys/vfs.h>
#include <unistd.h>

#include "host/ui/platform/gnustep/filepanel/Folders.h"

namespace tessel::filepanel
{
namespace
{
constexpr std::uint32_t kOther = IN_CREATE | IN_DELETE | IN_MOVED_FROM | IN_MOVED_TO;
constexpr std::uint32_t kWritten = IN_MODIFY | IN_CLOSE_WRITE | IN_ATTRIB;
constexpr std::uint32_t kGone = IN_DELETE_SELF | IN_MOVE_SELF;
constexpr std::size_t kMostAtOnce = std::size_t{16} * 1024; // bytes

// Folders of other computers, and those that the system makes up when somebody looks: nobody tells of
// changes.
constexpr std::uint32_t kSilent[] = {NFS_SUPER_MAGIC,  SMB_SUPER_MAGIC,  CIFS_SUPER_MAGIC, SMB2_SUPER_MAGIC,
                                     FUSE_SUPER_MAGIC, V9FS_MAGIC,       CEPH_SUPER_MAGIC, AFS_SUPER_MAGIC,
                                     CODA_SUPER_MAGIC, PROC_SUPER_MAGIC, SYSFS_MAGIC};

bool isSilent(const std::string& folder)
{
    struct statfs status;
    return statfs(folder.c_str(), &status) != 0 ||
           std::ranges::find(kSilent, static_cast<std::uint32_t>(status.f_type)) != std::end(kSilent);
}

FolderChanges changesOf(const inotify_event& event, const char* name, bool isOfFolder)
{
    FolderChanges changes;
    const bool isOfFile = isOfFolder && event.len > 0;
    if (isOfFile && (event.mask & kWritten))
        changes.written.emplace_back(name);
    const bool isOfFolderItself = isOfFolder && event.len == 0 && (event.mask & IN_ATTRIB);
    // When there was too much to tell, anything may have happened.
    changes.isOther = isOfFolderItself || (isOfFile && (event.mask & kOther)) ||
                      (event.mask & (kGone | IN_UNMOUNT | IN_Q_OVERFLOW));
    return changes;
}
} // namespace

void FolderChanges::add(FolderChanges more)
{
    isOther = isOther || more.isOther;
    std::ranges::move(more.written, std::back_inserter(written));
}

bool FolderWatch::start(const std::string& folder)
{
    stop();
    mDescriptor = inotify_init1(IN_NONBLOCK | IN_CLOEXEC);
    if (mDescriptor >= 0 && !isSilent(folder) && watch(folder))
        return true;
    stop();
    return false;
}

bool FolderWatch::watch(const std::string& folder)
{
    mFolder = inotify_add_watch(mDescriptor, folder.c_str(), kOther | kWritten | kGone | IN_ONLYDIR);
    bool isWatched = mFolder >= 0;
    for (std::string above = folder; isWatched && above != folderAbove(above);)
    {
        above = folderAbove(above);
        isWatched = inotify_add_watch(mDescriptor, above.c_str(), kGone | IN_MASK_ADD) >= 0;
    }
    return isWatched;
}

void FolderWatch::stop()
{
    if (mDescriptor >= 0)
        close(mDescriptor);
    mDescriptor = -1;
    mFolder = -1;
}

FolderChanges FolderWatch::take()
{
    FolderChanges changes;
    alignas(inotify_event) char events[kMostAtOnce];
    for (;;)
    {
        const auto length = read(mDescriptor, events, sizeof events);
        if (length <= 0)
            return changes;
        for (const char* at = events; at < events + length;)
        {
            inotify_event event;
            std::memcpy(&event, at, sizeof event);
            changes.add(changesOf(event, at + sizeof event, event.wd == mFolder));
            at += sizeof event + event.len;
        }
    }
}
} // namespace tessel::filepanel
