// Everything that is said in a session, once more, in a file.
#pragma once

#include <filesystem>
#include <string>
#include <string_view>

#include "host/platform/Descriptor.h"
#include "host/text/Result.h"

namespace tessel
{
class SessionLog
{
public:
    // Opens the file to add to it; a new one is the person's alone. Nothing but an ordinary file is taken:
    // why not is a sentence.
    static Result<SessionLog> open(const std::filesystem::path& file);

    // Pieces of lines, UTF-8. Each line is written when it is whole, after the time by the clock of the
    // place: "2026-11-22T09:41:07.250+0100 ".
    void record(std::string_view text);

    // Writes what is left of a line. Whether all of it has arrived: a sentence about the first failure.
    Result<> finish();

private:
    SessionLog(std::filesystem::path file, Descriptor opened)
        : mFile(std::move(file)), mOpened(std::move(opened))
    {
    }

    void writeLine(std::string_view line);

    std::filesystem::path mFile;
    Descriptor mOpened;
    std::string mOpenLine;
    Result<> mWritten;
};
} // namespace tessel
