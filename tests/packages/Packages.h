// The packages, and what stands installed from them.
#pragma once

#include <filesystem>
#include <string>

#include <unistd.h>

#include "tests/support/ShellCommand.h"

// The file of a package: "tessel", "tessel-dev", "modrig".
inline std::filesystem::path packageFile(const std::string& name)
{
    for (const auto& entry : std::filesystem::directory_iterator(PACKAGES))
        if (entry.path().filename().string().starts_with(name + "_" MODRIG_VERSION "_"))
            return entry.path();
    return {};
}

// What runs a command as somebody who may not write what is installed.
inline std::string asOrdinaryUser()
{
    return geteuid() == 0 ? "setpriv --reuid=65534 --regid=65534 --clear-groups " : "";
}
