// Parts of the registry to files of their own and back: for other profiles, other machines, and to look at.
#pragma once

#include <filesystem>
#include <string>

#include "host/registry/RegistryText.h"
#include "host/text/Result.h"

namespace tessel
{
class Registry;

// The key, below HKEY_CURRENT_USER, with everything below it. Answers a sentence about it; fails with one. A
// file that stands there is replaced as a whole if it is a registry file, and otherwise stays.
Result<std::wstring> exportRegistry(Registry& registry, const std::wstring& key,
                                    const std::filesystem::path& file, RegistryTextForm form);

// All that the file asks for, or nothing. Answers and fails as above.
Result<std::wstring> importRegistry(Registry& registry, const std::filesystem::path& file);
} // namespace tessel
