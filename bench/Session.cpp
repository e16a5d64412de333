#include "bench/Session.h"

#include <cstdlib>
#include <memory>
#include <stdexcept>
#include <string>
#include <system_error>

#include "host/app/Host.h"

namespace bench
{
namespace
{
class WorkFolder
{
public:
    WorkFolder()
    {
        std::string name = (std::filesystem::temp_directory_path() / "modrig-bench-XXXXXX").string();
        if (!mkdtemp(name.data()))
            throw std::runtime_error("cannot make a folder for the benchmarks");
        mPath = name;
    }
    ~WorkFolder()
    {
        std::error_code ignored; // what cannot be removed is the system's to clean
        std::filesystem::remove_all(mPath, ignored);
    }
    WorkFolder(const WorkFolder&) = delete;
    WorkFolder& operator=(const WorkFolder&) = delete;

    const std::filesystem::path& path() const { return mPath; }

private:
    std::filesystem::path mPath;
};

tessel::Host& host()
{
    static tessel::Host running({.profileFolder = workFolder() / "profile", .safe = true, .output = [](auto) {
                                 }});
    return running;
}
} // namespace

const std::filesystem::path& workFolder()
{
    static WorkFolder folder;
    return folder.path();
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
