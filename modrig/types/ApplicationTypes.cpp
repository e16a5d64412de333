#include "modrig/types/ApplicationTypes.h"

#include <tessel/tsed.h>

#include <algorithm>
#include <cwchar>
#include <string>
#include <utility>

#include "modrig/base/CaseFolding.h"
#include "modrig/base/SplitPath.h"

namespace
{
// A package does under any extension.
bool NeedsRemovingTsLisp(const wchar_t* ext, int type)
{
    const auto& kinds = ModrigUtils::kApplicationKinds;
    return type == kPackagedLisp || std::any_of(std::begin(kinds), std::end(kinds),
                                                [&](const ModrigUtils::ApplicationKind& kind) {
                                                    return kind.needsRemovingTsLisp && kind.type == type &&
                                                           EqualIgnoringCase(ext, kind.extension);
                                                });
}
} // namespace

CExtInfo::CExtInfo(const wchar_t* ext, int type)
    : mbEnabled(testValidExt(ext, type)), mExtension{}, mType(type)
{
    std::wcsncpy(mExtension, ext, kExtensionSize - 1);
}

bool CExtInfo::testValidExt(const wchar_t* ext, int type)
{
    return !NeedsRemovingTsLisp(ext, type) || RemovingTsLISP();
}

namespace ModrigUtils
{
namespace
{
template <std::size_t... kRows>
std::array<CExtInfo, kApplicationTypes> UsableRows(std::index_sequence<kRows...>)
{
    return {CExtInfo(kApplicationKinds[kRows].extension, kApplicationKinds[kRows].type)...};
}
} // namespace

std::array<CExtInfo, kApplicationTypes> UsableKinds()
{
    return UsableRows(std::make_index_sequence<kApplicationTypes>());
}

const ApplicationKind* KindOfFile(const SplitPath& file)
{
    for (const ApplicationKind& kind : kApplicationKinds)
        if (file.HasExtension(std::wstring(L".") + kind.extension))
            return &kind;
    return nullptr;
}

std::vector<ApplicationKind> KindsByFilter()
{
    std::vector<ApplicationKind> kinds(std::begin(kApplicationKinds), std::end(kApplicationKinds));
    std::sort(kinds.begin(), kinds.end(),
              [](const ApplicationKind& left, const ApplicationKind& right)
              { return left.filterPlace < right.filterPlace; });
    return kinds;
}

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
