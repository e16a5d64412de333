// A registry in a throwaway folder, as the running host's, with what the host said.
#pragma once

#include <filesystem>
#include <memory>
#include <string>

#include "host/Services.h"
#include "host/registry/Registry.h"
#include "tests/host_app/HostParts.h"
#include "tests/support/TemporaryFolder.h"

class RegistryHost
{
public:
    RegistryHost() { open(); }

    // The host ends and starts again.
    void open()
    {
        mRegistry.reset();
        mRegistry = std::make_unique<tessel::Registry>(file());
        tessel::services().registry = mRegistry.get();
    }
    void close()
    {
        mRegistry.reset();
        tessel::services().registry = nullptr;
    }

    const TemporaryFolder& folder() const { return mFolder; }
    std::filesystem::path file() const { return mFolder / "registry.db"; }
    tessel::Registry& registry() { return *mRegistry; }
    CapturedOutput& output() { return mOutput; }

private:
    TemporaryFolder mFolder;
    CapturedOutput mOutput;
    std::unique_ptr<tessel::Registry> mRegistry;
};
