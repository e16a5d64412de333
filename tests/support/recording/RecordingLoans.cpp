#include "tests/support/recording/RecordingLoans.h"

#include <map>

namespace
{
using Loans = std::map<const void*, const char*>;

// Made with the first loan and never destroyed: things are given back after the program's last object is
// gone.
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
