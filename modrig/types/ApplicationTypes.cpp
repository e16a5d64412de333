#include "modrig/types/ApplicationTypes.h"

#include <tessel/tsed.h>

#include <cwchar>

#include "modrig/base/CaseFolding.h"

CExtInfo::CExtInfo(const wchar_t* ext, int type)
    : mbEnabled(testValidExt(ext, type)), mExtension{}, mType(type)
{
    std::wcsncpy(mExtension, ext, kExtensionSize - 1);
}

bool CExtInfo::testValidExt(const wchar_t* ext, int type)
{
    const bool compiledLisp = type == kLispFile && EqualIgnoringCase(ext, L"qbc");
    if (type == kPackagedLisp || compiledLisp)
        return RemovingTsLISP();
    return true;
}

namespace ModrigUtils
{
const CExtInfo* FindExtension(const CStdStr& ext)
{
    for (const CExtInfo& row : sExtInfo)
        if (row.mbEnabled && EqualIgnoringCase(row.mExtension, ext.Text()))
            return &row;
    return nullptr;
}

int FileType(CStdStr ext)
{
    const CExtInfo* row = FindExtension(ext);
    return row ? row->mType : kNoApplication;
}

int FileTypeOfPath(const CStdStr& path)
{
    return FileType(path.AfterLastDot());
}
} // namespace ModrigUtils
