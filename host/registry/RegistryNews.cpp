#include "host/registry/RegistryNews.h"

#include "host/registry/LayeredRegistry.h"

namespace tessel
{
namespace
{
constexpr wchar_t kLayoutMark[] = L"LayoutMark";
constexpr wchar_t kLikeNoLayout[] = L"changed";
} // namespace

RegistryNews::RegistryNews(LayeredRegistry& registry, const std::wstring& productRoot)
    : mRegistry(registry), mKey(productRoot + L"\\Applications")
{
}

// Whoever has never had anything laid out has no value.
std::wstring RegistryNews::mark() const
{
    return mRegistry.own().read(mKey, kLayoutMark).value_or(L"0");
}

bool RegistryNews::isThere() const
{
    return mark() != std::to_wstring(mRegistry.markOfLayers());
}

void RegistryNews::note(const std::wstring& mark)
{
    static_cast<void>(mRegistry.own().write(mKey, kLayoutMark, mark));
}

void RegistryNews::noteRead()
{
    if (isThere())
        note(std::to_wstring(mRegistry.markOfLayers()));
}

void RegistryNews::noteChange()
{
    note(kLikeNoLayout);
}
} // namespace tessel
