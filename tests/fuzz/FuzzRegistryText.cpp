// Registry files of any bytes: what is understood is written and read again as it was.
#include <cstdint>
#include <cstdlib>
#include <string_view>

#include "host/registry/RegistryText.h"

namespace
{
void require(bool condition)
{
    if (!condition)
        std::abort();
}

// The same whatever line it stands in.
bool asksForTheSame(tessel::RegistryChange one, const tessel::RegistryChange& other)
{
    one.line = other.line;
    return one == other;
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const auto changes = tessel::readRegistryText({reinterpret_cast<const char*>(data), size});
    if (!changes)
    {
        require(!changes.sentence().empty());
        return 0;
    }
    for (const auto form : {tessel::RegistryTextForm::kUtf8, tessel::RegistryTextForm::kUtf16})
    {
        const auto text = tessel::writeRegistryText(*changes, form);
        require(static_cast<bool>(text));
        const auto again = tessel::readRegistryText(*text);
        require(again && again->size() == changes->size());
        for (std::size_t index = 0; index < again->size(); ++index)
            require(asksForTheSame((*again)[index], (*changes)[index]));
    }
    return 0;
}
