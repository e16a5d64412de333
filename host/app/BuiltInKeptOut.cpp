// DISABLE, ENABLE, BISECT: which applications are loaded at starts.
#include <algorithm>
#include <filesystem>

#include "host/app/BuiltIn.h"
#include "host/app/BuiltInSupport.h"
#include "host/app/Parts.h"
#include "host/applications/ApplicationFiles.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
using Texts = std::vector<std::wstring>;

bool isCalled(const std::wstring& path, const std::wstring& name)
{
    return equalIgnoringCase(toText(toPath(path).filename()), name);
}

bool isSameFile(const std::wstring& path, const std::wstring& other)
{
    std::error_code failed; // a file that is not there is the same as no other
    return path == other || std::filesystem::equivalent(toPath(path), toPath(other), failed);
}

// What applications have stored: in a safe session none of it was loaded, and nothing else knows of it.
void addStoredPaths(LayeredRegistry& registry, LayeredRegistry::Key key, const std::wstring& name,
                    Texts& paths)
{
    for (const auto& value : registry.values(key))
        if (isCalled(value.data, name) && toPath(value.data).is_absolute())
            paths.push_back(value.data);
    for (const std::wstring& child : registry.subKeys(key))
        addStoredPaths(registry, registry.find(child, key), name, paths);
}

void dropAllBut(Texts& paths, const std::wstring& name)
{
    std::erase_if(paths, [&](const auto& path)
                  { return !isCalled(path, name) || !checkIsApplication(toPath(path)); });
}

// Of the applications that the host knows the whole path of.
Texts applicationsCalled(Parts& parts, const std::wstring& name)
{
    Texts known;
    for (const auto& module : parts.linker->loadedModules())
        known.push_back(module.path);
    for (int index = 0; index < parts.document->loadedApplicationCount(); ++index)
        known.emplace_back(parts.document->loadedApplicationName(index));
    for (const auto& outcome : parts.loadOutcomes.failed())
        known.push_back(outcome.path);
    for (const auto& record : parts.records->all())
        known.push_back(record.module);
    known.push_back(toText(parts.folders.plugIns / toPath(name)));
    dropAllBut(known, name);
    if (!known.empty())
        return known;
    addStoredPaths(*parts.layered, parts.layered->find(parts.profiles.currentKey()), name, known);
    dropAllBut(known, name);
    return known;
}

Texts keptOutCalled(const Parts& parts, const std::wstring& name)
{
    Texts result;
    for (const auto& application : parts.keptOut.all())
        if (isCalled(toWide(application.path), name))
            result.push_back(toWide(application.path));
    return result;
}

// Of at least one.
Result<std::wstring> onlyOneOf(const Texts& paths, const std::wstring& typed)
{
    Texts different;
    for (const std::wstring& path : paths)
        if (std::ranges::none_of(different, [&](const auto& other) { return isSameFile(path, other); }))
            different.push_back(path);
    if (different.size() < 2)
        return different.front();
    std::wstring sentence =
        translated(L"Several applications are called \"{}\"; type the whole path of one:", typed);
    for (const std::wstring& path : different)
        sentence += L"\n  " + path;
    return Failure{sentence};
}

// The name alone is enough for what the host knows; a file of that name where the user is counts as well.
Result<std::wstring> pathToKeepOut(Parts& parts, const std::wstring& typed)
{
    Texts candidates = applicationsCalled(parts, typed);
    const std::wstring here = fullPath(parts, typed);
    const auto checked = checkIsApplication(toPath(here));
    if (checked)
        candidates.push_back(here);
    else if (candidates.empty())
        return checked.failure();
    return onlyOneOf(candidates, typed);
}

Result<std::wstring> pathToLetIn(const Parts& parts, const std::wstring& typed)
{
    Texts candidates = keptOutCalled(parts, typed);
    for (const std::string& suspect : parts.bisecting.keptOutNow())
        if (isCalled(toWide(suspect), typed))
            candidates.push_back(toWide(suspect));
    const std::wstring here = fullPath(parts, typed);
    if (const KeptOutApplication* known = parts.keptOut.find(toUtf8(here)); known || candidates.empty())
        candidates.push_back(known ? toWide(known->path) : here);
    return onlyOneOf(candidates, typed);
}

Result<> disable(Parts& parts, const CommandStack::Arguments& arguments)
{
    const auto typed = onlyFile(parts, L"DISABLE", arguments);
    const auto path = typed ? pathToKeepOut(parts, *typed) : typed;
    if (!path)
        return path.failure();
    if (auto kept = parts.keptOut.keepOut(toUtf8(*path)); !kept)
        return kept;
    return confirm(parts,
                   translated(L"{} is kept out at starts from now on; ENABLE lets it in again.", *path));
}

Result<> enable(Parts& parts, const CommandStack::Arguments& arguments)
{
    const auto typed = onlyFile(parts, L"ENABLE", arguments);
    const auto path = typed ? pathToLetIn(parts, *typed) : typed;
    if (!path)
        return path.failure();
    const std::wstring bisect =
        parts.bisecting.keepsOut(toUtf8(*path))
            ? translated(L"BISECT keeps it out at this start; BISECT STOP ends the search.")
            : std::wstring();
    if (!bisect.empty() && !parts.keptOut.find(toUtf8(*path)))
        return Failure{translated(L"\"{}\" is not let in by ENABLE: {}", *path, bisect)};
    if (auto let = parts.keptOut.letIn(toUtf8(*path)); !let)
        return let;
    return confirm(parts, bisect.empty()
                              ? translated(L"{} is not kept out at starts any more.", *path)
                              : translated(L"{} is not kept out at starts any more. But {}", *path, bisect));
}

Result<std::wstring> runBisect(Parts& parts, const std::wstring& word)
{
    if (equalIgnoringCase(word, L"START"))
        return parts.bisecting.begin(parts.admission.suspects());
    if (equalIgnoringCase(word, L"GOOD"))
        return parts.bisecting.answer(true, parts.admission.whyNotAsPlanned());
    if (equalIgnoringCase(word, L"BAD"))
        return parts.bisecting.answer(false, parts.admission.whyNotAsPlanned());
    if (equalIgnoringCase(word, L"STOP"))
        return parts.bisecting.stop();
    return word.empty() ? parts.bisecting.tell() : wrongUsage(parts, L"BISECT");
}

Result<> bisect(Parts& parts, const CommandStack::Arguments& arguments)
{
    if (arguments.size() > 1)
        return wrongUsage(parts, L"BISECT");
    const auto said = runBisect(parts, arguments.empty() ? std::wstring() : arguments.front());
    return said ? succeed(parts, *said) : said.failure();
}
} // namespace

void addKeptOutCommands(Parts& parts)
{
    addBuiltIn(parts, L"DISABLE", disable);
    addBuiltIn(parts, L"ENABLE", enable);
    addBuiltIn(parts, L"BISECT", bisect);
}
} // namespace tessel
