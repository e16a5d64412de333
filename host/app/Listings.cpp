#include "host/app/Listings.h"

#include <functional>

#include "host/app/BuiltInSupport.h"
#include "host/app/Parts.h"
#include "host/applications/KeptOutWords.h"
#include "host/text/Json.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
using Arguments = CommandStack::Arguments;
using Texts = std::vector<std::wstring>;

Result<> sayDocument(Parts& parts, const json::Fields& fields)
{
    return succeed(parts, json::object(fields));
}

std::wstring timeOf(const Parts& parts, const std::wstring& path)
{
    const LoadOutcome* outcome = parts.loadOutcomes.of(path);
    return outcome && outcome->loaded ? std::to_wstring(outcome->took.count()) : L"null";
}

std::wstring loadedApplication(const Parts& parts, const std::wstring& path, const wchar_t* kind, bool locked)
{
    return json::object({{L"path", json::text(path)},
                         {L"kind", json::text(kind)},
                         {L"isLocked", json::truth(locked)},
                         {L"loadedInMicroseconds", timeOf(parts, path)}});
}

std::wstring loadedApplications(const Parts& parts)
{
    Texts all;
    for (const auto& module : parts.linker->loadedModules())
        all.push_back(loadedApplication(parts, module.path, L"compiled", module.locked));
    for (int index = 0; index < parts.document->loadedApplicationCount(); ++index)
        all.push_back(loadedApplication(parts, parts.document->loadedApplicationName(index), L"lisp", true));
    return json::list(all);
}

std::wstring withReason(const std::wstring& path, const std::wstring& reason)
{
    return json::object({{L"path", json::text(path)}, {L"reason", json::text(reason)}});
}

Result<> applications(Parts& parts, const Arguments& arguments)
{
    if (!arguments.empty())
        return wrongUsage(parts, L"APPS");
    Texts keptOut;
    for (const auto& application : parts.keptOut.all())
        if (application.isOut())
            keptOut.push_back(withReason(toWide(application.path), reasonOf(application)));
    Texts failed;
    for (const LoadOutcome& outcome : parts.loadOutcomes.failed())
        failed.push_back(withReason(outcome.path, outcome.loaded.sentence()));
    return sayDocument(parts, {{L"loaded", loadedApplications(parts)},
                               {L"keptOut", json::list(keptOut)},
                               {L"notLoaded", json::list(failed)}});
}

Result<> commandList(Parts& parts, const Arguments& arguments)
{
    if (!arguments.empty())
        return wrongUsage(parts, L"HELP");
    Texts commands;
    for (const auto& command : parts.commands->descriptions())
        commands.push_back(json::object({{L"name", json::text(command.name)},
                                         {L"group", json::text(command.group)},
                                         {L"usage", json::text(command.usage)},
                                         {L"summary", json::text(command.summary)}}));
    return sayDocument(parts, {{L"commands", json::list(commands)}});
}

Result<> profileList(Parts& parts, const Arguments& arguments)
{
    if (!arguments.empty())
        return wrongUsage(parts, L"PROFILE");
    const auto key = parts.layered->find(std::wstring(kProductRegistryRoot) + L"\\Profiles");
    const Texts names = key == Registry::kNoKey ? Texts() : parts.layered->subKeys(key);
    return sayDocument(
        parts, {{L"current", json::text(parts.profiles.current())}, {L"profiles", json::listOfTexts(names)}});
}

std::wstring valueOf(const SystemVariables::Variable& variable)
{
    const bool isNumber = std::holds_alternative<std::int16_t>(variable.value);
    return isNumber ? toText(variable.value) : json::text(toText(variable.value));
}

Result<> variableList(Parts& parts, const Arguments& arguments)
{
    if (arguments.size() > 1)
        return wrongUsage(parts, L"SETVAR");
    Texts variables;
    for (const auto& variable : parts.variables->all())
        if (arguments.empty() || equalIgnoringCase(variable.name, arguments.front()))
            variables.push_back(json::object({{L"name", json::text(variable.name)},
                                              {L"value", valueOf(variable)},
                                              {L"purpose", json::text(variable.purpose)}}));
    if (variables.empty())
        return Failure{translated(L"There is no variable called \"{}\".", arguments.front())};
    return sayDocument(parts, {{L"variables", json::list(variables)}});
}
} // namespace

void addListings(Parts& parts)
{
    const auto add = [&parts](const wchar_t* name, BuiltInCommand* listing)
    {
        parts.commands->addListing(name, std::bind_front(listing, std::ref(parts)));
    };
    add(L"APPS", applications);
    add(L"HELP", commandList);
    add(L"PROFILE", profileList);
    add(L"SETVAR", variableList);
}
} // namespace tessel
