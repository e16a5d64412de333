// The kinds of application files, told apart by file extension.
#pragma once

#include <array>
#include <iterator>
#include <vector>

#include "modrig/base/CStdStr.h"
#include "modrig/messages/MessageIds.h"

class SplitPath;

// How a file is loaded.
inline constexpr int kCompiledModule = 0;
inline constexpr int kLispFile = 1;
inline constexpr int kMacroProject = 2;
inline constexpr int kPackagedLisp = 3;
inline constexpr int kNoApplication = -1;

namespace ModrigUtils
{
// What is known of a kind before any host is asked.
struct ApplicationKind
{
    const wchar_t* extension; // lower case, without the dot
    int type;                 // how its files are loaded
    bool isLisp;              // loaded again each time that it is asked for, and not while Lisp is off
    bool needsRemovingTsLisp; // only hosts that answer the query `RemovingTsLISP` with true can use it
    int filterPlace;          // its filter's place among the filters of kinds, from 1
    unsigned filterText;      // the id of its filter, a description and patterns
    // The key of its filter in the file panels: its description, and followed by "_EXT" its extensions. Null
    // for a kind that has no filter of its own there.
    const char* filterKey;
};

// All that is said of a kind, in one row. The order is the search order everywhere.
inline constexpr ApplicationKind kApplicationKinds[] = {
    {L"bundle", kCompiledModule, false, false, 1, ModrigMessages::kBundleFilter, "IDS_MODRIG_QMB_APPS"},
    {L"zmb", kCompiledModule, false, false, 2, ModrigMessages::kCoreModuleFilter, "IDS_MODRIG_ZMB_APPS"},
    {L"lsp", kLispFile, true, false, 3, ModrigMessages::kLispSourceFilter, "IDS_MODRIG_LSP_APPS"},
    {L"mcp", kMacroProject, false, false, 7, ModrigMessages::kMacroProjectFilter, nullptr},
    {L"omp", kCompiledModule, false, false, 4, ModrigMessages::kObjectModuleFilter, "IDS_MODRIG_OMP_APPS"},
    {L"rpk", kPackagedLisp, true, true, 6, ModrigMessages::kPackagedLispFilter, nullptr},
    {L"qbc", kLispFile, true, true, 5, ModrigMessages::kCompiledLispFilter, "IDS_MODRIG_QBC_APPS"},
};
} // namespace ModrigUtils

// The same kinds as the running host can use them: an extension and how its files are loaded.
struct CExtInfo
{
    CExtInfo(const wchar_t* ext, int type);

    // Whether the running host can use files of the kind. It is asked about packaged Lisp, and where the row
    // of the kind says so; everything else is always usable.
    [[nodiscard]] static bool testValidExt(const wchar_t* ext, int type);

    static constexpr std::size_t kExtensionSize = 7;

    bool mbEnabled;
    wchar_t mExtension[kExtensionSize]; // lower case, without the dot
    std::int32_t mType;
};

inline constexpr std::size_t kApplicationTypes = std::size(ModrigUtils::kApplicationKinds);
// In the order of `kApplicationKinds`. A disabled row counts as an unknown extension.
extern std::array<CExtInfo, kApplicationTypes> sExtInfo;

namespace ModrigUtils
{
// The rows of `sExtInfo`. The host is asked here what it can use.
[[nodiscard]] std::array<CExtInfo, kApplicationTypes> UsableKinds();

// The kind of the file, whether or not the host can use it; null for any other file.
[[nodiscard]] const ApplicationKind* KindOfFile(const SplitPath& file);

// The kinds in the order of their filters.
[[nodiscard]] std::vector<ApplicationKind> KindsByFilter();

// The first enabled row with that extension (no dot, any case), or null.
[[nodiscard]] const CExtInfo* FindExtension(const CStdStr& ext);

// The kind that goes with an extension given without its dot, in any case; kNoApplication when there is none.
[[nodiscard]] int FileType(CStdStr ext);

// The kind of the file at the path, by the text after the path's last dot.
[[nodiscard]] int FileTypeOfPath(const CStdStr& path);
} // namespace ModrigUtils
