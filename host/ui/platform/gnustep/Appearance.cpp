#include "host/ui/platform/gnustep/Appearance.h"

#include <cstdlib>
#include <filesystem>

#include "host/platform/Programs.h"

namespace tessel::windowing
{
namespace
{
std::string environment(const char* name)
{
    const char* value = std::getenv(name);
    return value ? value : "";
}

// Without one the question would start a session bus of its own.
bool hasSessionBus()
{
    std::error_code ignored; // a folder that cannot be looked into has no bus for us
    return !environment("DBUS_SESSION_BUS_ADDRESS").empty() ||
           std::filesystem::exists(environment("XDG_RUNTIME_DIR") + "/bus", ignored);
}

// The portal may have to be started for the question, and a broken one never answers.
std::string portalAnswer()
{
    if (!hasSessionBus())
        return "";
    return outputOfProgram(
        {"gdbus", "call", "--session", "--timeout", "1", "--dest", "org.freedesktop.portal.Desktop",
         "--object-path", "/org/freedesktop/portal/desktop", "--method",
         "org.freedesktop.portal.Settings.Read", "org.freedesktop.appearance", "color-scheme"});
}
} // namespace

std::optional<Appearance> appearanceOfSetting(const std::string& setting)
{
    if (setting == "light")
        return Appearance::kLight;
    if (setting == "dark")
        return Appearance::kDark;
    return std::nullopt;
}

std::optional<Appearance> appearanceOfGtkTheme(const std::string& theme)
{
    if (theme.empty())
        return std::nullopt;
    return theme.ends_with(":dark") || theme.ends_with("-dark") ? Appearance::kDark : Appearance::kLight;
}

std::optional<Appearance> appearanceOfPortal(const std::string& answer)
{
    if (answer.find("uint32 1") != std::string::npos)
        return Appearance::kDark;
    if (answer.find("uint32 2") != std::string::npos)
        return Appearance::kLight;
    return std::nullopt;
}

Appearance chosenAppearance(const std::string& setting)
{
    if (const auto chosen = appearanceOfSetting(setting))
        return *chosen;
    if (const auto chosen = appearanceOfGtkTheme(environment("GTK_THEME")))
        return *chosen;
    return appearanceOfPortal(portalAnswer()).value_or(Appearance::kLight);
}
} // namespace tessel::windowing
