// SETVAR, PROFILE: how the host is set.
#include "host/app/BuiltIn.h"
#include "host/app/BuiltInSupport.h"
#include "host/app/Parts.h"
#include "host/text/Table.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr std::size_t kVariableColumn = 34;

std::wstring assignment(const SystemVariables::Variable& variable)
{
    return variable.name + L" = " + toText(variable.value);
}

Result<> listVariables(Parts& parts)
{
    Table table({kVariableColumn});
    for (const auto& variable : parts.variables->all())
        table.add({assignment(variable), inPersonsLanguage(variable.purpose)});
    parts.commandLine->show(table);
    return {};
}

Result<> showVariable(Parts& parts, const std::wstring& name)
{
    const auto* variable = parts.variables->find(name);
    if (!variable)
        return Failure{translated(L"There is no variable called \"{}\".", name)};
    sayLine(parts, assignment(*variable));
    return {};
}

Result<> setVariable(Parts& parts, const CommandStack::Arguments& arguments)
{
    if (arguments.empty())
        return listVariables(parts);
    if (arguments.size() == 1)
        return showVariable(parts, arguments.front());
    if (arguments.size() > 2)
        return wrongUsage(parts, L"SETVAR");
    return parts.variables->set(arguments[0], arguments[1]);
}

// The Startup Suite belongs to the profile.
Result<> changeProfile(Parts& parts, const std::wstring& name)
{
    const bool isAnother = !equalIgnoringCase(name, parts.profiles.current());
    const auto changed = parts.profiles.setCurrent(name);
    if (changed && isAnother)
        parts.registryNews.noteChange();
    return changed;
}

Result<> profile(Parts& parts, const CommandStack::Arguments& arguments)
{
    if (arguments.size() > 1)
        return wrongUsage(parts, L"PROFILE");
    if (arguments.size() == 1)
        return changeProfile(parts, arguments.front());
    sayLine(parts, parts.profiles.current());
    return {};
}
} // namespace

void addSettingCommands(Parts& parts)
{
    addBuiltIn(parts, L"SETVAR", setVariable);
    addBuiltIn(parts, L"PROFILE", profile);
}
} // namespace tessel
