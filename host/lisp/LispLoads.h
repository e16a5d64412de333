// How loading Lisp files goes, seen from outside: which file an expression loads, and what becomes of it.
// Files load others, and may catch the errors of those.
#pragma once

#include <optional>
#include <string>
#include <vector>

#include "host/applications/LoadOutcomes.h"

namespace tessel
{
class LispLoads
{
public:
    // Notes there what it finds out; null: nowhere.
    explicit LispLoads(LoadOutcomes* outcomes) : mOutcomes(outcomes) {}

    // An expression begins, and ends with this result. Answers the code of its refusal if the file that it
    // failed to load was refused, else `Failure::kUnspecified`; 0 when no file failed.
    void begin();
    int end(const Outcome& value);

    // In between: a file is to be loaded, and is loaded. The path as it was given.
    void asked(const std::wstring& path) { mFiles.push_back({path, LoadOutcomes::Clock::now(), {}}); }
    void loaded(const std::wstring& path);
    // What was asked for last is refused; the end of a sentence.
    void refused(const Failure& reason);
    // What fails now is the expression's file of that path. The words are missing if it was refused.
    void failed(const std::wstring& path, const std::wstring& words);

private:
    struct File
    {
        std::wstring path;
        LoadOutcomes::Clock::time_point begun;
        Result<> loaded; // unless it was refused
    };
    using Files = std::vector<File>;

    Files::iterator lastOf(const std::wstring& path);
    void note(const File& file) const;

    LoadOutcomes* mOutcomes;
    Files mFiles;                // that have begun and are not loaded, each within the one before it
    std::optional<File> mFailed; // of them, once the expression fails
};
} // namespace tessel
