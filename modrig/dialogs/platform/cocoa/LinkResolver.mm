#include "modrig/dialogs/platform/LinkResolver.h"

#import <Foundation/Foundation.h>

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
        NSString* text = ModrigUtils::StringFromPath(path);
        mResolved = ModrigUtils::PathFromString([text stringByResolvingSymlinksInPath]);
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
