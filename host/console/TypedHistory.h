// The lines that were typed at the prompt, in a file of the profile, one after the other.
#pragma once

#include <cstddef>
#include <filesystem>
#include <string>
#include <vector>

#include "host/text/Result.h"
#include "host/text/Translation.h"

namespace tessel
{
// As many lines the arrow keys bring back.
inline constexpr std::size_t kMostHistoryLines = 1000;

// Sessions that run at the same time add to the same file, a line each time: none loses another's, and a
// session that is killed has kept what was typed. The first failure is answered; after it this session
// neither reads nor writes the file, and says no more about it.
class TypedHistory
{
public:
    explicit TypedHistory(std::filesystem::path file) : mFile(std::move(file)) {}

    // The last lines, the oldest first; none when there is no file yet.
    Result<std::vector<std::wstring>> read();

    // Adds a line, without its line break. A blank one is passed over; the password in an address is left
    // out.
    Result<> add(const std::wstring& line);

private:
    Failure giveUp(Sentence<2> whatFailed, const std::wstring& reason);

    std::filesystem::path mFile;
    bool mGivenUp = false;
};
} // namespace tessel
