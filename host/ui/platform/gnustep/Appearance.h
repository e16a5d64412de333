// Light windows or dark ones: what the desktop's settings say.
#pragma once

#include <optional>
#include <string>

namespace tessel::windowing
{
enum class Appearance
{
    kLight,
    kDark
};

// What the host's own setting asks for: "light" or "dark"; nothing for any other text, as "auto".
std::optional<Appearance> appearanceOfSetting(const std::string& setting);

// What the environment's name of a GTK theme asks for, which beats the desktop's setting: "Adwaita:dark".
std::optional<Appearance> appearanceOfGtkTheme(const std::string& theme);

// What the desktop's portal answers about its colour scheme: 1 is dark, 2 is light, 0 is no preference.
std::optional<Appearance> appearanceOfPortal(const std::string& answer);

// The setting, or else what the environment, or else what the desktop asks for; light when none does.
// Waits a second for the desktop at most.
Appearance chosenAppearance(const std::string& setting);
} // namespace tessel::windowing
