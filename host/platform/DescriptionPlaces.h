// Where the platform's bundle class looks for the description of a bundle.
#pragma once

#include <string>
#include <vector>

namespace tessel
{
// Files below the bundle's folder: the first that is there is read.
std::vector<std::string> descriptionPlaces();
} // namespace tessel
