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

// Lisp has nothing but text for an error, so that what became of a file has to be told from its sentence: who
// makes one that says why a file is not loaded makes it here, and who looks for one compares it with these.
std::wstring beginningOfRefusal(const std::wstring& path); // the name is the path, perhaps with an extension
std::wstring refusalBeforeReason(const std::wstring& name);
Failure refusedLispFile(const std::wstring& name, const std::wstring& reason,
                        int code = Failure::kUnspecified);

// The path may have separators of either kind, and may lack its extension. Text is taken as UTF-8; what is
// not is replaced. What Lisp would not survive is refused: text that is nested too deep, compiled Lisp that
// is not whole. Without `compiledFiles`, so is compiled Lisp altogether.
// `begins` is told the full path before the file is opened, and may refuse it.
using LispFileBegins = std::function<Result<>(const std::wstring& name, const std::filesystem::path& file)>;
Result<LispFile> readLispFile(const std::wstring& path, bool compiledFiles,
                              const LispFileBegins& begins = {});
} // namespace tessel
