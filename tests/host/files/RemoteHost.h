// Remote files as the running host's, with a cache in a throwaway folder and what the host said.
#pragma once

#include <filesystem>
#include <fstream>
#include <iterator>
#include <set>
#include <string>

#include "host/commands/Interruption.h"
#include "host/files/RemoteFiles.h"
#include "host/text/Running.h"
#include "host/text/Unicode.h"
#include "tests/host/support/HostParts.h"
#include "tests/support/TemporaryFolder.h"

class RemoteHost
{
public:
    static constexpr std::uint64_t kMostBytes = 100'000;
    static constexpr std::size_t kLongestPath = 1023;

    tessel::RemoteFiles& remote() { return *mRemote; }
    CapturedOutput& output() { return mOutput; }
    const TemporaryFolder& folder() const { return mFolder; }
    std::filesystem::path cache() const { return mFolder / "cache"; }

    // With little time for the whole transfer, for servers that never end.
    tessel::RemoteFiles impatient()
    {
        return {cache(),
                {kMostBytes, std::chrono::milliseconds(5000), std::chrono::milliseconds(300)},
                mInterruption};
    }

    tessel::RemoteFiles::Copy fetch(const std::wstring& url, bool ignoreCache = false)
    {
        return told(mRemote->fetch(url, kLongestPath, ignoreCache));
    }
    // The copy, or a status alone and what went wrong in the output, as applications find it.
    tessel::RemoteFiles::Copy told(const tessel::Result<tessel::RemoteFiles::Copy>& fetched)
    {
        return mOutput.commandLine().tell(fetched) ? *fetched : tessel::RemoteFiles::Copy{fetched.code(), {}};
    }

    // Everything in the cache with its content.
    std::set<std::pair<std::string, std::string>> stored() const
    {
        std::set<std::pair<std::string, std::string>> files;
        if (!std::filesystem::is_directory(cache()))
            return files;
        for (const auto& entry : std::filesystem::recursive_directory_iterator(cache()))
            files.emplace(entry.path().string(), entry.is_regular_file() ? content(entry.path()) : "");
        return files;
    }

    static std::string content(const std::filesystem::path& file)
    {
        std::ifstream stream(file, std::ios::binary);
        return {std::istreambuf_iterator<char>(stream), {}};
    }
    static std::string content(const std::wstring& file)
    {
        return content(std::filesystem::path(tessel::toUtf8(file)));
    }

private:
    TemporaryFolder mFolder;
    CapturedOutput mOutput;
    tessel::EndRequest mEndRequest;
    tessel::Interruption mInterruption{mEndRequest};
    tessel::Owned<tessel::RemoteFiles> mRemote{cache(),
                                               tessel::RemoteFiles::Limits{kMostBytes,
                                                                           std::chrono::milliseconds(5000),
                                                                           std::chrono::milliseconds(30'000)},
                                               mInterruption};
};
