#include "modrig/messages/ResourceOverride.h"

HINSTANCE CTemporaryResourceOverride::m_hInstanceDefault = nullptr;

namespace
{
// Stands in the field of an object that was made with a null handle and so has nothing to restore: an address
// of our own, which no module has. Null would not do: it is what is current before anybody has chosen.
HINSTANCE NothingToRestore()
{
    return reinterpret_cast<HINSTANCE>(&CTemporaryResourceOverride::m_hInstanceDefault);
}
} // namespace

CTemporaryResourceOverride::CTemporaryResourceOverride(HINSTANCE resources)
    : mhPrevious(resources ? AfxGetResourceHandle() : NothingToRestore())
{
    if (resources && mhPrevious != resources)
        AfxSetResourceHandle(resources);
}

CTemporaryResourceOverride::~CTemporaryResourceOverride()
{
    if (mhPrevious != NothingToRestore() && AfxGetResourceHandle() != mhPrevious)
        AfxSetResourceHandle(mhPrevious);
}

bool CTemporaryResourceOverride::SetDefaultResource(long language, CStdStr moduleName)
{
    // The texts are loaded exactly once: a second load message is an error, not a refresh.
    if (m_hInstanceDefault)
        return false;
    if (language != 0)
        m_hInstanceDefault = LoadLibrary((CStdStr(L"en-us\\") + moduleName).c_str());
    if (!m_hInstanceDefault)
        m_hInstanceDefault = LoadLibrary(moduleName.c_str());
    return m_hInstanceDefault != nullptr;
}

void CTemporaryResourceOverride::ReleaseDefaultResource()
{
    if (!m_hInstanceDefault)
        return;
    FreeLibrary(m_hInstanceDefault); // whatever it answers, the handle is not used again
    m_hInstanceDefault = nullptr;
}
