// Lists of result buffers, as the host builds them for applications.
#pragma once

#include <span>
#include <string_view>

#include <tessel/tsresbuf.h>

namespace tessel
{
// A list of the texts in their order; null for none. The caller frees it with `tsutRelRb`. What a list says
// that this thread has freed is not built again: whoever asks again and again for a long list that hardly
// changes has it for the price of looking through it.
TsResultBuffer* listOfTexts(std::span<const std::wstring_view> texts);
} // namespace tessel
