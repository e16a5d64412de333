// Makes a folder the current one as long as it lives.
#pragma once

#include <filesystem>

class CurrentFolder
{
public:
    explicit CurrentFolder(const std::filesystem::path& folder) : mBefore(std::filesystem::current_path())
    {
        std::filesystem::current_path(folder);
    }
    ~CurrentFolder()
    {
        std::error_code ignored; // each test runs in a process of its own
        std::filesystem::current_path(mBefore, ignored);
    }
    CurrentFolder(const CurrentFolder&) = delete;
    CurrentFolder& operator=(const CurrentFolder&) = delete;

private:
    std::filesystem::path mBefore;
};
