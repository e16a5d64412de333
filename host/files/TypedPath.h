// Paths as a person types them.
#pragma once

#include <filesystem>
#include <optional>

namespace tessel
{
// A tilde at the beginning stands for a home folder, unless something has just that name.
std::filesystem::path withTilde(const std::filesystem::path& typed);

// The path from the root on, in the one way of writing it: without ".", ".." and doubled slashes. What is
// reached by a link stays so; only above a link ".." leads to where its target is. None while the current
// folder is gone and the path counts from there.
std::optional<std::filesystem::path> wholePath(const std::filesystem::path& typed);
} // namespace tessel
