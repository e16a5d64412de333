// The current document: what has been loaded into it.
#pragma once

#include <tessel/tsdocument.h>

#include <string>
#include <unordered_set>
#include <vector>

namespace tessel
{
class Document : public TsApDocument
{
public:
    // A file that was loaded without an error; listed once, whatever the case of its path.
    void add(const std::wstring& path);

    int loadedApplicationCount() const override;
    const wchar_t* loadedApplicationName(int index) const override;

private:
    std::vector<std::wstring> mPaths;
    std::unordered_set<std::wstring> mFolded;
};
} // namespace tessel
