// SETVAR, PROFILE: how the host is set.
#include "host/app/BuiltIn.h"
#include "host/app/BuiltInSupport.h"
#include "host/app/Parts.h"

namespace tessel
{
namespace
{
constexpr wchar_t kSettingsGroup[] = L"Settings";
constexpr std::size_t kVariableColumn = 34;

std::wstring assignment(const SystemVariables::Variable& variable)
{
    return variable.name + L" = " + toText(variable.value);
}

Result<> listVariables(Parts& parts)
{
    for (const auto& variable : parts.variables->all())
        sayLine(parts, L"  " + padded(assignment(variable), kVariableColumn) + L" " + variable.purpose);
    return {};
}

Result<> showVariable(Parts& parts, const std::wstring& name)
{
    const auto* variable = parts.variables->find(name);
    if (!variable)
        return Failure{L"There is no variable called \"" + name + L"\"."};
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

Result<> profile(Parts& parts, const CommandStack::Arguments& arguments)
{
    if (arguments.size() > 1)
        return wrongUsage(parts, L"PROFILE");
    if (arguments.size() == 1)
        return parts.profiles.setCurrent(arguments.front());
    sayLine(parts, parts.profiles.current());
    return {};
}
} // namespace

void addSettingCommands(Parts& parts)
{
    addBuiltIn(parts, {kSettingsGroup, L"SETVAR", L"[name [value]]", L"Shows or sets system variables"},
               setVariable);
    addBuiltIn(parts, {kSettingsGroup, L"PROFILE", L"[name]", L"Shows or changes the current profile"},
               profile);
}
} // namespace tessel
