#include "host/registry/CopyElsewhere.h"

#include <array>
#include <cerrno>
#include <cstdint>
#include <cstdlib>
#include <string>
#include <system_error>
#include <utility>

#include "host/platform/SystemFailure.h"
#include "host/registry/Journals.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
constexpr std::size_t kPartCount = 3;

std::array<std::filesystem::path, kPartCount> partsOf(const std::filesystem::path& file)
{
    return {file, logOf(file), rollbackJournalOf(file)};
}

// What changes with every writing; zeros for what is not there.
using PartState = std::pair<std::filesystem::file_time_type, std::uintmax_t>;

PartState stateOf(const std::filesystem::path& part)
{
    std::error_code missing;
    if (!std::filesystem::is_regular_file(part, missing))
        return {};
    return {std::filesystem::last_write_time(part, missing), std::filesystem::file_size(part, missing)};
}

std::array<PartState, kPartCount> stateOfAll(const std::array<std::filesystem::path, kPartCount>& parts)
{
    return {stateOf(parts[0]), stateOf(parts[1]), stateOf(parts[2])};
}

std::error_code copyPart(const std::filesystem::path& from, const std::filesystem::path& to)
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
        return systemFailure(failed ? failed.value() : errno);
    mFolder = name;
    const auto parts = partsOf(file);
    const auto places = partsOf(this->file());
    const auto before = stateOfAll(parts);
    for (std::size_t part = 0; part < kPartCount; ++part)
        if (const auto error = copyPart(parts[part], places[part]); error)
            return systemFailure(error.value());
    return stateOfAll(parts) == before ? Result<>() : Failure{translated(L"it is being written")};
}
} // namespace tessel
