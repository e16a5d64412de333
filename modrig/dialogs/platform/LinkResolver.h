// Where many paths lead in the end.
#pragma once

#include <memory>

#include "modrig/base/CStdStr.h"

namespace ModrigPlatform
{
// Resolves the symbolic links in paths that are asked about at one time: it need not notice what becomes of
// a folder in the meantime.
class LinkResolver
{
public:
    LinkResolver() = default;
    virtual ~LinkResolver() = default;
    LinkResolver(const LinkResolver&) = delete;
    LinkResolver& operator=(const LinkResolver&) = delete;

    // Says that the path will be asked about, before any is: many in one folder are looked up together.
    virtual void Expect(const CStdStr& path) = 0;

    // What the toolkit's stringByResolvingSymlinksInPath makes of the path, expected or not. The answer is
    // good until the next call, or while the path is.
    [[nodiscard]] virtual const CStdStr& Resolve(const CStdStr& path) = 0;
};

[[nodiscard]] std::unique_ptr<LinkResolver> MakeLinkResolver();
} // namespace ModrigPlatform
