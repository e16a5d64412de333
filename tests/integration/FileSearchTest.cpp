// Files that are named without their folder, or are missing where they are said to be.
#include "tests/integration/ModrigInHost.h"

#include <gmock/gmock.h>

namespace
{
class FileSearch : public ModrigInHost
{
protected:
    FileSearch()
    {
        std::filesystem::create_directories(current);
        std::filesystem::create_directories(searched);
        EXPECT_TRUE(type(L"CD \"" + wide(current) + L"\""));
        EXPECT_TRUE(type(L"SETVAR SEARCHPATH \"/nowhere;" + wide(searched) + L"\""));
        said();
    }

    // The path found; nothing when there is none.
    std::wstring find(const std::wstring& path)
    {
        std::wstring found = path;
        DWORD attributes = 0;
        dialog([&] { attributes = ModrigUnderTest::findFile(found); });
        if (attributes != INVALID_FILE_ATTRIBUTES)
            return found;
        EXPECT_EQ(found, path) << "a path that is not found stays as it is";
        return {};
    }

    const std::filesystem::path current = folder / "where the user is";
    const std::filesystem::path searched = folder / "where the host searches";
};
} // namespace

TEST_F(FileSearch, LeavesAPathThatIsThereAlone)
{
    const auto file = folder.write("a folder/tool.lsp", "");
    folder.write("where the user is/tool.lsp", "");
    EXPECT_EQ(find(wide(file)), wide(file));
}

TEST_F(FileSearch, FindsAFileInTheCurrentFolderBeforeTheSearchPath)
{
    folder.write("where the host searches/tool.lsp", "");
    EXPECT_EQ(find(L"tool.lsp"), wide(searched / "tool.lsp"));
    folder.write("where the user is/tool.lsp", "");
    EXPECT_EQ(find(L"/x/y/tool.lsp"), wide(current / "tool.lsp"));
}

TEST_F(FileSearch, FindsANameWithoutAnExtensionInTheOrderOfTheKinds)
{
    folder.write("where the host searches/tool.qbc", "");
    EXPECT_EQ(find(L"tool"), wide(searched / "tool.qbc"));
    folder.write("where the host searches/tool.lsp", "");
    EXPECT_EQ(find(L"tool."), wide(searched / "tool.lsp"));
    std::filesystem::create_directories(searched / "tool.bundle");
    EXPECT_EQ(find(L"/gone/tool"), wide(searched / "tool.bundle"));
    folder.write("where the user is/tool.qbc", "");
    EXPECT_EQ(find(L"tool"), wide(current / "tool.qbc")) << "here comes before elsewhere, whatever the kind";
    std::filesystem::create_directories(current / "tool.bundle");
    EXPECT_EQ(find(L"tool"), wide(current / "tool.bundle"));
}

TEST_F(FileSearch, FindsNothingWhereThereIsNothing)
{
    EXPECT_EQ(find(L"tool"), L"");
    EXPECT_EQ(find(L"/x/tool.lsp"), L"");
    EXPECT_EQ(find(L""), L"");
    EXPECT_EQ(said(), "");
}

TEST_F(FileSearch, FindsNamesOfEveryKindOfLetter)
{
    const auto file = folder.write("where the host searches/größe 100%s 日本.lsp", "");
    EXPECT_EQ(find(L"größe 100%s 日本.lsp"), wide(file));
    EXPECT_EQ(find(std::wstring(4000, L'x') + L".lsp"), L"");
}
