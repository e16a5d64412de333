// How loading Lisp files goes, seen from outside: which file an expression loads, and what becomes of it.
// Files load others, and may catch the errors of those.
#pragma once

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

    // An expression begins, and ends with this result. Answers the code that was noted of the file that it
    // failed to load, the one of its refusal if it was refused; 0 when none was noted.
    void begin() { mFiles.clear(); }
    int end(const Outcome& value);

    // In between: a file is to be loaded, and is loaded. The path as it was given.
    void asked(const std::wstring& path) { mFiles.push_back({path, LoadOutcomes::Clock::now()}); }
    void loaded(const std::wstring& path);
    // What was asked for last is refused.
    void refused(const Outcome& admitted);

private:
    struct File
    {
        std::wstring path;
        LoadOutcomes::Clock::time_point begun;
        int failureCode = Failure::kUnspecified;
    };

    bool isOfFile(const std::wstring& words) const;
    void note(const File& file, const Result<>& loaded) const;

    LoadOutcomes* mOutcomes;
    std::vector<File> mFiles; // that have begun and are not loaded, each within the one before it
};
} // namespace tessel
