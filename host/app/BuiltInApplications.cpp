// LOAD, UNLOAD, APPS: applications without the dialog.
#include <algorithm>
#include <array>

#include "host/app/BuiltIn.h"
#include "host/app/BuiltInSupport.h"
#include "host/app/Parts.h"

namespace tessel
{
namespace
{
constexpr wchar_t kApplicationsGroup[] = L"Applications";
constexpr std::size_t kNameColumn = 24;
constexpr std::size_t kFolderColumn = 48;
constexpr std::array kLispExtensions = {L".lsp", L".qbc"};

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

Result<> loadLisp(Parts& parts, const std::wstring& path)
{
    const auto value = parts.lisp().evaluate(L"(load " + quoted(path) + L")");
    return value ? succeed(parts, path + L" is loaded.") : value.failure();
}

Result<> load(Parts& parts, const CommandStack::Arguments& arguments)
{
    if (arguments.size() != 1)
        return wrongUsage(parts, L"LOAD");
    const std::wstring path = fullPath(parts, arguments.front());
    if (isLispFile(path))
        return loadLisp(parts, path);
    if (!parts.linker->loadModule(path.c_str(), true, true))
        return Failure{}; // the linker has said why
    return succeed(parts, path + L" is loaded.");
}

Result<> unload(Parts& parts, const CommandStack::Arguments& arguments)
{
    if (arguments.size() != 1)
        return wrongUsage(parts, L"UNLOAD");
    const std::wstring path = fullPath(parts, arguments.front());
    if (isLispFile(path))
        return Failure{path + L" cannot be unloaded: Lisp stays until the session ends."};
    // The name alone is enough for what is loaded.
    const std::wstring loaded = parts.linker->pathOfModule(arguments.front());
    const std::wstring module = loaded.empty() ? path : loaded;
    if (!parts.linker->unloadModule(module.c_str(), true))
        return Failure{}; // the linker has said why
    return succeed(parts, module + L" is unloaded.");
}

void sayApplication(Parts& parts, const std::wstring& path, const std::wstring& state)
{
    const auto file = toPath(path);
    sayLine(parts, L"  " + padded(toText(file.filename()), kNameColumn) + L" " +
                       padded(toText(file.parent_path()), kFolderColumn) + L" " + state);
}

Result<> listApplications(Parts& parts, const CommandStack::Arguments&)
{
    const auto modules = parts.linker->loadedModules();
    for (const auto& module : modules)
        sayApplication(parts, module.path, module.locked ? L"locked" : L"may be unloaded");
    const int lispFiles = parts.document->loadedApplicationCount();
    for (int index = 0; index < lispFiles; ++index)
        sayApplication(parts, parts.document->loadedApplicationName(index), L"Lisp");
    if (modules.empty() && lispFiles == 0)
        sayLine(parts, L"No application is loaded.");
    for (const auto& application : parts.keptOut.all())
        if (application.isOut())
            sayApplication(parts, toWide(application.path), reasonOf(application));
    return {};
}
} // namespace

void addApplicationCommands(Parts& parts)
{
    addBuiltIn(parts, {kApplicationsGroup, L"LOAD", L"file", L"Loads a compiled module or a Lisp file"},
               load);
    addBuiltIn(parts, {kApplicationsGroup, L"UNLOAD", L"file", L"Unloads a compiled module"}, unload);
    addBuiltIn(parts, {kApplicationsGroup, L"APPS", L"", L"Lists what is loaded"}, listApplications);
}
} // namespace tessel
