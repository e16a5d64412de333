#include "host/platform/HomeFolder.h"

#include <algorithm>
#include <cstdlib>

#include <pwd.h>
#include <unistd.h>

namespace tessel
{
namespace
{
std::string homeOf(const std::string& user)
{
    const char* own = std::getenv("HOME");
    if (user.empty() && own && *own)
        return own;
    const passwd* entry = user.empty() ? getpwuid(getuid()) : getpwnam(user.c_str());
    return entry && entry->pw_dir ? entry->pw_dir : "";
}
} // namespace

std::string withHomeFolder(const std::string& typed)
{
    if (!typed.starts_with('~'))
        return typed;
    const std::size_t end = std::min(typed.find('/'), typed.size());
    std::string home = homeOf(typed.substr(1, end - 1));
    if (home.empty())
        return typed;
    while (home.ends_with('/') && end < typed.size()) // the root's
        home.pop_back();
    return home + typed.substr(end);
}
} // namespace tessel
