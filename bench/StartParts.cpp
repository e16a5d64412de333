// What the host cannot start without, one part after the other and nothing else: the registry, and the
// Modrig bundle mapped by the platform. Linked with the host's objects, since its library hides its parts.
// With a number after the folders it also reads so many values of the History, one after the other, by the
// store's own calls; with "fill" after that it stores them, and does nothing else.
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <filesystem>
#include <string>

#include "bench/BareStore.h"
#include "host/applications/ModuleLibrary.h"
#include "host/registry/LayeredRegistry.h"
#include "host/registry/Profiles.h"
#include "host/registry/Registry.h"
#include "host/text/CommandLine.h"
#include "host/text/Running.h"
#include "host/text/Version.h"

namespace
{
constexpr wchar_t kHistory[] = L"Software\\Tessel\\R21\\Profiles\\Default\\Dialogs\\Modrig\\History";

std::wstring entryName(long number)
{
    return std::to_wstring(number) + L"History";
}

bool fill(tessel::Registry& registry, long count)
{
    bool written = static_cast<bool>(registry.write(kHistory, L"NumHistory", std::to_wstring(count)));
    for (long number = 1; number <= count; ++number)
        written = registry.write(kHistory, entryName(number),
                                 L"/home/user/Applications/library" + std::to_wstring(number / 100) +
                                     L"/tool" + std::to_wstring(number) + L".lsp") &&
                  written;
    return registry.endOfCommand() && written;
}
} // namespace

int main(int argc, char** argv)
{
    if (argc < 3 || argc > 5)
    {
        std::fputs("usage: bench_start_parts PROFILE-FOLDER BUNDLE [COUNT [fill]]\n", stderr);
        return 2;
    }
    const long count = argc > 3 ? std::atol(argv[3]) : 0;
    std::filesystem::create_directories(argv[1]);
    tessel::CommandLine commandLine([](std::string_view) {});
    const auto registryFile = std::filesystem::path(argv[1]) / "registry.db";
    tessel::Owned<tessel::Registry> registry(registryFile);
    tessel::LayeredRegistry layered(*registry);
    const tessel::Profiles profiles(layered, tessel::kProductRegistryRoot);
    if (!registry->endOfCommand())
        return 1;
    if (argc > 4)
        return std::strcmp(argv[4], "fill") == 0 && fill(*registry, count) ? 0 : 1;
    if (count > 0 && !bench::readBare(registryFile, static_cast<std::size_t>(count)))
        return 1;
    const auto file = tessel::moduleFileAt(argv[2]);
    if (!file)
        return 1;
    const auto bundle = tessel::ModuleLibrary::open(*file, true);
    return bundle && (*bundle)->entryPoint() ? 0 : 1;
}
