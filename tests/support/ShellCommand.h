// Commands as a person types them into a shell.
#pragma once

#include <array>
#include <cstdio>
#include <string>

#include <sys/wait.h>

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
