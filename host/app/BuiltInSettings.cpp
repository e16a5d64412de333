// SETVAR, PROFILE: how the host is set.
#include "host/Services.h"
#include "host/app/BuiltIn.h"
#include "host/app/BuiltInSupport.h"
#include "host/registry/Profiles.h"
#include "host/registry/SystemVariables.h"

namespace tessel
{
namespace
{
constexpr wchar_t kGroup[] = L"Settings";
constexpr std::size_t kVariableColumn = 34;

std::wstring assignment(const SystemVariables::Variable& variable)
{
    return variable.name + L" = " + toText(variable.value);
}

Result<> listVariables()
{
    for (const auto& variable : services().variables->all())
        sayLine(L"  " + padded(assignment(variable), kVariableColumn) + L" " + variable.purpose);
    return {};
}

Result<> showVariable(const std::wstring& name)
{
    const auto* variable = services().variables->find(name);
    if (!variable)
        return Failure{L"There is no variable called \"" + name + L"\"."};
    sayLine(assignment(*variable));
    return {};
}

Result<> setVariable(const CommandStack::Arguments& arguments)
{
    if (arguments.empty())
        return listVariables();
    if (arguments.size() == 1)
        return showVariable(arguments.front());
    if (arguments.size() > 2)
        return wrongUsage(L"SETVAR");
    return services().variables->set(arguments[0], arguments[1]);
}

Result<> profile(const CommandStack::Arguments& arguments)
{
    if (arguments.size() > 1)
        return wrongUsage(L"PROFILE");
    if (arguments.size() == 1)
        return setCurrentProfile(arguments.front());
    sayLine(currentProfile());
    return {};
}
} // namespace

void addSettingCommands(CommandStack& commands)
{
    commands.addBuiltIn({kGroup, L"SETVAR", L"[name [value]]", L"Shows or sets system variables"},
                        setVariable);
    commands.addBuiltIn({kGroup, L"PROFILE", L"[name]", L"Shows or changes the current profile"}, profile);
}
} // namespace tessel
