#include "modrig/base/SplitPath.h"

#include <string>
#include <vector>

#include <gtest/gtest.h>

namespace
{
SplitPath Split(const std::wstring& path)
{
    return SplitPath(CStdStr(path));
}

std::wstring Repeat(std::size_t count, wchar_t character)
{
    return std::wstring(count, character);
}

// The folder, the name, the extension does not fit.
std::vector<std::wstring> TooLongPaths()
{
    return {L"/" + Repeat(1022, L'f') + L"/gear.lsp", L"/a/" + Repeat(256, L'n') + L".lsp",
            L"/a/gear." + Repeat(255, L'x'), L"/b/gear." + Repeat(255, L'x')};
}
} // namespace

TEST(SplitPath, GivesNameAndExtensionWithItsDot)
{
    const SplitPath split = Split(L"/apps/old.tools/gear.wheel.lsp");
    EXPECT_EQ(L"gear.wheel", split.Name());
    EXPECT_EQ(L".lsp", split.Extension());
    EXPECT_EQ(L"gear.wheel.lsp", split.FileName().Text());
}

TEST(SplitPath, TakesADotInAFolderForNoExtension)
{
    const SplitPath split = Split(L"/apps.d/gear");
    EXPECT_EQ(L"gear", split.Name());
    EXPECT_EQ(L"", split.Extension());
}

TEST(SplitPath, KnowsBothSeparators)
{
    EXPECT_EQ(L"gear.lsp", Split(L"C:\\apps\\gear.lsp").FileName().Text());
    EXPECT_EQ(L"gear.lsp", Split(L"\\\\server\\apps/gear.lsp").FileName().Text());
}

TEST(SplitPath, ComparesExtensionsWithTheirDotAndWithoutCase)
{
    EXPECT_TRUE(Split(L"/a/gear.LSP").HasExtension(L".lsp"));
    EXPECT_FALSE(Split(L"/a/gear.LSP").HasExtension(L"lsp"));
    EXPECT_FALSE(Split(L"/a/gear").HasExtension(L".lsp"));
}

TEST(SplitPath, ComparesFileNamesAndFoldersSeparatelyAndWithoutCase)
{
    const SplitPath gear = Split(L"C:/Äpfel/gear.lsp");
    EXPECT_TRUE(gear.SameFileName(Split(L"/b/GEAR.Lsp")));
    EXPECT_FALSE(gear.SameFileName(Split(L"C:/Äpfel/gear.qbc")));
    EXPECT_TRUE(gear.SameFolder(Split(L"c:/äPFEL/wheel.qbc")));
    EXPECT_FALSE(gear.SameFolder(Split(L"D:/Äpfel/gear.lsp")));
    EXPECT_FALSE(gear.SameFolder(Split(L"C:/Äpfel/b/gear.lsp")));
}

TEST(SplitPath, TellsTheTwoSeparatorsApartInFolders)
{
    EXPECT_FALSE(Split(L"/a/b/gear.lsp").SameFolder(Split(L"\\a\\b\\gear.lsp")));
}

TEST(SplitPath, EqualPartsHaveEqualHashes)
{
    const SplitPath left = Split(L"C:/Äpfel/Gear.lsp");
    const SplitPath right = Split(L"c:/äpfel/GEAR.LSP");
    EXPECT_EQ(left.FileNameHash(), right.FileNameHash());
    EXPECT_EQ(WholePathHash(L"C:/Äpfel/Gear.lsp"), WholePathHash(L"c:/äpfel/GEAR.LSP"));
    EXPECT_EQ(left.FileNameHash(), Split(L"/elsewhere/gear.lsp").FileNameHash());
}

TEST(SplitPath, FitsTheLongestPartsThatItHasRoomFor)
{
    const std::wstring folder = L"/" + Repeat(1021, L'f') + L"/";
    const std::wstring name = Repeat(255, L'n');
    const std::wstring extension = L"." + Repeat(254, L'x');
    const SplitPath split = Split(folder + name + extension);
    EXPECT_EQ(name, split.Name());
    EXPECT_EQ(extension, split.Extension());
}

TEST(SplitPath, IsEmptyAsAWholeWhenOnePartDoesNotFit)
{
    for (const std::wstring& path : TooLongPaths())
    {
        const SplitPath split = Split(path);
        EXPECT_TRUE(split.IsTooLong());
        EXPECT_EQ(L"", split.Name());
        EXPECT_EQ(L"", split.Extension());
        EXPECT_TRUE(split.FileName().IsEmpty());
        EXPECT_TRUE(split.SameFolder(Split(L"gear.lsp"))) << "the folder is empty too";
    }
}

TEST(SplitPath, IsNotTooLongWhenItsPartsFitOrAreEmpty)
{
    EXPECT_FALSE(Split(L"").IsTooLong());
    EXPECT_FALSE(Split(L"/a/").IsTooLong());
    EXPECT_FALSE(Split(L"/" + Repeat(1021, L'f') + L"/" + Repeat(255, L'n') + L".lsp").IsTooLong());
}

TEST(SplitPath, HasTheFileNameOfNothingButItselfWhenItIsTooLong)
{
    const std::vector<std::wstring> paths = TooLongPaths();
    for (const std::wstring& path : paths)
    {
        const SplitPath split = Split(path);
        EXPECT_FALSE(split.SameFileName(Split(L"")));
        EXPECT_FALSE(Split(L"").SameFileName(split));
        for (const std::wstring& other : paths)
            EXPECT_EQ(path == other, split.SameFileName(Split(other)));
    }
}

TEST(SplitPath, IsTheSameInAnyCaseAlsoWhenItIsTooLong)
{
    const std::wstring leftPath = L"/Ä/" + Repeat(256, L'n') + L".lsp";
    const std::wstring rightPath = L"/ä/" + Repeat(256, L'N') + L".LSP";
    const SplitPath left = Split(leftPath);
    const SplitPath right = Split(rightPath);
    EXPECT_TRUE(left.SameFileName(right));
    EXPECT_EQ(left.FileNameHash(), right.FileNameHash());
    EXPECT_EQ(WholePathHash(leftPath), WholePathHash(rightPath));
}

TEST(SplitPath, TellsPathsThatAreTooLongApartByTheirHashes)
{
    const std::wstring left = L"/a/" + Repeat(256, L'n') + L".lsp";
    const std::wstring right = L"/b/" + Repeat(256, L'n') + L".lsp";
    EXPECT_NE(Split(left).FileNameHash(), Split(right).FileNameHash());
    EXPECT_NE(WholePathHash(left), WholePathHash(right));
}
