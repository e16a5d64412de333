// Makes whole inputs out of typed lines: one line for a command, as many as it takes for Lisp.
#pragma once

#include <optional>
#include <string>
#include <string_view>

#include "host/text/LispScanner.h"

namespace tessel
{
// Whether the text begins with a parenthesis, blanks aside: then it is Lisp, not a command.
bool isLisp(std::wstring_view text);

class InputAssembler
{
public:
    // Takes the next line and answers an input that is complete with it. Nothing for a blank line, for a
    // comment (it begins with a semicolon) and for Lisp that goes on.
    std::optional<std::wstring> add(std::wstring_view line);

    // Whether Lisp has begun that is not complete yet.
    bool isOpen() const { return !mText.empty(); }
    // The lines of it so far; otherwise empty.
    const std::wstring& begun() const { return mText; }

    void discard();

private:
    std::wstring mText;
    LispScanner mScanner; // has taken the text
};
} // namespace tessel
