// LOAD, UNLOAD, APPS: applications without the dialog.
#include <algorithm>
#include <array>

#include <tessel/tsdocument.h>
#include <tessel/tsed.h>

#include "host/Services.h"
#include "host/app/BuiltIn.h"
#include "host/app/BuiltInSupport.h"
#include "host/applications/DynamicLinker.h"
#include "host/lisp/LispInterpreter.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr wchar_t kGroup[] = L"Applications";
constexpr std::size_t kLongestPath = 8192;
constexpr std::size_t kNameColumn = 24;
constexpr std::size_t kFolderColumn = 48;
constexpr std::array kLispExtensions = {L".lsp", L".qbc"};

// Where the file is, along the host's search path; a file that is not found is looked for where the user is,
// so that what is said about it names a whole path.
std::wstring fullPath(const std::wstring& typed)
{
    std::array<wchar_t, kLongestPath> found{};
    if (tsedFindFile(typed.c_str(), found.data(), found.size()) == TS_NORMAL)
        return found.data();
    std::error_code currentFolderIsGone;
    const auto path = std::filesystem::absolute(toPath(typed), currentFolderIsGone);
    return toText(path.has_filename() ? path : path.parent_path());
}

bool isLispFile(const std::wstring& path)
{
    const std::wstring extension = toText(toPath(path).extension());
    return std::ranges::any_of(kLispExtensions,
                               [&](const wchar_t* lisp) { return equalIgnoringCase(extension, lisp); });
}

// A Lisp string that the reader takes for this very text.
std::wstring quoted(const std::wstring& text)
{
    std::wstring result = L"\"";
    for (const wchar_t character : text)
    {
        if (character == L'"' || character == L'\\')
            result += L'\\';
        result += character;
    }
    return result + L"\"";
}

Result<> loadLisp(const std::wstring& path)
{
    const auto value = services().lisp->evaluate(L"(load " + quoted(path) + L")");
    return value ? succeed(path + L" is loaded.") : value.failure();
}

Result<> load(const CommandStack::Arguments& arguments)
{
    if (arguments.size() != 1)
        return wrongUsage(L"LOAD");
    const std::wstring path = fullPath(arguments.front());
    if (isLispFile(path))
        return loadLisp(path);
    if (!services().linker->loadModule(path.c_str(), true, true))
        return Failure{}; // the linker has said why
    return succeed(path + L" is loaded.");
}

Result<> unload(const CommandStack::Arguments& arguments)
{
    if (arguments.size() != 1)
        return wrongUsage(L"UNLOAD");
    const std::wstring path = fullPath(arguments.front());
    if (isLispFile(path))
        return Failure{path + L" cannot be unloaded: Lisp stays until the session ends."};
    // The name alone is enough for what is loaded.
    const std::wstring loaded = services().linker->pathOfModule(arguments.front());
    const std::wstring module = loaded.empty() ? path : loaded;
    if (!services().linker->unloadModule(module.c_str(), true))
        return Failure{}; // the linker has said why
    return succeed(module + L" is unloaded.");
}

void sayApplication(const std::wstring& path, const std::wstring& state)
{
    const auto file = toPath(path);
    sayLine(L"  " + padded(toText(file.filename()), kNameColumn) + L" " +
            padded(toText(file.parent_path()), kFolderColumn) + L" " + state);
}

Result<> listApplications(const CommandStack::Arguments&)
{
    const auto modules = services().linker->loadedModules();
    for (const auto& module : modules)
        sayApplication(module.path, module.locked ? L"locked" : L"may be unloaded");
    const TsApDocument* document = curDoc();
    const int lispFiles = document ? document->loadedApplicationCount() : 0;
    for (int index = 0; index < lispFiles; ++index)
        sayApplication(document->loadedApplicationName(index), L"Lisp");
    if (modules.empty() && lispFiles == 0)
        sayLine(L"No application is loaded.");
    return {};
}
} // namespace

void addApplicationCommands(CommandStack& commands)
{
    commands.addBuiltIn({kGroup, L"LOAD", L"file", L"Loads a compiled module or a Lisp file"}, load);
    commands.addBuiltIn({kGroup, L"UNLOAD", L"file", L"Unloads a compiled module"}, unload);
    commands.addBuiltIn({kGroup, L"APPS", L"", L"Lists what is loaded"}, listApplications);
}
} // namespace tessel
