#include "host/registry/CopyElsewhere.h"

#include <array>
#include <cerrno>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <system_error>
#include <utility>

#include "host/platform/SystemFailure.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr std::array kParts = {"", "-wal", "-journal"};

// What changes with every writing; zeros for what is not there.
using PartState = std::pair<std::filesystem::file_time_type, std::uintmax_t>;

std::array<PartState, kParts.size()> stateOf(const std::filesystem::path& file)
{
    std::array<PartState, kParts.size()> states;
    for (std::size_t part = 0; part < kParts.size(); ++part)
    {
        const std::string path = file.string() + kParts[part];
        std::error_code missing;
        if (std::filesystem::is_regular_file(path, missing))
            states[part] = {std::filesystem::last_write_time(path, missing),
                            std::filesystem::file_size(path, missing)};
    }
    return states;
}

std::error_code copyPart(const std::string& from, const std::string& to)
{
    std::error_code failed;
    if (!std::filesystem::is_regular_file(from, failed))
        return {}; // without it the rest is all there is
    if (std::filesystem::copy_file(from, to, failed))
        std::filesystem::permissions(
            to, std::filesystem::perms::owner_read | std::filesystem::perms::owner_write, failed);
    return failed;
}
} // namespace

CopyElsewhere::CopyElsewhere(const std::filesystem::path& file) : mMade(make(file))
{
}

CopyElsewhere::~CopyElsewhere()
{
    std::error_code left; // for the system to clear away
    if (!mFolder.empty())
        std::filesystem::remove_all(mFolder, left);
}

Result<> CopyElsewhere::make(const std::filesystem::path& file)
{
    std::error_code failed;
    std::string name = (std::filesystem::temp_directory_path(failed) / "tessel-XXXXXX").string();
    if (failed || !mkdtemp(name.data()))
        return failed ? Failure{toWide(failed.message())} : systemFailure(errno);
    mFolder = name;
    const auto before = stateOf(file);
    for (const char* part : kParts)
        if (const auto error = copyPart(file.string() + part, this->file().string() + part); error)
            return Failure{toWide(error.message())};
    return stateOf(file) == before ? Result<>() : Failure{L"it is being written"};
}
} // namespace tessel
