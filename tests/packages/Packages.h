// The packages, and what stands installed from them.
#pragma once

#include <array>
#include <cstdio>
#include <filesystem>
#include <string>

#include <sys/wait.h>
#include <unistd.h>

struct CommandOutcome
{
    int status = 0;
    std::string output; // errors included
};

inline CommandOutcome runCommand(const std::string& command)
{
    CommandOutcome outcome;
    FILE* pipe = popen(("{ " + command + "; } 2>&1").c_str(), "r");
    std::array<char, 4096> piece{};
    while (const std::size_t count = fread(piece.data(), 1, piece.size(), pipe))
        outcome.output.append(piece.data(), count);
    const int status = pclose(pipe);
    outcome.status = WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    return outcome;
}

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
