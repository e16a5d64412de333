#include "host/registry/Profiles.h"

#include "host/registry/LayeredRegistry.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
constexpr wchar_t kCurrentProfileValue[] = L""; // the unnamed value of the key that holds the profiles
constexpr wchar_t kFirstProfile[] = L"Default";
constexpr std::size_t kLongestName = 255;

bool isProfileName(const std::wstring& name)
{
    return !name.empty() && name.size() <= kLongestName && name.find(L'\\') == name.npos;
}
} // namespace

Profiles::Profiles(LayeredRegistry& registry, const std::wstring& productRoot)
    : mRegistry(registry), mKey(productRoot + L"\\Profiles")
{
    if (!mRegistry.read(mKey, kCurrentProfileValue))
        // What is wrong is told by `canStore`.
        static_cast<void>(mRegistry.write(mKey, kCurrentProfileValue, kFirstProfile));
    // The rest of the start takes its time, and other sessions may start too.
    mRegistry.own().storeSoFar();
}

std::wstring Profiles::current() const
{
    return mRegistry.read(mKey, kCurrentProfileValue).value_or(L"");
}

std::vector<std::wstring> Profiles::names() const
{
    const auto key = mRegistry.find(mKey);
    return key == Registry::kNoKey ? std::vector<std::wstring>() : mRegistry.subKeys(key);
}

Result<> Profiles::setCurrent(const std::wstring& name)
{
    if (!isProfileName(name))
        return Failure{translated(L"\"{}\" cannot be the name of a profile.", name)};
    if (!mRegistry.write(mKey, kCurrentProfileValue, name))
        return Failure{
            translated(L"The profile cannot be changed to \"{}\": the registry cannot be written.", name)};
    return {};
}
} // namespace tessel
