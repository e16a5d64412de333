// Programs in the place of others, written for one test.
#pragma once

#include <filesystem>
#include <string>

#include "tests/support/TemporaryFolder.h"

// Writes a program into the folder that does what these lines of the shell say, and answers its path.
inline std::filesystem::path writeProgram(const TemporaryFolder& folder, const std::filesystem::path& name,
                                          const std::string& lines)
{
    const auto program = folder.write(name, "#!/bin/sh\n" + lines + "\n");
    std::filesystem::permissions(program, std::filesystem::perms::owner_all);
    return program;
}
