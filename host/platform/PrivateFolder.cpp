#include "host/platform/PrivateFolder.h"

#include <cerrno>
#include <system_error>

#include <sys/stat.h>
#include <unistd.h>

#include "host/platform/SystemFailure.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
constexpr mode_t kForThePersonAlone = 0700;
constexpr uid_t kAdministrator = 0; // could write anything anyway

bool isFolder(const std::filesystem::path& path)
{
    std::error_code unreachable;
    return std::filesystem::is_directory(path, unreachable);
}
} // namespace

Result<> makePrivateFolder(const std::filesystem::path& folder)
{
    const auto itself = folder.has_filename() ? folder : folder.parent_path();
    std::error_code error;
    if (itself.has_parent_path())
        std::filesystem::create_directories(itself.parent_path(), error);
    if (error)
        return systemFailure(error.value());
    if (mkdir(itself.c_str(), kForThePersonAlone) == 0)
        return {};
    if (errno != EEXIST)
        return systemFailure(errno);
    return isFolder(itself) ? Result<>() : systemFailure(ENOTDIR);
}

Result<> checkNobodyElseWrites(const std::filesystem::path& path)
{
    struct stat status = {};
    if (stat(path.c_str(), &status) != 0)
        return systemFailure(errno);
    if (status.st_uid != geteuid() && status.st_uid != kAdministrator)
        return Failure{translated(L"it belongs to another user"), kBelongsToAnother};
    if ((status.st_mode & (S_IWGRP | S_IWOTH)) != 0)
        return Failure{translated(L"other users may write to it")};
    return {};
}

bool mayBeEntered(const std::filesystem::path& folder)
{
    return !isFolder(folder) || access(folder.c_str(), X_OK) == 0;
}

bool othersMayEnter(const std::filesystem::path& folder)
{
    struct stat status = {};
    return stat(folder.c_str(), &status) == 0 && (status.st_mode & (S_IXGRP | S_IXOTH)) != 0;
}
} // namespace tessel
