// The user's profiles: named sets of settings, one of which is current. Applications keep their own settings
// below the key of the current profile.
#pragma once

#include <string>
#include <vector>

#include "host/text/Result.h"

namespace tessel
{
class LayeredRegistry;

class Profiles
{
public:
    // Gives a new registry its first profile, "Default", unless a current profile is set already.
    Profiles(LayeredRegistry& registry, const std::wstring& productRoot);

    // The current profile's name; empty when the registry cannot be read.
    std::wstring current() const;

    // Its key, below which applications keep what is theirs.
    std::wstring currentKey() const { return mKey + L"\\" + current(); }

    // All of them, in the order in which they were made.
    std::vector<std::wstring> names() const;

    // Makes a profile the current one; one that is new begins empty. Fails when the name cannot be that of a
    // key or the registry cannot be written.
    Result<> setCurrent(const std::wstring& name);

private:
    LayeredRegistry& mRegistry;
    std::wstring mKey;
};
} // namespace tessel
