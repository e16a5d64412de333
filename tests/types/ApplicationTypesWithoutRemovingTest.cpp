// In a host that does not load compiled and packaged Lisp.
#include "modrig/loader/ApplicationLoader.h"
#include "modrig/loader/LoadedApplications.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/types/ApplicationTypes.h"
#include "modrig/types/FileFilters.h"
#include "modrig/types/FileValidation.h"
#include "tests/support/ModuleTest.h"

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class HostWithoutCompiledLisp : public ModuleTest
{
};
} // namespace

TEST_F(HostWithoutCompiledLisp, SwitchesTwoKindsOff)
{
    std::vector<std::wstring> disabled;
    for (const CExtInfo& row : sExtInfo)
        if (!row.mbEnabled)
            disabled.push_back(row.mExtension);
    EXPECT_THAT(disabled, ElementsAre(L"rpk", L"qbc"));
}

TEST_F(HostWithoutCompiledLisp, KnowsTheirExtensionsNoMore)
{
    EXPECT_EQ(-1, FileType(L"qbc"));
    EXPECT_EQ(-1, FileType(L"rpk"));
    EXPECT_EQ(1, FileType(L"lsp"));
    EXPECT_EQ(2, FileType(L"mcp"));
    EXPECT_EQ(0, FileType(L"bundle"));
}

TEST_F(HostWithoutCompiledLisp, RefusesTheirFilesSilentlyInTheDialogs)
{
    EXPECT_FALSE(IsValidFileForModrig(L"/a/tool.qbc"));
    EXPECT_FALSE(IsValidFileForModrig(L"/a/tool.rpk"));
    EXPECT_TRUE(IsValidFileForModrig(L"/a/tool.lsp"));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(HostWithoutCompiledLisp, LooksForNoFilesOfTheirs)
{
    CStdStr path(L"tool");
    EXPECT_EQ(INVALID_FILE_ATTRIBUTES, ValidateFileExists(path));
    EXPECT_THAT(host().files.searched,
                ElementsAre(L"tool.bundle", L"tool.zmb", L"tool.lsp", L"tool.mcp", L"tool.omp"));
}

TEST_F(HostWithoutCompiledLisp, LoadsNoneOfTheirFiles)
{
    EXPECT_EQ(kNotLoaded, PerformModrig(L"/a/tool.qbc", 1, 1, 1));
    EXPECT_EQ(kNotLoaded, PerformModrig(L"/a/tool.rpk", 1, 1, 1));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/a/tool.qbc"),
                                     Message(ModrigMessages::kLoadFailed, L"/a/tool.qbc"),
                                     Message(ModrigMessages::kCannotLoadFile, L"/a/tool.rpk"),
                                     Message(ModrigMessages::kLoadFailed, L"/a/tool.rpk")));
    EXPECT_THAT(host().lisp.queued, IsEmpty());
}

TEST_F(HostWithoutCompiledLisp, StillLoadsLispSourceByAPlainExpression)
{
    EXPECT_EQ(kLoaded, PerformModrig(L"/a/tool.lsp", 0, 1, 1));
    EXPECT_THAT(host().lisp.queued, testing::Contains(L"(load \"/a/tool.lsp\")"));
}

TEST_F(HostWithoutCompiledLisp, CountsTheirFilesAmongThoseThatCannotBeFoundNotLoaded)
{
    EXPECT_TRUE(ApplicationIsLoaded(L"/a/tool.qbc"));
    EXPECT_FALSE(IsAppUnloadAble(L"/a/tool.qbc"));
}

TEST_F(HostWithoutCompiledLisp, TakesTheirPatternsOutOfTheFilters)
{
    host().resources.setText(kResourceModuleName, ModrigMessages::kCompiledLispFilter,
                             L"Compiled Lisp|*.qbc");
    host().resources.setText(kResourceModuleName, ModrigMessages::kPackagedLispFilter,
                             L"Packaged Lisp|*.rpk;*.lsp");
    CStdStr filter;
    ReAdjustFilterString(filter);
    EXPECT_EQ(L"R21 Tessel|*.bundle;*.LSP|Bundles|*.bundle|Compiled Lisp||Packaged Lisp|*.lsp|",
              filter.Text());
}
