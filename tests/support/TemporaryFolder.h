// A folder of its own for one test, removed at the end.
#pragma once

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <stdexcept>
#include <string>
#include <string_view>

class TemporaryFolder
{
public:
    TemporaryFolder()
    {
        std::string name = (std::filesystem::temp_directory_path() / "modrig-test-XXXXXX").string();
        if (!mkdtemp(name.data()))
            throw std::runtime_error("cannot make a temporary folder");
        mPath = std::filesystem::canonical(name);
    }
    ~TemporaryFolder()
    {
        std::error_code ignored; // a folder that cannot be removed is the system's to clean
        std::filesystem::remove_all(mPath, ignored);
    }
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;

    const std::filesystem::path& path() const { return mPath; }
    std::filesystem::path operator/(const std::filesystem::path& name) const { return mPath / name; }

    // Writes a file (its folders too) and answers its path.
    std::filesystem::path write(const std::filesystem::path& name, std::string_view content) const
    {
        const auto file = mPath / name;
        std::filesystem::create_directories(file.parent_path());
        std::ofstream(file, std::ios::binary) << content;
        return file;
    }

private:
    std::filesystem::path mPath;
};
