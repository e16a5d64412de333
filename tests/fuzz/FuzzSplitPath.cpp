// `_wsplitpath_s` with any path and any buffer sizes: it writes inside the buffers, terminates them, and the
// parts put together are the path.
#include <cstdlib>
#include <cwchar>
#include <vector>

#include <wincompat/winfile.h>

#include "tests/fuzz/WideText.h"

namespace
{
constexpr std::size_t kParts = 4;
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    if (size < kParts)
        return 0;
    const std::wstring path = wideText(data + kParts, size - kParts);
    std::vector<std::vector<wchar_t>> parts; // each of its own size, so that a write past its end is seen
    for (std::size_t i = 0; i < kParts; ++i)
        parts.emplace_back(std::size_t{data[i]} * 2, L'?');
    const auto buffer = [&](std::size_t i)
    {
        return parts[i].empty() ? nullptr : parts[i].data();
    };
    const int status = _wsplitpath_s(path.c_str(), buffer(0), parts[0].size(), buffer(1), parts[1].size(),
                                     buffer(2), parts[2].size(), buffer(3), parts[3].size());
    std::wstring whole;
    bool complete = true;
    for (const auto& part : parts)
    {
        complete &= !part.empty();
        if (!part.empty())
            whole += part.data(); // reads past the buffer if it is not terminated
    }
    const std::wstring expected = status == 0 ? std::wstring(path.c_str()) : std::wstring();
    if (complete ? whole != expected : whole.size() > expected.size())
        std::abort();
    return 0;
}
