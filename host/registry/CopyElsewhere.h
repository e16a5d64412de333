// A registry's file and its journals in a folder of their own, where the store may bring them together:
// beside the file it may not write, or not lock. Used by the Registry's own files alone.
#pragma once

#include <filesystem>

#include "host/text/Result.h"

namespace tessel
{
// Gone with the object. Nobody else can read it.
class CopyElsewhere
{
public:
    // Of a file that nobody of this process has open.
    explicit CopyElsewhere(const std::filesystem::path& file);
    ~CopyElsewhere();
    CopyElsewhere(const CopyElsewhere&) = delete;
    CopyElsewhere& operator=(const CopyElsewhere&) = delete;

    // Fails where a copy cannot be made, or somebody wrote meanwhile: then it would be half of this and half
    // of that. The end of a sentence.
    const Result<>& made() const { return mMade; }

    std::filesystem::path file() const { return mFolder / "copy.db"; }

private:
    Result<> make(const std::filesystem::path& file);

    std::filesystem::path mFolder; // empty when there is none
    Result<> mMade;
};
} // namespace tessel
