#include "host/text/Json.h"

#include <boost/locale/encoding_utf.hpp>

#include "host/text/ControlCharacters.h"
#include "host/text/Unicode.h"

namespace tessel::json
{
namespace
{
using boost::locale::conv::utf_to_utf;

constexpr wchar_t kFirstPrivateByte = 0x10FE00;
constexpr int kOnOneLine = -1;
constexpr bool kInAscii = true;

bool standsForItself(wchar_t character)
{
    return !isControl(static_cast<char32_t>(character)) && character < kFirstPrivateByte;
}

// With a private character as its four bytes, and not as the byte that it stands for, which would be no
// UTF-8.
std::string utf8Of(std::wstring_view content)
{
    return utf_to_utf<char>(toUtf16(content));
}

std::wstring escaped(wchar_t character)
{
    const std::string quoted = Json(utf8Of({&character, 1})).dump(kOnOneLine, ' ', kInAscii);
    return std::wstring(quoted.begin() + 1, quoted.end() - 1);
}
} // namespace

Json text(std::wstring_view content)
{
    return utf8Of(content);
}

Json listOfTexts(const std::vector<std::wstring>& contents)
{
    Json values = Json::array();
    for (const std::wstring& content : contents)
        values.push_back(text(content));
    return values;
}

std::wstring written(const Json& document)
{
    std::wstring line;
    for (const wchar_t character : utf_to_utf<wchar_t>(document.dump()))
        if (standsForItself(character))
            line += character;
        else
            line += escaped(character);
    return line;
}
} // namespace tessel::json
