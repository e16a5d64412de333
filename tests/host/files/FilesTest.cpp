#include <gtest/gtest.h>

#include <sys/stat.h>
#include <wincompat/winfile.h>

#include <filesystem>
#include <string>

#include "host/text/Unicode.h"
#include "tests/host/files/CurrentFolder.h"
#include "tests/support/TemporaryFolder.h"

namespace
{
DWORD attributesOf(const std::filesystem::path& path)
{
    return GetFileAttributesW(tessel::toWide(path.string()).c_str());
}
} // namespace

TEST(FileAttributes, TellFilesAndFolders)
{
    const TemporaryFolder folder;
    EXPECT_EQ(attributesOf(folder.write("tool.lsp", "")), FILE_ATTRIBUTE_NORMAL);
    EXPECT_EQ(attributesOf(folder.path()), FILE_ATTRIBUTE_DIRECTORY);
    EXPECT_EQ(attributesOf(folder / "missing.lsp"), INVALID_FILE_ATTRIBUTES);
}

TEST(FileAttributes, TellPipesAndDevicesFromFiles)
{
    const TemporaryFolder folder;
    ASSERT_EQ(mkfifo((folder / "pipe").c_str(), 0600), 0);
    EXPECT_EQ(attributesOf(folder / "pipe"), FILE_ATTRIBUTE_DEVICE);
    EXPECT_EQ(attributesOf("/dev/null"), FILE_ATTRIBUTE_DEVICE);
}

TEST(FileAttributes, AreThereForNamesOfEveryKind)
{
    const TemporaryFolder folder;
    for (const char* name : {"größe.lsp", "100%s.lsp", "a \"b\" 'c'.lsp", "\xE6\x97\xA5\xE6\x9C\xAC.lsp"})
        EXPECT_EQ(attributesOf(folder.write(name, "")), FILE_ATTRIBUTE_NORMAL) << name;
}

TEST(FileAttributes, TellWhatNobodyMayWrite)
{
    namespace fs = std::filesystem;
    const TemporaryFolder folder;
    const auto file = folder.write("tool.lsp", "");
    fs::permissions(file, fs::perms::owner_read);
    EXPECT_EQ(attributesOf(file), FILE_ATTRIBUTE_READONLY);
    fs::permissions(file, fs::perms::owner_read | fs::perms::group_write);
    EXPECT_EQ(attributesOf(file), FILE_ATTRIBUTE_NORMAL);
    fs::create_directory(folder / "closed");
    fs::permissions(folder / "closed", fs::perms::owner_read | fs::perms::owner_exec);
    EXPECT_EQ(attributesOf(folder / "closed"), FILE_ATTRIBUTE_DIRECTORY | FILE_ATTRIBUTE_READONLY);
}

TEST(FileAttributes, FollowLinks)
{
    const TemporaryFolder folder;
    std::filesystem::create_symlink(folder.path(), folder / "link");
    EXPECT_EQ(attributesOf(folder / "link"), FILE_ATTRIBUTE_DIRECTORY);
    std::filesystem::create_symlink(folder / "missing", folder / "dangling");
    EXPECT_EQ(attributesOf(folder / "dangling"), INVALID_FILE_ATTRIBUTES);
    std::filesystem::create_symlink(folder / "circle", folder / "circle");
    EXPECT_EQ(attributesOf(folder / "circle"), INVALID_FILE_ATTRIBUTES);
}

TEST(FileAttributes, TakeARelativePathFromTheCurrentFolder)
{
    const TemporaryFolder folder;
    folder.write("tool.lsp", "");
    const CurrentFolder current(folder.path());
    EXPECT_EQ(GetFileAttributesW(L"tool.lsp"), FILE_ATTRIBUTE_NORMAL);
    EXPECT_EQ(GetFileAttributesW(L"other.lsp"), INVALID_FILE_ATTRIBUTES);
}

TEST(FileAttributes, AreInvalidForWhatIsNoPath)
{
    EXPECT_EQ(GetFileAttributesW(nullptr), INVALID_FILE_ATTRIBUTES);
    EXPECT_EQ(GetFileAttributesW(L""), INVALID_FILE_ATTRIBUTES);
    EXPECT_EQ(GetFileAttributesW((L"/" + std::wstring(4000, L'x')).c_str()), INVALID_FILE_ATTRIBUTES);
    EXPECT_EQ(GetFileAttributesW((L"/" + std::wstring(40'000, L'x')).c_str()), INVALID_FILE_ATTRIBUTES);
}

TEST(CurrentDirectory, IsGivenWithItsLength)
{
    const TemporaryFolder folder;
    std::filesystem::create_directory(folder / "größe");
    const CurrentFolder current(folder / "größe");
    const std::wstring expected = tessel::toWide((folder / "größe").string());
    wchar_t buffer[1024] = {};
    EXPECT_EQ(GetCurrentDirectory(1024, buffer), expected.size());
    EXPECT_EQ(expected, buffer);
}

TEST(CurrentDirectory, IsGivenWholeOrNotAtAll)
{
    const TemporaryFolder folder;
    const CurrentFolder current(folder.path());
    const auto length = static_cast<DWORD>(folder.path().string().size());
    std::wstring buffer(length + 1, L'?');
    EXPECT_EQ(GetCurrentDirectory(length, buffer.data()), length + 1);
    EXPECT_EQ(buffer, std::wstring(length + 1, L'?'));
    EXPECT_EQ(GetCurrentDirectory(0, nullptr), length + 1);
    EXPECT_EQ(GetCurrentDirectory(length + 1, buffer.data()), length);
    EXPECT_EQ(buffer.c_str(), tessel::toWide(folder.path().string()));
}

TEST(CurrentDirectory, FailsWhenTheFolderIsGone)
{
    const TemporaryFolder folder;
    std::filesystem::create_directory(folder / "gone");
    const CurrentFolder current(folder / "gone");
    std::filesystem::remove(folder / "gone");
    wchar_t buffer[1024];
    EXPECT_EQ(GetCurrentDirectory(1024, buffer), 0u);
}
