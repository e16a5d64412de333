// What applications and the platform leave to be released later is released at the end of a scope. These
// nest.
#pragma once

namespace tessel
{
class AutoreleasePool
{
public:
    AutoreleasePool();
    ~AutoreleasePool();
    AutoreleasePool(const AutoreleasePool&) = delete;
    AutoreleasePool& operator=(const AutoreleasePool&) = delete;

private:
    void* mPool; // of a class that only Objective-C knows
};
} // namespace tessel
