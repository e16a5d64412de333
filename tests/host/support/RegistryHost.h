// A registry in a throwaway folder, as the running host's, with what the host said.
#pragma once

#include <chrono>
#include <filesystem>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "host/registry/LayeredRegistry.h"
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
        close();
        mRegistry.emplace(file(), mBusyTimeout);
        mLayered.emplace(**mRegistry, tessel::readRegistryLayers(mLayoutFolders),
                         [this](const std::wstring& sentence) { mSaid.push_back(sentence); });
    }
    void close()
    {
        mLayered.reset();
        mRegistry.reset();
    }

    // From the next start on; later folders before earlier ones.
    void layOut(std::vector<std::filesystem::path> folders) { mLayoutFolders = std::move(folders); }

    const TemporaryFolder& folder() const { return mFolder; }
    std::filesystem::path file() const { return mFolder / "registry.db"; }
    tessel::Registry& registry() { return **mRegistry; }
    tessel::LayeredRegistry& layered() { return **mLayered; }
    const std::vector<std::wstring>& saidOfLayers() const { return mSaid; }
    CapturedOutput& output() { return mOutput; }

private:
    TemporaryFolder mFolder;
    CapturedOutput mOutput;
    std::chrono::milliseconds mBusyTimeout;
    std::vector<std::filesystem::path> mLayoutFolders;
    std::vector<std::wstring> mSaid;
    std::optional<tessel::Owned<tessel::Registry>> mRegistry;
    std::optional<tessel::Owned<tessel::LayeredRegistry>> mLayered;
};
