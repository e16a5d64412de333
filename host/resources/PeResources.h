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

#include "host/resources/ModuleLanguages.h"
#include "host/text/Result.h"

namespace tessel
{
class PeResources
{
public:
    // Why the bytes are no sound file with resources is the end of a sentence.
    static Result<PeResources> read(std::vector<std::uint8_t> bytes);

    // The languages that the file has texts in, as they stand in it: the first is the one whose texts come
    // first. Resource compilers keep the order of their script there, while the tree is sorted by numbers.
    const std::vector<LanguageNumber>& languages() const { return mLanguages; }

    // The text of that id in one of the languages; empty when there is none. Halves of a character outside
    // the basic plane become one character, a lone half U+FFFD.
    std::wstring string(unsigned id, LanguageNumber language) const;

private:
    using TextBlocks =
        std::map<unsigned, std::size_t>; // number of a block of sixteen texts -> where it begins

    PeResources() = default;

    std::vector<std::uint8_t> mBytes;
    std::map<LanguageNumber, TextBlocks> mBlocks;
    std::vector<LanguageNumber> mLanguages;
};
} // namespace tessel
