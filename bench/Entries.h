// The entries of a stored History, for those that store it by themselves.
#pragma once

#include <cstddef>
#include <string>

namespace bench
{
// They are numbered from 1 on.
inline std::string entryName(std::size_t number)
{
    return std::to_string(number) + "History";
}

// Answers the path of an entry in UTF-8; counted from 0.
using PathOf = std::string (*)(std::size_t index);
} // namespace bench
