// A Lisp file on its way to the interpreter: found, read, checked, decoded.
#pragma once

#include <filesystem>
#include <functional>
#include <string>

#include "host/text/Result.h"

namespace tessel
{
struct LispFile
{
    enum class Kind
    {
        kSource,
        kCompiled
    };
    static constexpr int kMissing = 2; // the code of a failure when there is no such file

    Kind kind = Kind::kSource;
    std::wstring name; // what messages call it: the path as given, with the extension that was added
    std::wstring text; // what Lisp is to read
};

// The whole sentence about a file that is not loaded, of the reason that follows here.
std::wstring cannotLoad(const std::wstring& path, const std::wstring& reason);

// The path may have separators of either kind, and may lack its extension. Text is taken as UTF-8; what is
// not is replaced. What Lisp would not survive is refused: text that is nested too deep, compiled Lisp that
// is not whole. Without `compiledFiles`, so is compiled Lisp altogether.
// `begins` is told the full path before the file is opened, and may refuse it. Why there is no file is the
// end of a sentence.
using LispFileBegins = std::function<Result<>(const std::filesystem::path& file)>;
Result<LispFile> readLispFile(const std::wstring& path, bool compiledFiles,
                              const LispFileBegins& begins = {});
} // namespace tessel
