#include "host/app/PersonalFolders.h"

#include <iterator>
#include <sstream>
#include <string>

#include "host/app/platform/DataHome.h"
#include "host/registry/RegistryLayers.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr wchar_t kLayoutKey[] = L"Software\\Tessel\\Layout";
constexpr char kProductFolder[] = "Tessel";
} // namespace

std::filesystem::path personalFolder()
{
    const auto dataHome = personalDataHome();
    return dataHome.empty() ? dataHome : dataHome / kProductFolder;
}

std::vector<std::filesystem::path> furtherLayoutFolders(const std::filesystem::path& folder)
{
    const auto layers = readRegistryLayers({folder});
    const auto* named = layers.policy.value(kLayoutKey, L"Folders");
    if (!named)
        named = layers.defaults.value(kLayoutKey, L"Folders");
    std::vector<std::filesystem::path> folders;
    std::istringstream all(named ? toUtf8(named->data) : "");
    for (std::string further; std::getline(all, further, ':');)
        if (std::filesystem::path(further).is_absolute())
            folders.emplace_back(further);
    return folders;
}

std::vector<std::filesystem::path> layoutFolders(const std::filesystem::path& toTry)
{
    auto folders = machineFolders();
    if (!toTry.empty())
        folders.insert(std::prev(folders.end()), toTry);
    auto further = furtherLayoutFolders(folders.back());
    folders.insert(folders.begin(), further.begin(), further.end());
    return folders;
}
} // namespace tessel
