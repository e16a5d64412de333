#include "host/text/TerminalText.h"

#include "host/text/ControlCharacters.h"
#include "host/text/Credentials.h"
#include "host/text/Hexadecimal.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
bool isOrder(wchar_t character)
{
    return isControl(static_cast<char32_t>(character)) && character != L'\n' && character != L'\t';
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
