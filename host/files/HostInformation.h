// What the host tells applications of itself, and their way to remote files.
#pragma once

#include <string>
#include <utility>

#include <tessel/tshostservices.h>

#include "host/files/RemoteFiles.h"

namespace tessel
{
class CommandLine;

class HostInformation : public TsDbHostApplicationServices
{
public:
    // Why a file could not be fetched is said on the command line.
    HostInformation(std::wstring profileFolder, RemoteFiles& remote, CommandLine& commandLine)
        : mProfileFolder(std::move(profileFolder)), mRemote(remote), mCommandLine(commandLine)
    {
    }

    const wchar_t* productRegistryRoot() const override;
    const wchar_t* profileFolder() const override { return mProfileFolder.c_str(); }
    const wchar_t* product() const override;
    bool isUrl(const wchar_t* text) const override;
    int fetchRemoteFile(const wchar_t* url, wchar_t* localPath, std::size_t capacity,
                        bool ignoreCache) override;

private:
    Result<RemoteFiles::Copy> fetch(const std::wstring& url, std::size_t capacity, bool ignoreCache) const;

    std::wstring mProfileFolder;
    RemoteFiles& mRemote;
    CommandLine& mCommandLine;
};
} // namespace tessel
