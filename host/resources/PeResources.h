// The string tables of a portable executable (PE format, 32 and 64 bits), as resource compilers write them.
//
// The bytes may come from anywhere: every offset is checked against what is there before it is used, and the
// whole tree of string tables is walked once when the file is read, so that a file that is accepted answers
// every question. A changed letter inside a text is the one damage that nobody can see.
#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <string>
#include <vector>

#include "host/text/Result.h"

namespace tessel
{
class PeResources
{
public:
    // Why the bytes are no sound file with resources is the end of a sentence.
    static Result<PeResources> read(std::vector<std::uint8_t> bytes);

    // The text of that id; empty when there is none. Where the file has it in several languages, the first in
    // the file. Halves of a character outside the basic plane become one character, a lone half U+FFFD.
    std::wstring string(unsigned id) const;

private:
    PeResources() = default;

    std::vector<std::uint8_t> mBytes;
    std::map<unsigned, std::size_t> mBlocks; // number of a block of sixteen texts -> where it begins
};
} // namespace tessel
