// Whether a terminal that a descriptor leads to is to show colours.
#pragma once

#include <cstdlib>
#include <string_view>

#include <unistd.h>

namespace tessel
{
// By what people have agreed on: no colours for who sets NO_COLOR to anything, nor on a terminal that says it
// is dumb, or nothing at all.
inline bool showsColours(int descriptor)
{
    const auto variable = [](const char* name)
    {
        const char* value = std::getenv(name);
        return std::string_view(value ? value : "");
    };
    return isatty(descriptor) && variable("NO_COLOR").empty() && !variable("TERM").empty() &&
           variable("TERM") != "dumb";
}
} // namespace tessel
