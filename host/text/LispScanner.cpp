#include "host/text/LispScanner.h"

namespace tessel
{
namespace
{
constexpr std::wstring_view kWhiteSpace = L" \t\r\n\f\v";
constexpr std::wstring_view kTokenEnds = L" \t\r\n\f\v()\"';`,";
constexpr std::wstring_view kDigits = L"0123456789";
// What # does not take for its own: a list or a string is its form, the others are errors for the reader to
// find.
constexpr std::wstring_view kNotOfHash = L"()\";";

bool isOneOf(std::wstring_view set, wchar_t character)
{
    return set.find(character) != std::wstring_view::npos;
}
} // namespace

void LispScanner::take(std::wstring_view text)
{
    for (const wchar_t character : text)
        take(character);
}

void LispScanner::take(wchar_t character)
{
    step(character);
    ++mTaken;
}

bool LispScanner::isOpen() const
{
    return !mLevels.empty() || mState == State::kQuoted || mState == State::kEscapedInQuoted ||
           mState == State::kBlockComment;
}

void LispScanner::step(wchar_t character)
{
    switch (mState)
    {
    case State::kBetween:
        return stepBetween(character);
    case State::kToken:
        return stepToken(character);
    case State::kEscapedInToken:
    case State::kCharacter:
        mState = State::kToken;
        return;
    case State::kHash:
        return stepAfterHash(character);
    case State::kLineComment:
        mState = character == L'\n' ? State::kBetween : State::kLineComment;
        return;
    case State::kQuoted:
        return stepQuoted(character);
    case State::kEscapedInQuoted:
        mState = State::kQuoted;
        return;
    case State::kBlockComment:
        return stepBlockComment(character);
    }
}

void LispScanner::stepBetween(wchar_t character)
{
    if (character == L';')
        mState = State::kLineComment;
    else if (!isOneOf(kWhiteSpace, character))
        stepIntoForm(character);
}

void LispScanner::stepIntoForm(wchar_t character)
{
    if (levels() == 0)
        mStartOfForm = mTaken;
    switch (character)
    {
    case L'(':
        return open();
    case L')':
        return close();
    case L'\'':
    case L'`':
    case L',':
        return mark();
    case L'#':
        mState = State::kHash;
        return;
    case L'"':
        return beginQuoted(character);
    default:
        mState = State::kToken;
        stepToken(character);
    }
}

void LispScanner::open()
{
    mLevels.push_back({mMarks + 1, mFeature ? mMarks : 0});
    mDepth += mMarks + 1;
    mMarks = 0;
    mFeature = false;
}

void LispScanner::close()
{
    mMarks = 0;
    // A parenthesis too many closes nothing: the interpreter is to complain about it.
    if (mLevels.empty())
        return;
    mDepth -= mLevels.back().count;
    mMarks = mLevels.back().marksAfter;
    mLevels.pop_back();
}

void LispScanner::mark()
{
    ++mMarks;
    mState = State::kBetween;
}

void LispScanner::beginQuoted(wchar_t quote)
{
    mQuote = quote;
    mState = State::kQuoted;
}

void LispScanner::stepToken(wchar_t character)
{
    if (isOneOf(kTokenEnds, character))
    {
        endToken();
        stepBetween(character);
    }
    else if (character == L'|')
        beginQuoted(character);
    else if (character == L'\\')
        mState = State::kEscapedInToken;
}

void LispScanner::endToken()
{
    mState = State::kBetween;
    if (!mFeature)
        mMarks = 0;
    mFeature = false;
}

// #'f, #.form, #+feature, #:symbol, #xFF, #1=form, #1#, #(...), #\(, #|...|#
void LispScanner::stepAfterHash(wchar_t character)
{
    if (isOneOf(kDigits, character))
        return;
    if (character == L'\\')
        mState = State::kCharacter;
    else if (character == L'|')
    {
        mState = State::kBlockComment;
        mCommentDepth = 1;
        mBefore = L'\0';
    }
    else
    {
        mark();
        mFeature = character == L'+' || character == L'-';
        if (isOneOf(kNotOfHash, character))
            stepBetween(character);
    }
}

void LispScanner::stepQuoted(wchar_t character)
{
    if (character == L'\\')
        mState = State::kEscapedInQuoted;
    else if (character == mQuote && mQuote == L'|')
        mState = State::kToken;
    else if (character == mQuote)
    {
        mState = State::kBetween;
        mMarks = 0;
    }
}

// These nest. No character belongs to two marks.
void LispScanner::stepBlockComment(wchar_t character)
{
    const bool opens = mBefore == L'#' && character == L'|';
    const bool closes = mBefore == L'|' && character == L'#';
    mCommentDepth += opens ? 1U : 0U;
    mCommentDepth -= closes ? 1U : 0U;
    mBefore = opens || closes ? L'\0' : character;
    if (mCommentDepth == 0)
        mState = State::kBetween;
}
} // namespace tessel
