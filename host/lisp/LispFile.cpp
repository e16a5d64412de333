#include "host/lisp/LispFile.h"

#include <algorithm>
#include <cerrno>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <optional>
#include <string_view>
#include <system_error>

#include "host/lisp/CompiledLisp.h"
#include "host/lisp/LispSource.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
namespace fs = std::filesystem;

constexpr std::wstring_view kCompiledExtension = L".qbc";
constexpr std::wstring_view kExtensions[] = {L"", L".lsp", kCompiledExtension};
// Lisp keeps four bytes for a character, and more for what it makes of it.
constexpr std::uintmax_t kLargestFile = std::uintmax_t{32} << 20;
constexpr std::string_view kByteOrderMark = "\xEF\xBB\xBF";

LispFile refused(const std::wstring& name, const std::wstring& reason, LispFile::Kind kind)
{
    return {kind, name, L"Cannot load \"" + name + L"\": " + reason};
}

LispFile refused(const std::wstring& name, const std::wstring& reason)
{
    return refused(name, reason, LispFile::Kind::kRefused);
}

std::wstring systemText(std::error_code error)
{
    return toWide(error.message()) + L".";
}

struct FoundFile
{
    std::wstring name;
    fs::path path;
    fs::file_status status;
};

// An application may hand over a path as it is written on other systems.
std::wstring withSlashes(std::wstring path)
{
    std::replace(path.begin(), path.end(), L'\\', L'/');
    return path;
}

// The path as it stands comes first: a file name may contain a backslash.
std::optional<FoundFile> find(const std::wstring& given, std::error_code& error)
{
    if (given.find(L'\0') != std::wstring::npos)
    {
        error = std::make_error_code(std::errc::invalid_argument);
        return std::nullopt;
    }
    std::error_code first;
    for (const auto& spelling : {given, withSlashes(given)})
        for (const auto extension : kExtensions)
        {
            const std::wstring name = spelling + std::wstring(extension);
            const fs::path path = toUtf8(name);
            const auto status = fs::status(path, error);
            if (fs::exists(status) && !(fs::is_directory(status) && extension.empty()))
                return FoundFile{given + std::wstring(extension), path, status};
            if (!first)
                first = error;
        }
    error = first;
    return std::nullopt;
}

LispFile decodeSource(const std::wstring& name, std::string_view bytes)
{
    if (bytes.starts_with(kByteOrderMark))
        bytes.remove_prefix(kByteOrderMark.size());
    LispFile file{LispFile::Kind::kSource, name, toWide(bytes)};
    if (const auto form = findTooDeepForm(file.text))
    {
        const auto line = 1 + countLineBreaks(std::wstring_view(file.text).substr(0, *form));
        file.kind = LispFile::Kind::kRefused;
        file.text = name + L":" + std::to_wstring(line) +
                    L": The form that begins here is nested more than " + std::to_wstring(kDeepestNesting) +
                    L" levels deep.";
    }
    return file;
}

LispFile decodeCompiled(const std::wstring& name, std::string_view bytes)
{
    const auto unpacked = unpackCompiledLisp(bytes);
    if (!unpacked.ok)
        return refused(name, L"it " + unpacked.fault + L".");
    return {LispFile::Kind::kCompiled, name, toWide(unpacked.byteCode)};
}

bool isCompiled(const std::wstring& name)
{
    return name.size() >= kCompiledExtension.size() &&
           equalIgnoringCase(std::wstring_view(name).substr(name.size() - kCompiledExtension.size()),
                             kCompiledExtension);
}

LispFile read(const FoundFile& found)
{
    std::error_code error;
    // A pipe or a device might never end.
    if (!fs::is_regular_file(found.status))
        return refused(found.name, L"it is not a file.");
    if (fs::file_size(found.path, error) > kLargestFile && !error)
        return refused(found.name, L"it is larger than 32 MB.");
    errno = 0;
    std::ifstream stream(found.path, std::ios::binary);
    const std::string bytes{std::istreambuf_iterator<char>(stream), {}};
    if (!stream.is_open() || stream.bad())
        return refused(found.name, systemText({errno, std::generic_category()}));
    return isCompiled(found.name) ? decodeCompiled(found.name, bytes) : decodeSource(found.name, bytes);
}
} // namespace

LispFile readLispFile(const std::wstring& path, bool compiledFiles)
{
    std::error_code error;
    const auto found = find(path, error);
    if (!found)
    {
        std::error_code ignored; // the first error says more
        if (fs::is_directory(fs::path(toUtf8(path)), ignored))
            return refused(path, L"it is a folder.");
        return refused(path, systemText(error), LispFile::Kind::kMissing);
    }
    if (!compiledFiles && isCompiled(found->name))
        return refused(found->name, L"this host does not load compiled Lisp.");
    return read(*found);
}
} // namespace tessel
