// A registry in a throwaway folder, as the running host's, with what the host said.
#pragma once

#include <chrono>
#include <filesystem>
#include <optional>
#include <string>

#include "host/registry/Registry.h"
#include "host/text/Running.h"
#include "tests/host/support/HostParts.h"
#include "tests/support/TemporaryFolder.h"

class RegistryHost
{
public:
    explicit RegistryHost(std::chrono::milliseconds busyTimeout = tessel::Registry::kBusyTimeout)
        : mBusyTimeout(busyTimeout)
    {
        open();
    }

    // The host ends and starts again.
    void open()
    {
        mRegistry.reset();
        mRegistry.emplace(file(), mBusyTimeout);
    }
    void close() { mRegistry.reset(); }

    const TemporaryFolder& folder() const { return mFolder; }
    std::filesystem::path file() const { return mFolder / "registry.db"; }
    tessel::Registry& registry() { return **mRegistry; }
    CapturedOutput& output() { return mOutput; }

private:
    TemporaryFolder mFolder;
    CapturedOutput mOutput;
    std::chrono::milliseconds mBusyTimeout;
    std::optional<tessel::Owned<tessel::Registry>> mRegistry;
};
