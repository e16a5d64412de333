#include "host/applications/Document.h"

#include "host/text/Running.h"
#include "host/text/Unicode.h"

namespace tessel
{
void Document::add(const std::wstring& path)
{
    if (mFolded.insert(foldCase(path)).second)
        mPaths.push_back(path);
}

int Document::loadedApplicationCount() const
{
    return static_cast<int>(mPaths.size());
}

const wchar_t* Document::loadedApplicationName(int index) const
{
    const bool inside = index >= 0 && index < loadedApplicationCount();
    return inside ? mPaths[static_cast<std::size_t>(index)].c_str() : nullptr;
}
} // namespace tessel

TsApDocument* curDoc()
{
    return tessel::running<tessel::Document>();
}
