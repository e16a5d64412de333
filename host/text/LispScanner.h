// Follows the nesting of Lisp text as the standard reader would, without reading it as Lisp.
#pragma once

#include <cstddef>
#include <string_view>
#include <vector>

namespace tessel
{
// Walks over Lisp text as it arrives. A form is a level deeper for every parenthesis around it and for every
// mark that stands before it or before one of those parentheses, such as a quote: the reader calls itself for
// each.
class LispScanner
{
public:
    void take(std::wstring_view text);
    void take(wchar_t character);

    // Whether what was taken has an open parenthesis, string, |symbol| or #| comment |#.
    bool isOpen() const;

    // How deep the form is that comes next.
    std::size_t levels() const { return mDepth + mMarks; }

    // How many characters stand before the top-level form that was begun last.
    std::size_t startOfForm() const { return mStartOfForm; }

private:
    enum class State
    {
        kBetween, // tokens
        kToken,
        kEscapedInToken,
        kHash,      // after # and digits
        kCharacter, // after #\: the first character may be anything
        kLineComment,
        kQuoted, // a string or a |symbol|
        kEscapedInQuoted,
        kBlockComment
    };
    struct Level
    {
        std::size_t count;      // a parenthesis and the marks before it
        std::size_t marksAfter; // marks whose form is still to come when it closes
    };

    void step(wchar_t character);
    void stepBetween(wchar_t character);
    void stepIntoForm(wchar_t character);
    void stepToken(wchar_t character);
    void stepAfterHash(wchar_t character);
    void stepQuoted(wchar_t character);
    void stepBlockComment(wchar_t character);
    void open();
    void close();
    void mark();
    void beginQuoted(wchar_t quote);
    void endToken();

    State mState = State::kBetween;
    std::size_t mTaken = 0;
    std::size_t mStartOfForm = 0;
    std::vector<Level> mLevels;
    std::size_t mDepth = 0; // levels of all open parentheses
    std::size_t mMarks = 0; // before the next form
    bool mFeature = false;  // after #+ or #-: the form they are for comes second
    wchar_t mQuote = L'\0';
    std::size_t mCommentDepth = 0;
    wchar_t mBefore = L'\0'; // within a block comment: the character before, unless it ended a mark
};
} // namespace tessel
