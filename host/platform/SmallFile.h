// Small files in which the host keeps what must not be lost when a process ends: read whole, replaced whole.
#pragma once

#include <chrono>
#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "host/platform/Descriptor.h"
#include "host/text/Result.h"

namespace tessel
{
// Held by one process at a time, for as long as the object lives; others wait, but not for ever. The lock is
// the process's: one object for a file at a time.
class FileLock
{
public:
    static constexpr auto kPatience = std::chrono::seconds(5);

    // Makes the file if need be.
    explicit FileLock(const std::filesystem::path& file, std::chrono::milliseconds patience = kPatience);
    // Why it is not is the end of a sentence.
    const Result<>& held() const { return mHeld; }

private:
    Descriptor mFile;
    Result<> mHeld;
};

// Locks an open file as a whole for this process: at once or not at all.
bool lockNow(int descriptor);

// The content; nothing when there is no such file. What is no ordinary file of sensible size is refused.
Result<std::optional<std::string>> readSmallFile(const std::filesystem::path& file);

// Text as a part of a line, without tabs and line breaks, and back.
std::string escaped(std::string_view text);
std::string unescaped(std::string_view text);
// The lines of a text whose last line is ended too; what comes after that is none.
std::vector<std::string_view> linesOf(std::string_view text);

// The file has the new content or the old one, whatever happens meanwhile.
Result<> replaceSmallFile(const std::filesystem::path& file, std::string_view content);
} // namespace tessel
