// `tsutFormatArguments` with any format, any arguments and any capacity: what is cut is the beginning of the
// whole.
#include <algorithm>
#include <cstdlib>
#include <vector>

#include <tessel/tsformat.h>

#include "tests/fuzz/WideText.h"

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    if (size < 2)
        return 0;
    const std::size_t capacity = data[0];
    const std::size_t count = data[1] % 5;
    const std::wstring format = wideText(data + 2, size - 2);
    const TsFormatArgument arguments[] = {-7, L"text", 2.5, std::uint8_t{200}};
    const std::size_t length = tsutFormatArguments(nullptr, 0, format.c_str(), arguments, count);
    std::vector<wchar_t> whole(length + 1, L'?');
    std::vector<wchar_t> cut(capacity, L'?');
    if (tsutFormatArguments(whole.data(), whole.size(), format.c_str(), arguments, count) != length ||
        tsutFormatArguments(cut.data(), cut.size(), format.c_str(), arguments, count) != length ||
        whole[length] != L'\0')
        std::abort();
    const std::wstring beginning(whole.data(), capacity == 0 ? 0 : std::min(length, capacity - 1));
    if (capacity > 0 && beginning + L'\0' != std::wstring(cut.data(), beginning.size() + 1))
        std::abort();
    return 0;
}
