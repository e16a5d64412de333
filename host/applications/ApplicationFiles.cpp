#include "host/applications/ApplicationFiles.h"

#include <algorithm>
#include <array>
#include <string_view>

#include "host/platform/Bundle.h"
#include "host/platform/ImageCheck.h"
#include "host/platform/RegularFile.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr std::array<std::wstring_view, 3> kModules = {L".bundle", L".zmb", L".omp"};
constexpr std::array<std::wstring_view, 2> kLisp = {L".lsp", L".qbc"};
constexpr std::array<std::wstring_view, 1> kPackagedLisp = {L".rpk"};
constexpr std::array<std::wstring_view, 1> kMacroProjects = {L".mcp"};

template <std::size_t count>
bool hasOneOf(const std::array<std::wstring_view, count>& extensions, const std::filesystem::path& path)
{
    const std::wstring extension = toWide(path.extension().native());
    return std::ranges::any_of(extensions,
                               [&](std::wstring_view known) { return equalIgnoringCase(extension, known); });
}

bool isSharedLibrary(const std::filesystem::path& path)
{
    return static_cast<bool>(checkMappable(RegularFile(path.native())));
}
} // namespace

bool isCalledAsModule(const std::filesystem::path& path)
{
    return hasOneOf(kModules, path);
}

bool isCalledAsLisp(const std::filesystem::path& path)
{
    return hasOneOf(kLisp, path);
}

Result<> checkKindIsLoaded(const std::filesystem::path& path)
{
    if (hasOneOf(kPackagedLisp, path))
        return Failure{translated(L"it is a packaged Lisp application, a kind that Tessel does not load; "
                                  L"Lisp files (.lsp, .qbc) can be loaded")};
    if (hasOneOf(kMacroProjects, path))
        return Failure{translated(L"it is a macro project, a kind that Tessel does not load")};
    return {};
}

Result<> checkIsApplication(const std::filesystem::path& path)
{
    std::error_code failed;
    const auto status = std::filesystem::status(path, failed);
    if (!std::filesystem::exists(status))
        return Failure{translated(L"There is no application \"{}\" that could be kept out.", path)};
    const bool isFolder = std::filesystem::is_directory(status);
    if (isBundlePath(path.native()))
        return isFolder ? Result<>() : Failure{translated(L"\"{}\" is a file and no bundle.", path)};
    if (isFolder)
        return Failure{translated(L"\"{}\" is a folder and no application.", path)};
    if (isCalledAsModule(path) || isCalledAsLisp(path) || isSharedLibrary(path))
        return {};
    return Failure{
        translated(L"\"{}\" is no application: Tessel loads bundles, shared libraries (.zmb, .omp) "
                   L"and Lisp (.lsp, .qbc).",
                   path)};
}
} // namespace tessel
