// Text that comes from files, file names and other programs: any bytes go through the host's wide text and
// come back, and what a terminal is given holds no orders.
#include <cstdint>
#include <cstdlib>

#include "host/text/Credentials.h"
#include "host/text/TerminalText.h"
#include "host/text/Unicode.h"

namespace
{
void require(bool condition)
{
    if (!condition)
        std::abort();
}

bool isOrder(wchar_t character)
{
    return (character >= 0 && character < L' ' && character != L'\n' && character != L'\t') ||
           (character >= 0x7F && character < 0xA0);
}
} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::string bytes(data, data + size);
    const std::wstring text = tessel::toWide(bytes);
    require(tessel::toUtf8(text) == bytes);
    require(tessel::equalIgnoringCase(text, tessel::foldCase(text)));
    require(tessel::foldCase(text).size() == text.size());
    const std::wstring shown = tessel::forTerminal(text);
    for (const wchar_t character : shown)
        require(!isOrder(character));
    const std::wstring open = tessel::withoutCredentials(text);
    require(tessel::withoutCredentials(open) == open);
    const std::u16string utf16 = tessel::toUtf16(text);
    require(tessel::toUtf16(tessel::toWide(utf16)) == utf16);
    return 0;
}
