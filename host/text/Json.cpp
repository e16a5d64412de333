#include "host/text/Json.h"

namespace tessel::json
{
namespace
{
constexpr wchar_t kDelete = 0x7F;
constexpr wchar_t kLastControl = 0x9F;
constexpr wchar_t kFirstPrivateByte = 0x10FE00;
constexpr unsigned kBeyondFirstPlane = 0x10000;

bool standsForItself(wchar_t character)
{
    return character >= L' ' && (character < kDelete || character > kLastControl) &&
           character < kFirstPrivateByte;
}

std::wstring escapedUnit(unsigned unit)
{
    constexpr wchar_t kDigits[] = L"0123456789abcdef";
    std::wstring escape = L"\\u";
    for (int shift = 12; shift >= 0; shift -= 4)
        escape += kDigits[(unit >> shift) & 0xF];
    return escape;
}

// As one unit of UTF-16, or as two.
std::wstring escaped(unsigned character)
{
    if (character < kBeyondFirstPlane)
        return escapedUnit(character);
    const unsigned rest = character - kBeyondFirstPlane;
    return escapedUnit(0xD800 + (rest >> 10)) + escapedUnit(0xDC00 + (rest & 0x3FF));
}

std::wstring joined(const std::vector<std::wstring>& values)
{
    std::wstring all;
    for (const std::wstring& value : values)
        all += (all.empty() ? L"" : L", ") + value;
    return all;
}
} // namespace

std::wstring text(std::wstring_view content)
{
    std::wstring quoted = L"\"";
    for (const wchar_t character : content)
        if (character == L'"' || character == L'\\')
            quoted += {L'\\', character};
        else if (standsForItself(character))
            quoted += character;
        else
            quoted += escaped(static_cast<unsigned>(character));
    return quoted + L"\"";
}

std::wstring truth(bool value)
{
    return value ? L"true" : L"false";
}

std::wstring list(const std::vector<std::wstring>& values)
{
    return L"[" + joined(values) + L"]";
}

std::wstring listOfTexts(const std::vector<std::wstring>& contents)
{
    std::vector<std::wstring> values;
    for (const std::wstring& content : contents)
        values.push_back(text(content));
    return list(values);
}

std::wstring object(const Fields& fields)
{
    std::vector<std::wstring> members;
    for (const auto& [name, value] : fields)
        members.push_back(text(name) + L": " + value);
    return L"{" + joined(members) + L"}";
}
} // namespace tessel::json
