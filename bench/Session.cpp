#include "bench/Session.h"

#include <stdexcept>
#include <string>

#include "bench/TemporaryFolder.h"
#include "host/app/Host.h"

namespace bench
{
namespace
{
tessel::Host& host()
{
    static tessel::Host running({.profileFolder = workFolder() / "profile", .safe = true, .output = [](auto) {
                                 }});
    return running;
}
} // namespace

const std::filesystem::path& workFolder()
{
    static const TemporaryFolder folder("modrig-bench");
    return folder.path();
}

std::filesystem::path moduleIn(const std::filesystem::path& folder, std::size_t number)
{
    return folder / ("module" + std::to_string(number) + ".zmb");
}

std::filesystem::path folderOfModules(const std::string& name, std::size_t count)
{
    auto folder = workFolder() / name;
    std::filesystem::create_directories(folder);
    for (std::size_t i = 0; i < count; ++i)
        std::filesystem::copy_file(BENCH_MODULE, moduleIn(folder, i),
                                   std::filesystem::copy_options::skip_existing);
    return folder;
}

std::wstring wide(const std::filesystem::path& path)
{
    const std::string text = path.string();
    return {text.begin(), text.end()};
}

void startHost()
{
    static const bool started = host().start();
    if (!started)
        throw std::runtime_error("the host does not start");
}

void useProfile(const std::wstring& name)
{
    host().run(L"PROFILE " + name);
}

void endCommand()
{
    host().run(L"VERSION");
}
} // namespace bench
