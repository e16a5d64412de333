#include "host/ui/platform/gnustep/Appearance.h"

#include <array>
#include <cstdio>
#include <cstdlib>
#include <filesystem>

namespace tessel::windowing
{
namespace
{
// The portal may have to be started for the question, and a broken one never answers.
constexpr char kAskPortal[] = "gdbus call --session --timeout 1 --dest org.freedesktop.portal.Desktop "
                              "--object-path /org/freedesktop/portal/desktop "
                              "--method org.freedesktop.portal.Settings.Read "
                              "org.freedesktop.appearance color-scheme 2>/dev/null </dev/null";

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

std::string portalAnswer()
{
    FILE* answer = hasSessionBus() ? popen(kAskPortal, "r") : nullptr;
    if (!answer)
        return "";
    std::array<char, 256> line{};
    const std::string text = fgets(line.data(), line.size(), answer) ? line.data() : "";
    pclose(answer); // that it failed shows in its answer
    return text;
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
