// A folder of its own for one test, removed at the end. It stands in memory where the system offers that with
// room enough, so that nothing waits for a disk: what lasts when a process ends lasts there as well.
#pragma once

#include <cstdint>
#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <stdexcept>
#include <string>
#include <string_view>
#include <system_error>

#include <sys/mman.h>
#include <unistd.h>

class TemporaryFolder
{
public:
    TemporaryFolder()
    {
        std::string name = (place() / "modrig-test-XXXXXX").string();
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
    // Modules are loaded from the folder, which not every file system allows.
    static bool allowsModules(const std::filesystem::path& folder)
    {
        std::string name = (folder / "modrig-test-XXXXXX").string();
        const int file = mkstemp(name.data());
        if (file < 0)
            return false;
        unlink(name.c_str());
        void* code = ftruncate(file, 1) == 0 ? mmap(nullptr, 1, PROT_READ | PROT_EXEC, MAP_PRIVATE, file, 0)
                                             : MAP_FAILED;
        close(file);
        return code != MAP_FAILED && munmap(code, 1) == 0;
    }

    static bool memoryHasRoom()
    {
        constexpr std::uintmax_t kRoom = 512U << 20U;
        std::error_code missing;
        const auto space = std::filesystem::space(kInMemory, missing);
        return !missing && space.available >= kRoom && allowsModules(kInMemory);
    }

    static std::filesystem::path place()
    {
        static const bool inMemory = memoryHasRoom(); // asked once in a program
        return inMemory ? std::filesystem::path(kInMemory) : std::filesystem::temp_directory_path();
    }

    static constexpr const char* kInMemory = "/dev/shm";

    std::filesystem::path mPath;
};
