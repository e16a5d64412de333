#include "tests/support/recording/RecordingLoans.h"

#include <map>
#include <new>

namespace
{
using Loans = std::map<const void*, const char*>;

// Made with the first loan and never destroyed: memory is freed before the program's first object is made
// and after its last one is gone.
constinit Loans* loans = nullptr;
} // namespace

void recording_loans::lend(const void* thing, const char* kind)
{
    if (!loans)
        loans = new Loans;
    loans->insert_or_assign(thing, kind);
}

void recording_loans::takeBack(const void* thing)
{
    if (loans)
        loans->erase(thing);
}

std::vector<std::string> recording_loans::outstanding()
{
    std::vector<std::string> kinds;
    if (loans)
        for (const auto& [thing, kind] : *loans)
            kinds.emplace_back(kind);
    return kinds;
}

void recording_loans::forgetAll()
{
    if (loans)
        loans->clear();
}

// The string of a variable is given back with a plain `delete[]`, so that is where its way back is seen. Both
// do what they do anyway, and belong together: who frees has to know how it was allocated.
void* operator new[](std::size_t size)
{
    return ::operator new(size);
}

void operator delete[](void* memory) noexcept
{
    recording_loans::takeBack(memory);
    ::operator delete(memory);
}

void operator delete[](void* memory, std::size_t) noexcept
{
    ::operator delete[](memory);
}
