#include "host/platform/OrdinaryFile.h"

#include <array>
#include <cerrno>
#include <system_error>

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include "host/platform/Descriptor.h"
#include "host/platform/SystemFailure.h"
#include "host/text/Sizes.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
Failure whyUnreadable()
{
    const bool isMissing = errno == ENOENT || errno == ENOTDIR;
    return {systemFailure(errno).sentence, isMissing ? kNothingThere : Failure::kUnspecified};
}

Failure tooLarge(std::uintmax_t mostBytes)
{
    return {translated(L"it is larger than {}", sizeInWords(mostBytes))};
}
} // namespace

bool isOrdinaryFile(const std::filesystem::path& path)
{
    std::error_code unreachable;
    return std::filesystem::is_regular_file(path, unreachable);
}

Result<> checkOrdinary(const struct stat& status)
{
    if (S_ISDIR(status.st_mode))
        return Failure{translated(L"it is a folder, not a file")};
    return S_ISREG(status.st_mode) ? Result<>() : Failure{translated(L"it is not an ordinary file")};
}

Result<Descriptor> openOrdinaryFile(const std::filesystem::path& path, struct stat& status)
{
    return ordinaryFile(Descriptor(open(path.c_str(), kToReadOrdinary)), status);
}

Result<Descriptor> ordinaryFile(Descriptor opened, struct stat& status)
{
    if (!opened || fstat(opened.number(), &status) != 0)
        return whyUnreadable();
    if (auto ordinary = checkOrdinary(status); !ordinary)
        return ordinary.failure();
    return opened;
}

Result<std::string> readOrdinaryFile(const std::filesystem::path& path, std::uintmax_t mostBytes)
{
    struct stat status = {};
    const auto file = openOrdinaryFile(path, status);
    if (!file)
        return file.failure();
    if (static_cast<std::uintmax_t>(status.st_size) > mostBytes)
        return tooLarge(mostBytes);
    std::string content;
    content.reserve(static_cast<std::size_t>(status.st_size));
    std::array<char, 65536> piece;
    ssize_t count = 0;
    while ((count = read(file->number(), piece.data(), piece.size())) > 0)
    {
        content.append(piece.data(), static_cast<std::size_t>(count));
        if (content.size() > mostBytes) // it grows while it is read
            return tooLarge(mostBytes);
    }
    if (count < 0)
        return whyUnreadable();
    return content;
}
} // namespace tessel
