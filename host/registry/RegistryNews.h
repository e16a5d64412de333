// Whether the registry holds, since the last start, what applications cannot know of: an administrator lays
// out something else, a registry file was taken in, or another profile is the current one. What waits for a
// command may want to be loaded at the start by now.
#pragma once

#include <string>

namespace tessel
{
class LayeredRegistry;

// Kept in the person's own registry. Where that cannot be written there is news at every start, which costs
// the loading of what would have waited.
class RegistryNews
{
public:
    RegistryNews(LayeredRegistry& registry, const std::wstring& productRoot);

    bool isThere() const;
    // Until something else happens.
    void noteRead();
    // For the next start.
    void noteChange();

private:
    std::wstring mark() const;
    void note(const std::wstring& mark);

    LayeredRegistry& mRegistry;
    const std::wstring mKey;
};
} // namespace tessel
