// Makes whole inputs of typed lines: one line for a command, as many as it takes for Lisp.
#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace tessel
{
// Whether the text begins with a parenthesis, blanks aside: then it is Lisp, not a command.
bool isLisp(std::wstring_view text);

// Walks over Lisp text as it arrives and keeps count of what is open. Knows only as much of the reader's
// syntax as can hide a parenthesis.
class LispScanner
{
public:
    void take(std::wstring_view text);

    // Whether what was taken has an open parenthesis, string, |symbol| or #| comment |#.
    bool isOpen() const;

private:
    enum class State
    {
        kPlain,
        kHash,          // behind #
        kEscaped,       // behind a backslash
        kCharacter,     // behind #\: the first character may be anything
        kCharacterName, // within #\Space
        kLineComment,
        kQuoted, // a string or a |symbol|
        kEscapedInQuoted,
        kBlockComment
    };

    void step(wchar_t character);
    void stepPlain(wchar_t character);
    void stepBehindHash(wchar_t character);
    void stepQuoted(wchar_t character);
    void stepBlockComment(wchar_t character);

    State mState = State::kPlain;
    int mDepth = 0;
    int mCommentDepth = 0;
    wchar_t mQuote = L'\0';
    wchar_t mBefore = L'\0'; // within a block comment: the character before, unless it ended a mark
};

class InputAssembler
{
public:
    // Takes the next line and answers an input that is complete with it. Nothing for a blank line, for a
    // comment (it begins with a semicolon) and for Lisp that goes on.
    std::optional<std::wstring> add(std::wstring_view line);

    // Whether Lisp has begun that is not complete yet.
    bool isOpen() const { return !mText.empty(); }

    void discard();

private:
    std::wstring mText;
    LispScanner mScanner; // has taken the text
};
} // namespace tessel
