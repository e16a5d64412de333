#include "host/app/Listings.h"

#include <functional>

#include "host/app/BuiltInSupport.h"
#include "host/app/Parts.h"
#include "host/applications/KeptOutWords.h"
#include "host/text/Json.h"
#include "host/text/Translation.h"
#include "host/text/Version.h"

namespace tessel
{
namespace
{
using Arguments = CommandStack::Arguments;

Result<> sayDocument(Parts& parts, const Json& document)
{
    return succeed(parts, json::written(document));
}

Json timeOf(const Parts& parts, const std::wstring& path)
{
    const LoadOutcome* outcome = parts.loadOutcomes.of(path);
    return outcome && outcome->loaded ? Json(outcome->took.count()) : Json();
}

Json loadedApplication(const Parts& parts, const std::wstring& path, const char* kind, bool locked)
{
    return {{"path", json::text(path)},
            {"kind", kind},
            {"isLocked", locked},
            {"loadedInMicroseconds", timeOf(parts, path)}};
}

Json loadedApplications(const Parts& parts)
{
    Json all = Json::array();
    for (const auto& module : parts.linker->loadedModules())
        all.push_back(loadedApplication(parts, module.path, "compiled", module.locked));
    for (int index = 0; index < parts.document->loadedApplicationCount(); ++index)
        all.push_back(loadedApplication(parts, parts.document->loadedApplicationName(index), "lisp", true));
    return all;
}

Json withReason(const std::wstring& path, const std::wstring& reason)
{
    return {{"path", json::text(path)}, {"reason", json::text(reason)}};
}

Result<> applications(Parts& parts, const Arguments& arguments)
{
    if (!arguments.empty())
        return wrongUsage(parts, L"APPS");
    Json keptOut = Json::array();
    for (const auto& application : parts.keptOut.all())
        if (application.isOut())
            keptOut.push_back(withReason(toWide(application.path), reasonOf(application)));
    Json failed = Json::array();
    for (const LoadOutcome& outcome : parts.loadOutcomes.failed())
        failed.push_back(withReason(outcome.path, outcome.loaded.sentence()));
    return sayDocument(parts,
                       {{"loaded", loadedApplications(parts)}, {"keptOut", keptOut}, {"notLoaded", failed}});
}

Result<> commandList(Parts& parts, const Arguments& arguments)
{
    if (!arguments.empty())
        return wrongUsage(parts, L"HELP");
    Json commands = Json::array();
    for (const auto& command : parts.commands->descriptions())
        commands.push_back({{"name", json::text(command.name)},
                            {"group", json::text(command.group)},
                            {"usage", json::text(command.usage)},
                            {"summary", json::text(command.summary)}});
    return sayDocument(parts, {{"commands", commands}});
}

Result<> versionOfProgram(Parts& parts, const Arguments& arguments)
{
    if (!arguments.empty())
        return wrongUsage(parts, L"VERSION");
    return sayDocument(parts, {{"program", kProgramName}, {"version", version()}});
}

Result<> profileList(Parts& parts, const Arguments& arguments)
{
    if (!arguments.empty())
        return wrongUsage(parts, L"PROFILE");
    return sayDocument(parts, {{"current", json::text(parts.profiles.current())},
                               {"profiles", json::listOfTexts(parts.profiles.names())}});
}

Json valueOf(const SystemVariables::Variable& variable)
{
    const auto* number = std::get_if<std::int16_t>(&variable.value);
    return number ? Json(*number) : json::text(toText(variable.value));
}

Result<> variableList(Parts& parts, const Arguments& arguments)
{
    if (arguments.size() > 1)
        return wrongUsage(parts, L"SETVAR");
    Json variables = Json::array();
    for (const auto& variable : parts.variables->all())
        if (arguments.empty() || equalIgnoringCase(variable.name, arguments.front()))
            variables.push_back({{"name", json::text(variable.name)},
                                 {"value", valueOf(variable)},
                                 {"purpose", json::text(variable.purpose)}});
    if (variables.empty())
        return Failure{translated(L"There is no variable called \"{}\".", arguments.front())};
    return sayDocument(parts, {{"variables", variables}});
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
    add(L"?", commandList);
    add(L"VERSION", versionOfProgram);
    add(L"PROFILE", profileList);
    add(L"SETVAR", variableList);
}
} // namespace tessel
