// LOAD, UNLOAD, APPS: applications without the dialog.
#include <limits>

#include "host/app/BuiltIn.h"
#include "host/app/BuiltInSupport.h"
#include "host/app/Parts.h"
#include "host/applications/ApplicationFiles.h"
#include "host/applications/KeptOutWords.h"
#include "host/text/Duration.h"
#include "host/text/Quotes.h"
#include "host/text/Table.h"
#include "host/text/TerminalText.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
constexpr std::size_t kNameColumn = 24;
constexpr std::size_t kFolderColumn = 48;
constexpr std::size_t kAnyLength = std::numeric_limits<std::size_t>::max();

bool isLispFile(const std::wstring& path)
{
    return isCalledAsLisp(toPath(path));
}

Result<> loadLisp(Parts& parts, const std::wstring& path)
{
    const auto value = parts.lisp->evaluate(L"(load " + inQuotes(path) + L")");
    return value ? confirm(parts, translated(L"{} is loaded.", path)) : value.failure();
}

// "ftp://host/file". A file may be called so all the same.
bool seemsAnAddress(const std::wstring& typed)
{
    const auto scheme = typed.substr(0, typed.find(L"://"));
    return !scheme.empty() && scheme.size() < typed.size() && scheme.find(L'/') == scheme.npos;
}

// The file to load; that of an address is fetched first.
Result<std::wstring> localFile(Parts& parts, const std::wstring& typed)
{
    const bool canBeFetched = parts.information->isUrl(typed.c_str());
    if (!canBeFetched && seemsAnAddress(typed) && !parts.files->find(toPath(typed)))
        return Failure{translated(
            L"The address {} cannot be loaded: only http and https addresses can be fetched.", typed)};
    if (!canBeFetched)
        return fullPath(parts, typed);
    const auto copy = parts.remote->fetch(typed, kAnyLength, false);
    return copy ? Result<std::wstring>(copy->path) : copy.failure();
}

Result<> load(Parts& parts, const CommandStack::Arguments& arguments)
{
    const auto typed = onlyFile(parts, L"LOAD", arguments);
    const auto file = typed ? localFile(parts, *typed) : typed;
    if (!file)
        return file.failure();
    const std::wstring& path = *file;
    if (isLispFile(path))
        return loadLisp(parts, path);
    auto loaded = parts.linker->load(path, kResolveNow);
    return loaded ? confirm(parts, translated(L"{} is loaded.", path)) : loaded;
}

Result<> unload(Parts& parts, const CommandStack::Arguments& arguments)
{
    const auto typed = onlyFile(parts, L"UNLOAD", arguments);
    if (!typed)
        return typed.failure();
    const std::wstring path = fullPath(parts, *typed);
    if (isLispFile(path))
        return Failure{translated(L"{} cannot be unloaded: Lisp stays until the session ends.", path)};
    // The name alone is enough for what is loaded.
    const std::wstring loaded = parts.linker->pathOfModule(*typed);
    const std::wstring module = loaded.empty() ? path : loaded;
    const auto unloaded = parts.linker->unload(module);
    if (!unloaded)
        return unloaded.failure();
    if (!unloaded->empty())
        sayLine(parts, *unloaded);
    return confirm(parts, translated(L"{} is unloaded.", module));
}

void addApplication(Table& table, const std::wstring& path, const std::wstring& state)
{
    const auto file = toPath(path);
    const auto cell = [](const std::filesystem::path& text)
    {
        return forTerminal(toText(text)); // an escape is wider than what it stands for
    };
    table.add({cell(file.filename()), cell(file.parent_path()), forTerminal(state)});
}

std::wstring withTime(const Parts& parts, const std::wstring& path, const std::wstring& state)
{
    const LoadOutcome* outcome = parts.loadOutcomes.of(path);
    return outcome && outcome->loaded ? translated(L"{}, loaded in {}", state, durationInWords(outcome->took))
                                      : state;
}

// What kept it out at the start may do so no longer.
std::wstring whyNotLoaded(const Parts& parts, const LoadOutcome& outcome)
{
    const bool wasKeptOut = Admission::isKeptOut(outcome.loaded.code());
    if (wasKeptOut && !parts.admission.keptOutAtStart(outcome.path))
        return translated(L"was kept out of this start and is let in by now");
    return outcome.loaded.sentence();
}

void addNotLoaded(const Parts& parts, Table& table)
{
    const auto failed = parts.loadOutcomes.failed();
    if (!failed.empty())
        table.addHeading(translated(L"Not loaded in this session:"));
    for (const LoadOutcome& outcome : failed)
        addApplication(table, outcome.path, whyNotLoaded(parts, outcome));
}

// What was asked for in vain for that very reason stands among those that were not loaded.
void addKeptOut(const Parts& parts, Table& table)
{
    for (const auto& application : parts.keptOut.all())
    {
        const std::wstring path = toWide(application.path);
        const LoadOutcome* outcome = parts.loadOutcomes.of(path);
        if (application.isOut() && !(outcome && Admission::isKeptOut(outcome->loaded.code())))
            addApplication(table, path, reasonOf(application));
    }
}

Result<> listApplications(Parts& parts, const CommandStack::Arguments&)
{
    Table table({kNameColumn, kFolderColumn});
    const auto modules = parts.linker->loadedModules();
    for (const auto& module : modules)
        addApplication(table, module.path,
                       withTime(parts, module.path,
                                module.locked ? translated(L"locked") : translated(L"may be unloaded")));
    const int lispFiles = parts.document->loadedApplicationCount();
    for (int index = 0; index < lispFiles; ++index)
    {
        const std::wstring path = parts.document->loadedApplicationName(index);
        addApplication(table, path, withTime(parts, path, L"Lisp"));
    }
    if (modules.empty() && lispFiles == 0)
        table.addHeading(translated(L"No application is loaded."));
    addKeptOut(parts, table);
    addNotLoaded(parts, table);
    parts.commandLine->show(table);
    return {};
}
} // namespace

void addApplicationCommands(Parts& parts)
{
    addBuiltIn(parts, L"LOAD", load);
    addBuiltIn(parts, L"UNLOAD", unload);
    addBuiltIn(parts, L"APPS", listApplications);
}
} // namespace tessel
