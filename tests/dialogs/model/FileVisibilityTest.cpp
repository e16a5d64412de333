#include "modrig/dialogs/model/FileVisibility.h"

#include <gmock/gmock.h>

using namespace ModrigUtils;

namespace
{
const std::vector<CStdStr> kLispFilter = {CStdStr(L"lsp"), CStdStr(L"qbc")};
constexpr bool kPackagesAreFolders = true;
constexpr bool kPackagesAreFiles = false;

PanelFile File(const wchar_t* extension)
{
    return {.extension = CStdStr(extension), .exists = true};
}

PanelFile Folder(const wchar_t* extension)
{
    return {.extension = CStdStr(extension), .exists = true, .isFolder = true};
}

PanelFile Package(const wchar_t* extension)
{
    return {.extension = CStdStr(extension), .exists = true, .isFolder = true, .isPackage = true};
}

bool IsShown(const PanelFile& file, bool packages = kPackagesAreFiles)
{
    return IsShownInPanel(file, packages, kLispFilter);
}
} // namespace

TEST(PanelVisibility, FollowsTheFilterInAnyCase)
{
    EXPECT_TRUE(IsShown(File(L"lsp")));
    EXPECT_TRUE(IsShown(File(L"LSP")));
    EXPECT_TRUE(IsShown(File(L"qbc")));
    EXPECT_FALSE(IsShown(File(L"txt")));
    EXPECT_FALSE(IsShown(File(L"")));
}

TEST(PanelVisibility, ShowsEveryFolder)
{
    EXPECT_TRUE(IsShown(Folder(L"")));
    EXPECT_TRUE(IsShown(Folder(L"txt")));
}

TEST(PanelVisibility, TreatsPackagesLikeFiles)
{
    EXPECT_FALSE(IsShown(Package(L"bundle")));
    EXPECT_TRUE(IsShownInPanel(Package(L"bundle"), kPackagesAreFiles, {CStdStr(L"bundle")}));
}

TEST(PanelVisibility, ShowsEveryPackageWherePackagesAreFolders)
{
    EXPECT_TRUE(IsShown(Package(L"bundle"), kPackagesAreFolders));
}

TEST(PanelVisibility, ShowsOfAllApplicationsOfTheSystemTheHostOnly)
{
    PanelFile host = Package(L"APP");
    host.isHostFolder = true;
    EXPECT_TRUE(IsShown(host));
    EXPECT_FALSE(IsShown(Package(L"app")));
}

TEST(PanelVisibility, HidesAHostFolderThatIsNoApplication)
{
    PanelFile host = Package(L"debug");
    host.isHostFolder = true;
    EXPECT_FALSE(IsShown(host));
}

TEST(PanelVisibility, HidesWhatDoesNotExist)
{
    PanelFile broken = File(L"lsp");
    broken.exists = false;
    EXPECT_FALSE(IsShown(broken));
}
