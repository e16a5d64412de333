#include "host/console/InputAssembler.h"

#include <algorithm>
#include <utility>

namespace tessel
{
namespace
{
constexpr std::wstring_view kBlanks = L" \t\r";
constexpr std::wstring_view kWordEnds = L" \t\r\n()\"';";

// Walks over Lisp text and keeps count of what is open. Only as much of the reader's syntax as can hide a
// parenthesis.
class LispScanner
{
public:
    explicit LispScanner(std::wstring_view text) : mText(text) {}

    bool endsOpen()
    {
        while (mAt < mText.size())
            step();
        return mDepth > 0 || mCutShort;
    }

private:
    bool startsWith(std::wstring_view mark) const { return mText.substr(mAt).starts_with(mark); }

    void step()
    {
        if (startsWith(L"#\\"))
            skipCharacter();
        else if (startsWith(L"#|"))
            skipBlockComment();
        else if (mText[mAt] == L';')
            mAt = std::min(mText.find(L'\n', mAt), mText.size());
        else if (mText[mAt] == L'"' || mText[mAt] == L'|')
            skipQuoted(mText[mAt]);
        else
            count(mText[mAt]);
    }

    void count(wchar_t character)
    {
        if (character == L'(')
            ++mDepth;
        // A parenthesis too many closes nothing: the interpreter is to complain about it.
        if (character == L')' && mDepth > 0)
            --mDepth;
        mAt += character == L'\\' ? 2 : 1;
    }

    // #\( and #\Space: the first character may be anything.
    void skipCharacter()
    {
        mAt += 3;
        if (mAt < mText.size())
            mAt = std::min(mText.find_first_of(kWordEnds, mAt), mText.size());
    }

    void skipQuoted(wchar_t quote)
    {
        ++mAt;
        while (mAt < mText.size() && mText[mAt] != quote)
            mAt += mText[mAt] == L'\\' ? 2 : 1;
        mCutShort = mAt >= mText.size();
        ++mAt;
    }

    // These nest.
    void skipBlockComment()
    {
        int depth = 0;
        do
        {
            const bool opens = startsWith(L"#|");
            const bool closes = startsWith(L"|#");
            depth += (opens ? 1 : 0) - (closes ? 1 : 0);
            mAt += opens || closes ? 2 : 1;
        } while (depth > 0 && mAt < mText.size());
        mCutShort = depth > 0;
    }

    std::wstring_view mText;
    std::size_t mAt = 0;
    int mDepth = 0;
    bool mCutShort = false;
};

std::wstring_view withoutLeadingBlanks(std::wstring_view text)
{
    return text.substr(std::min(text.find_first_not_of(kBlanks), text.size()));
}
} // namespace

bool isLisp(std::wstring_view text)
{
    return withoutLeadingBlanks(text).starts_with(L'(');
}

bool isUnfinishedLisp(std::wstring_view text)
{
    return LispScanner(text).endsOpen();
}

std::optional<std::wstring> InputAssembler::add(std::wstring_view line)
{
    const auto content = withoutLeadingBlanks(line);
    if (!isOpen() && (content.empty() || content.starts_with(L';')))
        return std::nullopt;
    mText += isOpen() ? L"\n" : L"";
    mText += line;
    if (isLisp(mText) && isUnfinishedLisp(mText))
        return std::nullopt;
    return std::exchange(mText, {});
}
} // namespace tessel
