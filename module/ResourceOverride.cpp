#include "module/ResourceOverride.h"

HINSTANCE CTemporaryResourceOverride::m_hInstanceDefault = nullptr;

CTemporaryResourceOverride::CTemporaryResourceOverride(HINSTANCE resources) : mbActive(resources != nullptr)
{
    if (!mbActive)
        return;
    mhPrevious = AfxGetResourceHandle();
    if (mhPrevious != resources)
        AfxSetResourceHandle(resources);
}

CTemporaryResourceOverride::~CTemporaryResourceOverride()
{
    if (mbActive && AfxGetResourceHandle() != mhPrevious)
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
