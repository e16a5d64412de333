// The module's wide string.
//
// Every path, key and message of the module is one. Characters are Unicode code points of 4 bytes; positions
// and lengths count characters. Comparison "NoCase" is Unicode's simple case folding and does not depend on
// the process locale.
#pragma once

#include <string>
#include <string_view>

#include <tessel/tsformat.h>
#include <wincompat/wintypes.h>

class CStdStr
{
public:
    CStdStr() = default;

    // Copies the text; null gives an empty string. A pointer whose value is 1 to 65535 is no text but the id
    // of a string in the current resource module, which is loaded (see `Load`).
    CStdStr(const wchar_t* text);
    CStdStr(std::wstring text) : mText(std::move(text)) {}
    CStdStr(std::wstring_view text) : mText(text) {}

    const wchar_t* c_str() const { return mText.c_str(); }
    const std::wstring& Text() const { return mText; }
    bool IsEmpty() const { return mText.empty(); }

    int CompareNoCase(const CStdStr& other) const;
    bool EqualsNoCase(const CStdStr& other) const;

    // The first `count` characters; all of them when there are fewer.
    [[nodiscard]] CStdStr Left(std::size_t count) const;
    // From position `first` (0 is the head) to the end, or at most `count` characters; empty beyond the end.
    [[nodiscard]] CStdStr Mid(std::size_t first) const;
    [[nodiscard]] CStdStr Mid(std::size_t first, std::size_t count) const;

    // Remove white space, or the given character, from the ends.
    CStdStr& TrimLeft();
    CStdStr& TrimRight();
    CStdStr& TrimLeft(wchar_t character);
    CStdStr& TrimRight(wchar_t character);

    // The text after the last dot of the whole string, folders included: what the module takes for the
    // extension of an application file. Empty without a dot; `HasDot` tells the difference.
    CStdStr AfterLastDot() const;
    bool HasDot() const;

    // Replaces the value with string `id` of the resource module (null: the current one). When the text is
    // missing or empty the value stays as it is and the answer is false.
    [[nodiscard]] bool Load(unsigned id, HMODULE module = nullptr);

    // Replaces the value with the arguments formatted by string `id` of the current resource module, or, with
    // `Fmt`, by the text. The result holds at most the format's length plus 1023 characters. A conversion
    // that does not fit its argument prints as it stands. `Format` changes nothing when the id is missing.
    template <class... Arguments>
    [[nodiscard]] bool Format(unsigned id, const Arguments&... arguments)
    {
        CStdStr format;
        if (!format.Load(id))
            return false;
        Fmt(format.c_str(), arguments...);
        return true;
    }
    template <class... Arguments>
    void Fmt(const wchar_t* format, const Arguments&... arguments)
    {
        if constexpr (sizeof...(arguments) == 0)
            FormatArguments(format, nullptr, 0);
        else
        {
            const TsFormatArgument list[] = {TsFormatArgument(arguments)...};
            FormatArguments(format, list, sizeof...(arguments));
        }
    }

    // As `Load` and `Format`, for callers that go on with an empty text where the id is missing.
    [[nodiscard]] static CStdStr OfId(unsigned id)
    {
        CStdStr text;
        return text.Load(id) ? text : CStdStr();
    }
    template <class... Arguments>
    [[nodiscard]] static CStdStr Formatted(unsigned id, const Arguments&... arguments)
    {
        CStdStr text;
        return text.Format(id, arguments...) ? text : CStdStr();
    }

    CStdStr& operator+=(const CStdStr& tail)
    {
        mText += tail.mText;
        return *this;
    }

    // The one comparison that is exact to the letter.
    friend bool operator==(const CStdStr& left, const CStdStr& right) { return left.mText == right.mText; }

private:
    void FormatArguments(const wchar_t* format, const TsFormatArgument* arguments, std::size_t count);

    std::wstring mText;
};

inline CStdStr operator+(CStdStr left, const CStdStr& right)
{
    left += right;
    return left;
}
