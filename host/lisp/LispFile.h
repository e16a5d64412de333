// A Lisp file on its way to the interpreter: found, read, checked, decoded.
#pragma once

#include <string>

namespace tessel
{
struct LispFile
{
    enum class Kind
    {
        kSource,
        kCompiled,
        kMissing, // there is no such file
        kRefused
    };
    Kind kind = Kind::kRefused;
    std::wstring name; // what messages call it: the path as given, with the extension that was added
    std::wstring
        text; // what Lisp is to read; for the last two kinds a sentence that says why there is nothing
};

// The path may have separators of either kind, and may lack its extension. Text is taken as UTF-8; what is
// not is replaced. What Lisp would not survive is refused: text that is nested too deep, compiled Lisp that
// is not whole. Without `compiledFiles`, so is compiled Lisp altogether.
LispFile readLispFile(const std::wstring& path, bool compiledFiles);
} // namespace tessel
