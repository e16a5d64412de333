// The copy of a registry's last sound state, which stands beside its file, and other files there. Used by the
// Registry's own files alone.
#pragma once

#include <sqlite3.h>

#include <filesystem>
#include <string>
#include <string_view>

#include "host/text/Result.h"

namespace tessel
{
// "registry.db.sound" of "registry.db".
std::filesystem::path soundCopyOf(const std::filesystem::path& file);

// What helps against the damage: to put the copy back, if it is sound, or else to begin with nothing. Looks
// at all of the copy.
std::wstring helpAgainstDamage(const std::filesystem::path& file);

// Whether there is a copy that can be put back. Why not is the end of a sentence.
Result<> checkSoundCopy(const std::filesystem::path& file);

// When the copy was made, in local time: "2026-11-22 09:41".
std::wstring timeOfCopy(const std::filesystem::path& file);

// Makes the copy from what is stored in the open registry now. The earlier copy stays until the new one is
// wholly on the disk. The failure is the end of a sentence.
Result<> makeSoundCopy(sqlite3* database, const std::filesystem::path& file);

// Puts the copy in the place of the file, which nobody of this process has open. What is there now is kept
// beside it, with its journals, under a name that is free: answers as which file, with an empty path when
// nothing is there. At every moment one of the two is in its place, unless that was a folder. Fails, with a
// whole sentence and nothing changed, when there is no copy or it is damaged itself.
Result<std::filesystem::path> putSoundCopyBack(const std::filesystem::path& file);

// The same with nothing in the place of the file, and of its copy, which is kept beside it too.
Result<std::filesystem::path> setAside(const std::filesystem::path& file);

// Writes a file of its own and makes it stand at the path, wholly on the disk, unless something is there
// already: then that stays, and all is well. The failure is the end of a sentence.
Result<> makeFileOnce(const std::filesystem::path& file, std::string_view bytes);
} // namespace tessel
