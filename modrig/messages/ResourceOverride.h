// The switch to the module's own texts.
#pragma once

#include <wincompat/winres.h>

#include "modrig/base/CStdStr.h"

// While an object lives, the host looks texts up in the given resource module; afterwards again where it did
// before.
class CTemporaryResourceOverride
{
public:
    // A null handle leaves everything as it is.
    explicit CTemporaryResourceOverride(HINSTANCE resources);
    virtual ~CTemporaryResourceOverride();
    CTemporaryResourceOverride(const CTemporaryResourceOverride&) = delete;
    CTemporaryResourceOverride& operator=(const CTemporaryResourceOverride&) = delete;

    // Loads the module's resource module, once: false when it is loaded already, or cannot be. With a
    // language other than 0 the folder "en-us" is tried first, whatever the language.
    [[nodiscard]] static bool SetDefaultResource(long language, CStdStr moduleName);

    // Gives the resource module back. Nothing happens when none is loaded.
    static void ReleaseDefaultResource();

    // The loaded resource module, or null.
    static HINSTANCE m_hInstanceDefault;

private:
    // The handle that was current when the object was made.
    HINSTANCE mhPrevious;
};
