#include "host/lisp/LispSource.h"

#include <algorithm>
#include <vector>

namespace tessel
{
namespace
{
constexpr std::wstring_view kWhiteSpace = L" \t\r\n\f\v";
constexpr std::wstring_view kTokenEnds = L" \t\r\n\f\v()\"';`,";

std::size_t endOfLine(std::wstring_view text, std::size_t from)
{
    return std::min(text.find(L'\n', from), text.size());
}

// Behind a string or a |symbol|.
std::size_t endOfQuoted(std::wstring_view text, std::size_t from)
{
    const wchar_t quote = text[from];
    std::size_t at = from + 1;
    while (at < text.size() && text[at] != quote)
        at += text[at] == L'\\' ? 2 : 1;
    return std::min(at + 1, text.size());
}

// Behind a block comment; these nest. Nothing when it is never closed.
std::optional<std::size_t> endOfBlockComment(std::wstring_view text, std::size_t from)
{
    std::size_t depth = 0;
    for (std::size_t at = from; at + 1 < text.size();)
    {
        const auto mark = text.substr(at, 2);
        depth += mark == L"#|" ? 1U : 0U;
        depth -= mark == L"|#" ? 1U : 0U;
        at += mark == L"#|" || mark == L"|#" ? 2 : 1;
        if (depth == 0)
            return at;
    }
    return std::nullopt;
}

// Follows the nesting of forms as the standard reader would: by parentheses, and by the marks that stand
// before a form, such as quotes.
class NestingScanner
{
public:
    explicit NestingScanner(std::wstring_view text) : mText(text) {}

    std::optional<std::size_t> find(std::size_t limit)
    {
        while (mAt < mText.size())
        {
            step();
            if (mDepth + mMarks > limit)
                return mForm;
        }
        return std::nullopt;
    }

private:
    void step()
    {
        const wchar_t character = mText[mAt];
        if (kWhiteSpace.find(character) != std::wstring_view::npos)
            ++mAt;
        else if (character == L';')
            mAt = endOfLine(mText, mAt);
        else if (mText.substr(mAt).starts_with(L"#|"))
            mAt = endOfBlockComment(mText, mAt).value_or(mText.size());
        else
            stepIntoForm(character);
    }

    void stepIntoForm(wchar_t character)
    {
        if (mDepth + mMarks == 0)
            mForm = mAt;
        switch (character)
        {
        case L'(':
            open();
            break;
        case L')':
            close();
            break;
        case L'\'':
        case L'`':
        case L',':
            ++mMarks;
            ++mAt;
            break;
        case L'#':
            dispatch();
            break;
        case L'"':
            mAt = endOfQuoted(mText, mAt);
            mMarks = 0;
            break;
        default:
            skipToken();
        }
    }

    void open()
    {
        mLevels.push_back({mMarks + 1, mFeature ? mMarks : 0});
        mDepth += mMarks + 1;
        mMarks = 0;
        mFeature = false;
        ++mAt;
    }

    void close()
    {
        mMarks = 0;
        // A parenthesis too many closes nothing: the reader is to complain about it.
        if (!mLevels.empty())
        {
            mDepth -= mLevels.back().count;
            mMarks = mLevels.back().marksBehind;
            mLevels.pop_back();
        }
        ++mAt;
    }

    // #'f, #.form, #+feature, #:symbol, #xFF, #1=form, #1#, #(...), #\(
    void dispatch()
    {
        mAt = std::min(mText.find_first_not_of(L"0123456789", mAt + 1), mText.size());
        if (mAt == mText.size())
            return;
        if (mText[mAt] == L'\\')
        {
            mAt += 2; // the first character may be anything
            skipToken();
            return;
        }
        ++mMarks;
        mFeature = mText[mAt] == L'+' || mText[mAt] == L'-';
        if (mText[mAt] != L'(' && mText[mAt] != L'"')
            ++mAt;
    }

    void skipToken()
    {
        while (mAt < mText.size() && kTokenEnds.find(mText[mAt]) == std::wstring_view::npos)
        {
            if (mText[mAt] == L'|')
                mAt = endOfQuoted(mText, mAt);
            else
                mAt += mText[mAt] == L'\\' ? 2 : 1;
        }
        // The form that a feature is for is still to come.
        if (!mFeature)
            mMarks = 0;
        mFeature = false;
    }

    struct Level
    {
        std::size_t count;       // a parenthesis and the marks before it
        std::size_t marksBehind; // marks whose form is still to come
    };

    std::wstring_view mText;
    std::size_t mAt = 0;
    std::size_t mForm = 0;  // where the top-level form began
    std::size_t mDepth = 0; // levels that parentheses have closed over
    std::size_t mMarks = 0; // marks before the next form: each is a level until that form ends
    bool mFeature = false;  // behind #+ or #-
    std::vector<Level> mLevels;
};
} // namespace

std::optional<std::size_t> findTooDeepForm(std::wstring_view text, std::size_t limit)
{
    return NestingScanner(text).find(limit);
}

std::size_t countLineBreaks(std::wstring_view text)
{
    return static_cast<std::size_t>(std::count(text.begin(), text.end(), L'\n'));
}
} // namespace tessel
