#include "modrig/dialogs/platform/LinkResolver.h"

#include "modrig/dialogs/Paths.h"

namespace ModrigPlatform
{
namespace
{
class PathByPath : public LinkResolver
{
public:
    void Expect(const CStdStr&) override {}

    const CStdStr& Resolve(const CStdStr& path) override
    {
        mResolved = ModrigUtils::ResolvedByToolkit(path);
        return mResolved;
    }

private:
    CStdStr mResolved;
};
} // namespace

std::unique_ptr<LinkResolver> MakeLinkResolver()
{
    return std::make_unique<PathByPath>();
}
} // namespace ModrigPlatform
