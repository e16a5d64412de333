#include "host/messages/Browser.h"

#include <algorithm>
#include <string>

#include "host/messages/platform/Desktop.h"
#include "host/platform/Programs.h"

namespace tessel
{
bool openInBrowser(const std::filesystem::path& page)
{
    return hasDisplay() && std::ranges::any_of(pageOpeners(),
                                               [&page](const std::string& opener) {
                                                   return startProgram({opener, page.string()});
                                               });
}
} // namespace tessel
