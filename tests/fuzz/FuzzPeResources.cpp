// The reader of resource modules, fed with any bytes: it refuses them with a reason or answers every
// question.
#include <bitset>
#include <cstdlib>

#include "host/resources/PeResources.h"

namespace
{
constexpr unsigned kTextsPerBlock = 16;
constexpr unsigned kBlocks = 0x1001; // more than resource compilers write

// The blocks that the file can hold: their numbers stand in it, and the block after each.
std::bitset<kBlocks + 1> possibleBlocks(const std::uint8_t* data, std::size_t size)
{
    std::bitset<kBlocks + 1> blocks;
    for (std::size_t at = 0; at + 4 <= size; ++at)
    {
        const unsigned number = data[at] | data[at + 1] << 8 | data[at + 2] << 16;
        if (data[at + 3] == 0 && number >= 1 && number < kBlocks)
            blocks.set(number).set(number + 1);
    }
    return blocks;
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const auto resources = tessel::PeResources::read({data, data + size});
    if (static_cast<bool>(resources) != resources.sentence().empty())
        std::abort();
    if (!resources)
        return 0;
    const auto blocks = possibleBlocks(data, size);
    for (unsigned block = 1; block <= kBlocks; ++block)
        for (unsigned text = 0; blocks.test(block) && text < kTextsPerBlock; ++text)
            for (const auto language : resources->languages())
                if (resources->string((block - 1) * kTextsPerBlock + text, language).size() > size)
                    std::abort();
    return 0;
}
