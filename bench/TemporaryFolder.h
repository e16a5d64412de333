// A folder on the disk, where files usually are, removed at the end.
#pragma once

#include <stdlib.h>

#include <filesystem>
#include <stdexcept>
#include <string>
#include <system_error>

namespace bench
{
class TemporaryFolder
{
public:
    // `name` is what its name begins with.
    explicit TemporaryFolder(const std::string& name)
    {
        std::string path = (std::filesystem::temp_directory_path() / (name + "-XXXXXX")).string();
        if (!mkdtemp(path.data()))
            throw std::runtime_error("cannot make a folder called " + path);
        mPath = path;
    }
    ~TemporaryFolder()
    {
        std::error_code ignored; // what cannot be removed is the system's to clean
        std::filesystem::remove_all(mPath, ignored);
    }
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;

    const std::filesystem::path& path() const { return mPath; }

private:
    std::filesystem::path mPath;
};
} // namespace bench
