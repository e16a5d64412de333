#include "host/platform/NetworkFolder.h"

#include <algorithm>
#include <array>

#include <sys/vfs.h>

namespace tessel
{
namespace
{
// Kinds of file systems by the numbers of statfs(2), which names them for the kernel's own headers only.
constexpr std::array<unsigned, 13> kNetworkKinds = {
    0x6969,     // NFS
    0x517B,     // SMB
    0xFF534D42, // CIFS
    0xFE534D42, // SMB 2
    0x65735546, // FUSE: sshfs and others
    0x01021997, // 9P
    0x5346414F, // AFS
    0x6B414653, // AFS of the kernel
    0x73757245, // Coda
    0x00C36400, // Ceph
    0x0BD00BD0, // Lustre
    0x786F4256, // folders of VirtualBox
    0x564C,     // NCP
};
} // namespace

bool isOnNetwork(const std::string& folder)
{
    struct statfs system = {};
    if (statfs(folder.c_str(), &system) != 0)
        return false;
    return std::ranges::find(kNetworkKinds, static_cast<unsigned>(system.f_type)) != kNetworkKinds.end();
}
} // namespace tessel
