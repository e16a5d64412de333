// The host's records of applications: what is called what, where it is and when it is loaded.
#pragma once

#include <string>
#include <utility>
#include <vector>

namespace tessel
{
struct ApplicationRecord
{
    std::wstring name;
    std::wstring module; // full path
    std::wstring description;
    unsigned loadReasons = 0;
    std::vector<std::pair<std::wstring, std::wstring>> commands; // global and local names
};

// Every record, in the order in which they were made.
std::vector<ApplicationRecord> allApplicationRecords();
} // namespace tessel
