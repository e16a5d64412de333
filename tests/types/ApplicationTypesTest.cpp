#include "modrig/types/ApplicationTypes.h"

#include <cstddef>
#include <type_traits>

#include "modrig/base/SplitPath.h"
#include "tests/support/ModuleTest.h"

using namespace ModrigUtils;

namespace
{
class ApplicationTypes : public ModuleTest
{
};

unsigned TimesAskedBy(const wchar_t* extension, int type)
{
    const unsigned before = RecordingLisp::timesAskedForRemoving();
    static_cast<void>(CExtInfo::testValidExt(extension, type));
    return RecordingLisp::timesAskedForRemoving() - before;
}
} // namespace

TEST_F(ApplicationTypes, StandInTheTableInTheirSearchOrder)
{
    const std::pair<std::wstring, int> expected[] = {{L"bundle", 0}, {L"zmb", 0}, {L"lsp", 1}, {L"mcp", 2},
                                                     {L"omp", 0},    {L"rpk", 3}, {L"qbc", 1}};
    ASSERT_EQ(std::size(expected), std::size(sExtInfo));
    for (std::size_t i = 0; i < std::size(expected); ++i)
    {
        EXPECT_EQ(expected[i].first, sExtInfo[i].mExtension);
        EXPECT_EQ(expected[i].second, sExtInfo[i].mType);
        EXPECT_TRUE(sExtInfo[i].mbEnabled);
    }
}

TEST_F(ApplicationTypes, AreKindsOfTheirOwnWhateverTheHostCanUse)
{
    const std::pair<const wchar_t*, bool> expected[] = {
        {L"/a/tool.bundle", false}, {L"/a/tool.ZMB", false}, {L"/a/tool.lsp", true}, {L"/a/tool.mcp", false},
        {L"/a/tool.omp", false},    {L"/a/tool.Rpk", true},  {L"/a/tool.qbc", true}};
    for (const auto& [path, isLisp] : expected)
    {
        const ApplicationKind* kind = KindOfFile(SplitPath(CStdStr(path)));
        ASSERT_NE(nullptr, kind) << path;
        EXPECT_EQ(isLisp, kind->isLisp) << path;
    }
    for (const wchar_t* path : {L"/a/tool.txt", L"/a/lsp", L"/a.lsp/tool", L"/a/tool.", L""})
        EXPECT_EQ(nullptr, KindOfFile(SplitPath(CStdStr(path)))) << path;
    EXPECT_EQ(nullptr, KindOfFile(SplitPath(CStdStr(LongPath(4000, L"tool.lsp")))))
        << "a path that is too long is of no kind";
}

TEST_F(ApplicationTypes, HaveFiltersInPlacesOfTheirOwn)
{
    int place = 0;
    for (const ApplicationKind& kind : KindsByFilter())
        EXPECT_EQ(++place, kind.filterPlace) << kind.filterText;
    EXPECT_EQ(std::size(sExtInfo), static_cast<std::size_t>(place));
}

TEST_F(ApplicationTypes, ArePlainRecordsOfFlagExtensionAndCode)
{
    EXPECT_FALSE(std::is_polymorphic_v<CExtInfo>);
    ASSERT_TRUE(std::is_standard_layout_v<CExtInfo>);
    EXPECT_EQ(0u, offsetof(CExtInfo, mbEnabled));
    EXPECT_LT(offsetof(CExtInfo, mExtension), offsetof(CExtInfo, mType));
    EXPECT_EQ(7 * sizeof(wchar_t), sizeof(CExtInfo::mExtension));
    EXPECT_EQ(4u, sizeof(CExtInfo::mType));
}

TEST_F(ApplicationTypes, AreKnownByTheirExtensionInAnyCase)
{
    EXPECT_EQ(0, FileType(L"BUNDLE"));
    EXPECT_EQ(0, FileType(L"Zmb"));
    EXPECT_EQ(1, FileType(L"LSP"));
    EXPECT_EQ(0, FileType(L"omp"));
    EXPECT_EQ(1, FileType(L"qBc"));
}

TEST_F(ApplicationTypes, AreNotKnownByAnythingElse)
{
    EXPECT_EQ(-1, FileType(L"bundle "));
    EXPECT_EQ(-1, FileType(L""));
    EXPECT_EQ(-1, FileType(L".lsp"));
    EXPECT_EQ(-1, FileType(L"ls"));
    EXPECT_EQ(-1, FileType(L"lspx"));
    EXPECT_EQ(-1, FileType(L"bundl"));
}

TEST_F(ApplicationTypes, IncludeTheTwoThatTheLoaderRefuses)
{
    EXPECT_EQ(2, FileType(L"mcp"));
    EXPECT_EQ(3, FileType(L"rpk"));
}

TEST_F(ApplicationTypes, AreTakenFromTheTextAfterTheLastDotOfAPath)
{
    EXPECT_EQ(1, FileTypeOfPath(L"/a.b/tool.omp.LSP"));
    EXPECT_EQ(-1, FileTypeOfPath(L"/a.lsp/tool"));
    EXPECT_EQ(-1, FileTypeOfPath(L"tool."));
    EXPECT_EQ(-1, FileTypeOfPath(L"lsp"));
    EXPECT_EQ(-1, FileTypeOfPath(L""));
}

TEST_F(ApplicationTypes, AskTheHostForPackagedAndCompiledLispOnly)
{
    EXPECT_EQ(1u, TimesAskedBy(L"rpk", 3));
    EXPECT_EQ(1u, TimesAskedBy(L"anything", 3));
    EXPECT_EQ(1u, TimesAskedBy(L"QBC", 1));
    EXPECT_EQ(0u, TimesAskedBy(L"qbc", 0)) << "the extension counts for Lisp files only";
    EXPECT_EQ(0u, TimesAskedBy(L"lsp", 1));
    EXPECT_EQ(0u, TimesAskedBy(L"mcp", 2));
    EXPECT_EQ(0u, TimesAskedBy(L"bundle", 0));
}

TEST_F(ApplicationTypes, AskTheHostWhereTheirRowsSaySo)
{
    std::vector<std::wstring> asking;
    for (const ApplicationKind& kind : kApplicationKinds)
    {
        EXPECT_EQ(kind.needsRemovingTsLisp ? 1u : 0u, TimesAskedBy(kind.extension, kind.type))
            << kind.extension;
        if (kind.needsRemovingTsLisp)
            asking.emplace_back(kind.extension);
    }
    EXPECT_THAT(asking, testing::ElementsAre(L"rpk", L"qbc"));
}

TEST_F(ApplicationTypes, AreUsableAsTheHostAnswers)
{
    for (const bool removing : {true, false})
    {
        host().lisp.removing = removing;
        EXPECT_EQ(removing, CExtInfo::testValidExt(L"rpk", 3));
        EXPECT_EQ(removing, CExtInfo::testValidExt(L"qbc", 1));
        EXPECT_TRUE(CExtInfo::testValidExt(L"lsp", 1));
        EXPECT_TRUE(CExtInfo::testValidExt(L"mcp", 2));
        EXPECT_TRUE(CExtInfo::testValidExt(L"omp", 0));
        EXPECT_EQ(removing, CExtInfo(L"rpk", 3).mbEnabled);
    }
}

TEST_F(ApplicationTypes, AreSettledWhenTheTableIsBuilt)
{
    host().lisp.removing = false;
    const unsigned before = RecordingLisp::timesAskedForRemoving();
    EXPECT_EQ(1, FileType(L"qbc"));
    EXPECT_EQ(3, FileType(L"rpk"));
    EXPECT_EQ(before, RecordingLisp::timesAskedForRemoving());
}

TEST_F(ApplicationTypes, HoldExtensionsOfSixCharacters)
{
    EXPECT_STREQ(L"bundle", CExtInfo(L"bundle", 0).mExtension);
    EXPECT_STREQ(L"abcdef", CExtInfo(L"abcdefgh", 0).mExtension);
}
