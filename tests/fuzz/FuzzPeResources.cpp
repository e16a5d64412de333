// The reader of resource modules, fed with any bytes: it refuses them with a reason or answers every
// question.
#include <cstdlib>

#include "host/resources/PeResources.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const auto resources = tessel::PeResources::read({data, data + size});
    if (static_cast<bool>(resources) != resources.sentence().empty())
        std::abort();
    for (unsigned id = 0; resources && id < 0x10010; id += 5) // reaches each place in the blocks of sixteen
        if (resources->string(id).size() > size)
            std::abort();
    return 0;
}
