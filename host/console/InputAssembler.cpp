#include "host/console/InputAssembler.h"

#include <algorithm>
#include <utility>

namespace tessel
{
namespace
{
constexpr std::wstring_view kBlanks = L" \t\r";
constexpr std::wstring_view kWordEnds = L" \t\r\n()\"';";

std::wstring_view withoutLeadingBlanks(std::wstring_view text)
{
    return text.substr(std::min(text.find_first_not_of(kBlanks), text.size()));
}
} // namespace

bool isLisp(std::wstring_view text)
{
    return withoutLeadingBlanks(text).starts_with(L'(');
}

void LispScanner::take(std::wstring_view text)
{
    for (const wchar_t character : text)
        step(character);
}

bool LispScanner::isOpen() const
{
    return mDepth > 0 || mState == State::kQuoted || mState == State::kEscapedInQuoted ||
           mState == State::kBlockComment;
}

void LispScanner::step(wchar_t character)
{
    switch (mState)
    {
    case State::kPlain:
        return stepPlain(character);
    case State::kHash:
        return stepBehindHash(character);
    case State::kEscaped:
        mState = State::kPlain;
        return;
    case State::kCharacter:
        mState = State::kCharacterName;
        return;
    case State::kCharacterName:
        if (kWordEnds.find(character) != std::wstring_view::npos)
            stepPlain(character);
        return;
    case State::kLineComment:
        mState = character == L'\n' ? State::kPlain : State::kLineComment;
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

void LispScanner::stepPlain(wchar_t character)
{
    mState = State::kPlain;
    if (character == L'(')
        ++mDepth;
    // A parenthesis too many closes nothing: the interpreter is to complain about it.
    else if (character == L')' && mDepth > 0)
        --mDepth;
    else if (character == L'#')
        mState = State::kHash;
    else if (character == L'\\')
        mState = State::kEscaped;
    else if (character == L';')
        mState = State::kLineComment;
    else if (character == L'"' || character == L'|')
    {
        mQuote = character;
        mState = State::kQuoted;
    }
}

void LispScanner::stepBehindHash(wchar_t character)
{
    if (character == L'\\')
        mState = State::kCharacter;
    else if (character == L'|')
    {
        mState = State::kBlockComment;
        mCommentDepth = 1;
        mBefore = L'\0';
    }
    else
        stepPlain(character);
}

void LispScanner::stepQuoted(wchar_t character)
{
    if (character == L'\\')
        mState = State::kEscapedInQuoted;
    else if (character == mQuote)
        mState = State::kPlain;
}

// These nest. No character belongs to two marks.
void LispScanner::stepBlockComment(wchar_t character)
{
    const bool opens = mBefore == L'#' && character == L'|';
    const bool closes = mBefore == L'|' && character == L'#';
    mCommentDepth += (opens ? 1 : 0) - (closes ? 1 : 0);
    mBefore = opens || closes ? L'\0' : character;
    if (mCommentDepth == 0)
        mState = State::kPlain;
}

std::optional<std::wstring> InputAssembler::add(std::wstring_view line)
{
    const auto content = withoutLeadingBlanks(line);
    if (!isOpen() && (content.empty() || content.starts_with(L';')))
        return std::nullopt;
    if (!isOpen() && !isLisp(line))
        return std::wstring(line);
    const std::wstring added = (isOpen() ? L"\n" : L"") + std::wstring(line);
    mText += added;
    mScanner.take(added);
    if (mScanner.isOpen())
        return std::nullopt;
    mScanner = {};
    return std::exchange(mText, {});
}

void InputAssembler::discard()
{
    mText.clear();
    mScanner = {};
}
} // namespace tessel
