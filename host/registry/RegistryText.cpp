#include "host/registry/RegistryText.h"

#include <algorithm>
#include <cctype>
#include <cstdint>
#include <optional>

#include "host/registry/KeyPath.h"
#include "host/text/Hexadecimal.h"
#include "host/text/Quotes.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr std::wstring_view kFirstLine = L"Windows Registry Editor Version 5.00";
constexpr std::wstring_view kRootName = L"HKEY_CURRENT_USER";
constexpr std::wstring_view kShortRootName = L"HKCU";
constexpr std::wstring_view kTextByUnits = L"hex(1):";
constexpr std::string_view kUtf8Mark = "\xEF\xBB\xBF";
constexpr std::string_view kLowFirstMark = "\xFF\xFE";
constexpr std::string_view kHighFirstMark = "\xFE\xFF";
constexpr std::size_t kUnitBytes = 2;
constexpr int kDigitBits = 4;
constexpr std::size_t kDigitsOfByte = 2;
constexpr std::size_t kBytesInLine = 24;
constexpr std::size_t kMostKeysInPath = 512; // the registry cannot remove what is much deeper
constexpr auto kNoCharacter =
    Sentence<1>(L"in line {} a character of the number 0 stands, which no text has");

std::u16string unitsOf(std::string_view bytes, bool lowFirst)
{
    std::u16string units;
    units.reserve(bytes.size() / kUnitBytes);
    for (std::size_t at = 0; at + 1 < bytes.size(); at += kUnitBytes)
    {
        const auto first = static_cast<std::uint8_t>(bytes[at]);
        const auto second = static_cast<std::uint8_t>(bytes[at + 1]);
        units += static_cast<char16_t>(lowFirst ? first | second << 8 : first << 8 | second);
    }
    return units;
}

std::string bytesOf(std::u16string_view units)
{
    std::string bytes;
    bytes.reserve(units.size() * kUnitBytes);
    for (const char16_t unit : units)
        bytes += {static_cast<char>(unit & 0xFF), static_cast<char>(unit >> 8)};
    return bytes;
}

Result<std::wstring> decodedText(std::string_view bytes)
{
    const bool lowFirst = bytes.starts_with(kLowFirstMark);
    if (!lowFirst && !bytes.starts_with(kHighFirstMark))
        return toWide(bytes.starts_with(kUtf8Mark) ? bytes.substr(kUtf8Mark.size()) : bytes);
    if (bytes.size() % kUnitBytes != 0)
        return Failure{translated(L"it ends in the middle of a character")};
    return toWide(unitsOf(bytes.substr(kLowFirstMark.size()), lowFirst));
}

bool isLineBreak(wchar_t character)
{
    return character == L'\n' || character == L'\r';
}

bool isBlankInLine(wchar_t character)
{
    return character == L' ' || character == L'\t';
}

class Reader
{
public:
    explicit Reader(std::wstring_view text) : mText(text) {}

    Result<std::vector<RegistryChange>> read()
    {
        if (const std::size_t found = mText.find(L'\0'); found != mText.npos)
        {
            mAt = found;
            return failureHere(kNoCharacter);
        }
        if (takeRestOfLine() != kFirstLine)
            return Failure{translated(L"in line {} \"{}\" is missing", 1, kFirstLine)};
        while (skipToNext())
            if (auto done = mText[mAt] == L'[' ? readKey() : readValue(); !done)
                return done.failure();
        return std::move(mChanges);
    }

private:
    Failure failureHere(Sentence<1> what) const { return {translated(what, line())}; }

    // Counted from where it was asked last.
    std::size_t line() const
    {
        mLine += static_cast<std::size_t>(std::ranges::count(mText.substr(mCounted, mAt - mCounted), L'\n'));
        mCounted = mAt;
        return mLine;
    }

    bool atEnd() const { return mAt == mText.size(); }
    bool startsWith(std::wstring_view what) const { return mText.substr(mAt).starts_with(what); }
    bool take(std::wstring_view what)
    {
        const bool is = startsWith(what);
        mAt += is ? what.size() : 0;
        return is;
    }
    void skipBlanks()
    {
        while (!atEnd() && isBlankInLine(mText[mAt]))
            ++mAt;
    }

    // The line break stays, blanks at the end go.
    std::wstring_view takeRestOfLine()
    {
        const std::size_t begin = mAt;
        while (!atEnd() && !isLineBreak(mText[mAt]))
            ++mAt;
        std::wstring_view rest = mText.substr(begin, mAt - begin);
        while (!rest.empty() && isBlankInLine(rest.back()))
            rest.remove_suffix(1);
        return rest;
    }

    // To the next key or value; false when there is none.
    bool skipToNext()
    {
        while (!atEnd())
            if (mText[mAt] == L';')
                takeRestOfLine();
            else if (isBlankInLine(mText[mAt]) || isLineBreak(mText[mAt]))
                ++mAt;
            else
                return true;
        return false;
    }

    Result<> readKey()
    {
        const std::size_t here = line();
        std::wstring_view path = takeRestOfLine();
        if (path.size() < 2 || path.back() != L']')
            return Failure{translated(L"in line {} the \"]\" after the key is missing", here)};
        path = path.substr(1, path.size() - 2);
        const bool goes = path.starts_with(L'-');
        auto key = belowRoot(path.substr(goes ? 1 : 0));
        if (!key)
            return Failure{translated(L"in line {} a key stands that is not below HKEY_CURRENT_USER", here)};
        if (isTooDeep(*key))
            return Failure{
                translated(L"in line {} a key lies below more than {} others", here, kMostKeysInPath - 1)};
        if (goes && key->empty())
            return Failure{translated(L"in line {} all of HKEY_CURRENT_USER would go", here)};
        using Kind = RegistryChange::Kind;
        mChanges.push_back({goes ? Kind::kRemoveKey : Kind::kMakeKey, *key, L"", L"", here});
        mKey = goes ? std::nullopt : std::move(key);
        return {};
    }

    static bool isTooDeep(std::wstring_view path)
    {
        std::size_t depth = 0;
        while (!path.empty() && depth <= kMostKeysInPath)
            depth += takeKeyPart(path).empty() ? 0 : 1;
        return depth > kMostKeysInPath;
    }

    static std::optional<std::wstring> belowRoot(std::wstring_view path)
    {
        const std::wstring_view root = takeKeyPart(path);
        if (!equalIgnoringCase(root, kRootName) && !equalIgnoringCase(root, kShortRootName))
            return std::nullopt;
        return std::wstring(path);
    }

    Result<> readValue()
    {
        if (!mKey)
            return failureHere(Sentence<1>(L"in line {} a value stands without a key before it"));
        RegistryChange change{RegistryChange::Kind::kSetValue, *mKey, L"", L"", line()};
        if (!take(L"@"))
        {
            auto name = readQuoted(Sentence<1>(L"in line {} a name begins that never ends"));
            if (!name)
                return name.failure();
            change.name = *std::move(name);
        }
        skipBlanks();
        if (!take(L"="))
            return failureHere(Sentence<1>(L"in line {} the \"=\" after a name is missing"));
        skipBlanks();
        if (auto done = readData(change); !done)
            return done;
        skipBlanks();
        if (!atEnd() && !isLineBreak(mText[mAt]) && mText[mAt] != L';')
            return failureHere(Sentence<1>(L"in line {} something stands after a value"));
        mChanges.push_back(std::move(change));
        return {};
    }

    Result<> readData(RegistryChange& change)
    {
        if (take(L"-"))
        {
            change.kind = RegistryChange::Kind::kRemoveValue;
            return {};
        }
        if (!startsWith(L"\"") && !startsWith(kTextByUnits))
            return failureHere(Sentence<1>(
                L"in line {} a value stands that is no text, and the registry holds texts alone"));
        auto data = take(kTextByUnits) ? readUnits()
                                       : readQuoted(Sentence<1>(L"in line {} a text begins that never ends"));
        if (!data)
            return data.failure();
        change.data = *std::move(data);
        return {};
    }

    Result<std::wstring> readQuoted(Sentence<1> neverEnds)
    {
        const std::size_t here = line();
        if (!take(L"\""))
            return Failure{translated(L"in line {} neither a key nor a name in quotes begins", here)};
        std::wstring text;
        while (!atEnd())
        {
            const wchar_t character = mText[mAt++];
            if (character == L'"')
                return text;
            if (character == L'\\' && (atEnd() || (mText[mAt] != L'\\' && mText[mAt] != L'"')))
                return failureHere(
                    Sentence<1>(L"in line {} a \"\\\" stands alone, and is to be written twice"));
            text += character == L'\\' ? mText[mAt++] : character;
        }
        return Failure{translated(neverEnds, here)};
    }

    Result<std::wstring> readUnits()
    {
        std::string bytes;
        do
        {
            goOnToNextLine();
            const int high = digitAt(mAt);
            const int low = digitAt(mAt + 1);
            if (high < 0 || low < 0)
                break;
            bytes += static_cast<char>(high << kDigitBits | low);
            mAt += kDigitsOfByte;
            goOnToNextLine();
        } while (take(L","));
        if (bytes.size() % kUnitBytes != 0)
            return failureHere(Sentence<1>(L"in line {} a text ends in the middle of a character"));
        std::u16string units = unitsOf(bytes, true);
        if (units.ends_with(u'\0'))
            units.pop_back();
        if (units.find(u'\0') != units.npos)
            return failureHere(kNoCharacter);
        return toWide(units);
    }

    // A row of bytes goes on there after a backslash.
    void goOnToNextLine()
    {
        skipBlanks();
        while (take(L"\\\r\n") || take(L"\\\n"))
            skipBlanks();
    }

    // -1 where no digit stands.
    int digitAt(std::size_t at) const
    {
        const std::size_t digit = at < mText.size() && mText[at] < 0x80
                                      ? kSmallHexDigits.find(static_cast<char>(std::tolower(mText[at])))
                                      : kSmallHexDigits.npos;
        return digit == kSmallHexDigits.npos ? -1 : static_cast<int>(digit);
    }

    std::wstring_view mText;
    std::size_t mAt = 0;
    mutable std::size_t mCounted = 0;
    mutable std::size_t mLine = 1;
    std::optional<std::wstring> mKey; // to which values belong
    std::vector<RegistryChange> mChanges;
};

std::wstring byUnits(std::wstring_view text)
{
    const std::string bytes = bytesOf(toUtf16(text) + u'\0');
    std::wstring result(kTextByUnits);
    for (std::size_t at = 0; at < bytes.size(); ++at)
    {
        if (at > 0)
            result += at % kBytesInLine == 0 ? L",\\\r\n  " : L",";
        result += hexadecimal<wchar_t>(static_cast<unsigned char>(bytes[at]), kSmallHexDigits);
    }
    return result;
}

// Editors and version control change what stands at the end of lines.
bool hasControlCharacter(std::wstring_view text)
{
    return std::ranges::any_of(text, [](wchar_t character) { return character < L' ' || character == 0x7F; });
}

std::wstring lineOf(const RegistryChange& change)
{
    using Kind = RegistryChange::Kind;
    const std::wstring key = std::wstring(kRootName) + (change.key.empty() ? L"" : L"\\") + change.key;
    if (change.kind == Kind::kMakeKey)
        return L"\r\n[" + key + L"]\r\n";
    if (change.kind == Kind::kRemoveKey)
        return L"\r\n[-" + key + L"]\r\n";
    const std::wstring begin = (change.name.empty() ? L"@" : inQuotes(change.name)) + L"=";
    if (change.kind == Kind::kRemoveValue)
        return begin + L"-\r\n";
    return begin + (hasControlCharacter(change.data) ? byUnits(change.data) : inQuotes(change.data)) +
           L"\r\n";
}
} // namespace

Result<std::vector<RegistryChange>> readRegistryText(std::string_view bytes)
{
    const auto text = decodedText(bytes);
    return text ? Reader(*text).read() : text.failure();
}

Result<std::string> writeRegistryText(const std::vector<RegistryChange>& changes, RegistryTextForm form)
{
    std::wstring text = std::wstring(kFirstLine) + L"\r\n";
    for (const RegistryChange& change : changes)
    {
        if (std::ranges::any_of(change.key, isLineBreak))
            return Failure{
                translated(L"the name of a key in it has a line break, for which such files have no way")};
        text += lineOf(change);
    }
    return form == RegistryTextForm::kUtf8 ? toUtf8(text)
                                           : std::string(kLowFirstMark) + bytesOf(toUtf16(text));
}
} // namespace tessel
