#include "tests/host/support/HostWithModules.h"

#include <dlfcn.h>

HostWithModules::~HostWithModules()
{
    mLinker.unloadAll();
}

std::filesystem::path HostWithModules::fixture(const std::string& name) const
{
    return fixture(name, name);
}

std::filesystem::path HostWithModules::fixture(const std::string& name,
                                               const std::filesystem::path& copy) const
{
    const auto target = mFolder / copy;
    std::filesystem::create_directories(target.parent_path());
    std::filesystem::copy(std::filesystem::path(FIXTURE_MODULES) / name, target,
                          std::filesystem::copy_options::recursive);
    return target;
}

bool HostWithModules::load(const std::filesystem::path& path)
{
    return mLinker.loadModule(tessel::toWide(path.native()).c_str(), true, true);
}

bool HostWithModules::unload(const std::filesystem::path& path)
{
    return mLinker.unloadModule(tessel::toWide(path.native()).c_str(), true);
}

std::wstring HostWithModules::names() const
{
    std::wstring result;
    for (const auto& module : mLinker.loadedModules())
        result += module.name + L" ";
    return result;
}

std::string HostWithModules::output()
{
    return std::exchange(mOutput, {});
}

bool HostWithModules::isMapped(const std::filesystem::path& path)
{
    void* handle = dlopen(path.c_str(), RTLD_NOLOAD | RTLD_LAZY);
    return handle && dlclose(handle) == 0;
}

std::string HostWithModules::notLoaded(const std::filesystem::path& path, const std::string& whyNot)
{
    return "The application \"" + path.native() + "\" is not loaded: " + whyNot + ".\n";
}

std::string HostWithModules::notUnloaded(const std::filesystem::path& path, const std::string& whyNot)
{
    return "The application \"" + path.native() + "\" is not unloaded: " + whyNot + ".\n";
}
