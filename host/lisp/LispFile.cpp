#include "host/lisp/LispFile.h"

#include <algorithm>
#include <filesystem>
#include <optional>
#include <string_view>
#include <system_error>
#include <utility>

#include "host/lisp/CompiledLisp.h"
#include "host/lisp/LispSource.h"
#include "host/platform/OrdinaryFile.h"
#include "host/platform/SystemFailure.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
namespace fs = std::filesystem;

constexpr std::wstring_view kCompiledExtension = L".qbc";
constexpr std::wstring_view kExtensions[] = {L"", L".lsp", kCompiledExtension};
// Lisp keeps four bytes for a character, and more for what it makes of it.
constexpr std::uintmax_t kLargestLispFile = std::uintmax_t{32} << 20;
constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";

Failure missing(std::error_code error)
{
    return {systemFailure(error.value()).sentence, LispFile::kMissing};
}

struct FoundFile
{
    std::wstring name;
    fs::path path;
};

// An application may hand over a path as it is written on other systems.
std::wstring withSlashes(std::wstring path)
{
    std::replace(path.begin(), path.end(), L'\\', L'/');
    return path;
}

// The path as it stands comes first: a file name may contain a backslash.
Result<FoundFile> find(const std::wstring& given)
{
    if (given.find(L'\0') != std::wstring::npos)
        return missing(std::make_error_code(std::errc::invalid_argument));
    std::error_code first;
    std::error_code error;
    for (const auto& spelling : {given, withSlashes(given)})
        for (const auto extension : kExtensions)
        {
            const std::wstring name = spelling + std::wstring(extension);
            const fs::path path = toUtf8(name);
            const auto status = fs::status(path, error);
            if (fs::exists(status) && !(fs::is_directory(status) && extension.empty()))
                return FoundFile{given + std::wstring(extension), path};
            if (!first)
                first = error;
        }
    // The first error says more than those of the other names.
    if (fs::is_directory(fs::path(toUtf8(given)), error))
        return Failure{translated(L"it is a folder")};
    return missing(first);
}

// As it stands when the current folder is gone.
fs::path fullPath(const fs::path& path)
{
    std::error_code failed;
    auto full = fs::absolute(path, failed);
    return failed ? path : full;
}

Result<LispFile> decodeSource(const std::wstring& name, std::string_view bytes)
{
    if (bytes.starts_with(kByteOrderMark))
        bytes.remove_prefix(kByteOrderMark.size());
    std::wstring text = toWide(bytes);
    if (const auto form = findTooDeepForm(text))
    {
        const auto line = 1 + countLineBreaks(std::wstring_view(text).substr(0, *form));
        return Failure{translated(L"the form that begins in line {} is nested more than {} levels deep", line,
                                  kDeepestNesting)};
    }
    return LispFile{LispFile::Kind::kSource, name, std::move(text)};
}

Result<LispFile> decodeCompiled(const std::wstring& name, std::string_view bytes)
{
    const auto unpacked = unpackCompiledLisp(bytes);
    if (!unpacked)
        return unpacked.failure();
    return LispFile{LispFile::Kind::kCompiled, name, toWide(*unpacked)};
}

bool isCompiled(const std::wstring& name)
{
    return name.size() >= kCompiledExtension.size() &&
           equalIgnoringCase(std::wstring_view(name).substr(name.size() - kCompiledExtension.size()),
                             kCompiledExtension);
}

Result<LispFile> readFound(const FoundFile& found)
{
    const auto bytes = readOrdinaryFile(found.path, kLargestLispFile);
    if (!bytes)
        return bytes.failure();
    return isCompiled(found.name) ? decodeCompiled(found.name, *bytes) : decodeSource(found.name, *bytes);
}
} // namespace

std::wstring cannotLoad(const std::wstring& path, const std::wstring& reason)
{
    return translated(L"Cannot load \"{}\": {}.", path, reason);
}

Result<LispFile> readLispFile(const std::wstring& path, bool compiledFiles, const LispFileBegins& begins)
{
    const auto found = find(path);
    if (!found)
        return found.failure();
    if (!compiledFiles && isCompiled(found->name))
        return Failure{translated(L"this host does not load compiled Lisp")};
    if (auto begun = begins ? begins(fullPath(found->path)) : Result<>(); !begun)
        return begun.failure();
    return readFound(*found);
}
} // namespace tessel
