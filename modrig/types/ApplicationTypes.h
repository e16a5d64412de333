// The kinds of application files, told apart by file extension.
#pragma once

#include <span>

#include "modrig/base/CStdStr.h"

// How a file is loaded.
inline constexpr int kCompiledModule = 0;
inline constexpr int kLispFile = 1;
inline constexpr int kMacroProject = 2;
inline constexpr int kPackagedLisp = 3;
inline constexpr int kNoApplication = -1;

// One row of the table: an extension and how its files are loaded.
struct CExtInfo
{
    CExtInfo(const wchar_t* ext, int type);

    // Whether the running host can use files of the kind. Packaged and compiled Lisp need a host that answers
    // the query `RemovingTsLISP`; everything else is always usable.
    static bool testValidExt(const wchar_t* ext, int type);

    static constexpr std::size_t kExtensionSize = 7;

    bool mbEnabled;
    wchar_t mExtension[kExtensionSize]; // lower case, without the dot
    std::int32_t mType;
};

inline constexpr std::size_t kApplicationTypes = 7;
// The order is the search order everywhere. A disabled row counts as an unknown extension.
extern CExtInfo sExtInfo[kApplicationTypes];

namespace ModrigUtils
{
// The first enabled row with that extension (no dot, any case), or null.
[[nodiscard]] const CExtInfo* FindExtension(const CStdStr& ext);

// The kind that goes with an extension given without its dot, in any case; kNoApplication when there is none.
[[nodiscard]] int FileType(CStdStr ext);

// The kind of the file at the path, by the text after the path's last dot.
[[nodiscard]] int FileTypeOfPath(const CStdStr& path);
} // namespace ModrigUtils
