#include "host/text/TerminalText.h"

#include "host/text/Credentials.h"
#include "host/text/Hexadecimal.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr wchar_t kDelete = 0x7F;
constexpr wchar_t kLastControl =
    0x9F; // those from U+0080 are what some terminals take for an escape and a letter

bool isOrder(wchar_t character)
{
    const bool isControl =
        (character >= 0 && character < L' ') || (character >= kDelete && character <= kLastControl);
    return isControl && character != L'\n' && character != L'\t';
}
} // namespace

std::wstring forTerminal(std::wstring_view text)
{
    std::wstring result;
    result.reserve(text.size());
    for (std::size_t at = 0; at < text.size(); ++at)
        if (!isOrder(text[at]))
            result += text[at];
        else if (!text.substr(at).starts_with(L"\r\n"))
            result += shownByte<wchar_t>(static_cast<unsigned char>(text[at]));
    return withReadableBytes(withoutCredentials(result));
}
} // namespace tessel
