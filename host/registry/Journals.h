// Whether the journal beside a registry's file is its own. Used by the Registry's own files alone.
#pragma once

#include <filesystem>
#include <optional>
#include <string>

#include "host/text/Result.h"

namespace tessel
{
// A write-ahead log stays behind when a session is killed, and holds what it stored last. One that was
// written for another file, or for an older state of this one, would be taken by the store all the same, and
// what it holds would be mixed with the registry or stand in its place. Such a log is set aside; `sentence`
// of the answer tells so, and is empty when there was none. Fails, with the end of a sentence, when the log
// cannot be set aside: then the file must not be opened with it.
//
// Every registry has a number of its own, and every transaction writes the page that holds it, with a count.
Result<std::optional<std::wstring>> setForeignLogAside(const std::filesystem::path& file);

// The file as one that nobody changes, as a URI: the store then reads it without the journal's files beside
// it, which a folder that may not be written cannot take.
std::string asFixedFile(const std::filesystem::path& file);

// "registry.db-wal" and "registry.db-journal" of "registry.db".
std::filesystem::path logOf(const std::filesystem::path& file);
std::filesystem::path rollbackJournalOf(const std::filesystem::path& file);
// "registry.db-shm", which tells what is in the log.
std::filesystem::path indexOfLog(const std::filesystem::path& file);

// "NAME", or "NAME-2" and so on, at which nothing stands yet, nor a journal of it.
std::filesystem::path freeNameLike(const std::filesystem::path& first);

// Whether such a file holds what the registry's own file does not say.
bool isInUse(const std::filesystem::path& journal);

// Whether a session has left a journal: another one runs, or the last one did not end in good order.
bool hasJournal(const std::filesystem::path& file);
} // namespace tessel
