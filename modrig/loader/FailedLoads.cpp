#include "modrig/loader/FailedLoads.h"

#include <set>

namespace ModrigUtils
{
namespace
{
struct LessNoCase
{
    bool operator()(const CStdStr& left, const CStdStr& right) const { return left.CompareNoCase(right) < 0; }
};

std::set<CStdStr, LessNoCase>& FailedPaths()
{
    static std::set<CStdStr, LessNoCase> paths;
    return paths;
}
} // namespace

void NoteLoad(const CStdStr& path, bool succeeded)
{
    if (succeeded)
        FailedPaths().erase(path);
    else
        FailedPaths().insert(path);
}

bool LastLoadFailed(const CStdStr& path)
{
    return FailedPaths().contains(path);
}
} // namespace ModrigUtils
