// Files: those that a test names, or those of the real disk.
#pragma once

#include <map>
#include <string>
#include <vector>

#include <wincompat/winfile.h>

class RecordingFiles
{
public:
    // Attributes, the current folder and existence come from the real file system from now on.
    void useRealFileSystem() { mReal = true; }

    // Full paths, or paths below the current folder.
    void addFile(const std::wstring& path, DWORD attributes = FILE_ATTRIBUTE_NORMAL);
    void addFolder(const std::wstring& path) { addFile(path, FILE_ATTRIBUTE_DIRECTORY); }

    // What `GetCurrentDirectory` answers; empty makes it fail.
    std::wstring currentFolder = L"/current";

    // Where `tsedFindFile` looks after the current folder, in order.
    std::vector<std::wstring> searchFolders;
    // What it answers for a name, before it looks anywhere; the file need not exist.
    std::map<std::wstring, std::wstring> found;

    // The paths given to `GetFileAttributesW` and the names given to `tsedFindFile`, in order.
    std::vector<std::wstring> attributesAsked;
    std::vector<std::wstring> searched;

    // What the SDK's functions do.
    DWORD attributes(const std::wstring& path) const;
    std::wstring currentFolderNow() const;
    // Empty when there is none.
    std::wstring search(const std::wstring& name) const;

private:
    std::wstring fullPath(const std::wstring& path) const;

    bool mReal = false;
    std::map<std::wstring, DWORD> mFiles; // by full path
};
