// The user's profiles: named sets of settings, one of which is current. Applications keep their own settings
// below the key of the current profile.
#pragma once

#include <string>

#include "host/text/Result.h"

namespace tessel
{
// The current profile's name; empty when the registry cannot be read.
std::wstring currentProfile();

// Makes a profile the current one; one that is new begins empty. Fails when the name cannot be that of a key
// or the registry cannot be written.
Result<> setCurrentProfile(const std::wstring& name);
} // namespace tessel
