#include <gtest/gtest.h>

#include <wincompat/winfile.h>

#include <cerrno>
#include <ostream>
#include <string>

#include "host/text/Unicode.h"
#include "tests/host/files/CaseName.h"

namespace
{
constexpr std::size_t kPartRoom = 64;

struct Case
{
    const wchar_t* path;
    const wchar_t* drive;
    const wchar_t* folder;
    const wchar_t* name;
    const wchar_t* extension;
};

void PrintTo(const Case& value, std::ostream* stream)
{
    *stream << tessel::toUtf8(value.path);
}

// Buffers that are known not to be empty before the call.
struct Parts
{
    std::wstring drive = std::wstring(kPartRoom, L'?');
    std::wstring folder = drive;
    std::wstring name = drive;
    std::wstring extension = drive;

    int split(const wchar_t* path, std::size_t driveSize = kPartRoom, std::size_t folderSize = kPartRoom,
              std::size_t nameSize = kPartRoom, std::size_t extensionSize = kPartRoom)
    {
        return _wsplitpath_s(path, drive.data(), driveSize, folder.data(), folderSize, name.data(), nameSize,
                             extension.data(), extensionSize);
    }
    bool areEmpty() const
    {
        return drive[0] == L'\0' && folder[0] == L'\0' && name[0] == L'\0' && extension[0] == L'\0';
    }
    bool areUntouchedAfterTheFirst() const
    {
        const std::wstring rest(kPartRoom - 1, L'?');
        return drive.substr(1) == rest && folder.substr(1) == rest && name.substr(1) == rest &&
               extension.substr(1) == rest;
    }
};

class SplitPath : public testing::TestWithParam<Case>
{
};
} // namespace

TEST_P(SplitPath, FindsTheFourParts)
{
    const Case& expected = GetParam();
    Parts parts;
    ASSERT_EQ(parts.split(expected.path), 0);
    EXPECT_STREQ(parts.drive.c_str(), expected.drive);
    EXPECT_STREQ(parts.folder.c_str(), expected.folder);
    EXPECT_STREQ(parts.name.c_str(), expected.name);
    EXPECT_STREQ(parts.extension.c_str(), expected.extension);
}

INSTANTIATE_TEST_SUITE_P(
    Table, SplitPath,
    testing::Values(Case{L"", L"", L"", L"", L""}, Case{L"tool.lsp", L"", L"", L"tool", L".lsp"},
                    Case{L"/x/y/tool.lsp", L"", L"/x/y/", L"tool", L".lsp"},
                    Case{L"\\x\\tool.lsp", L"", L"\\x\\", L"tool", L".lsp"},
                    Case{L"a/b\\tool.lsp", L"", L"a/b\\", L"tool", L".lsp"},
                    Case{L"a\\b/tool.lsp", L"", L"a\\b/", L"tool", L".lsp"},
                    Case{L"C:\\x\\tool.lsp", L"C:", L"\\x\\", L"tool", L".lsp"},
                    Case{L"C:tool.lsp", L"C:", L"", L"tool", L".lsp"}, Case{L"C:", L"C:", L"", L"", L""},
                    Case{L":", L"", L"", L":", L""}, Case{L"/", L"", L"/", L"", L""},
                    Case{L"/x/y/", L"", L"/x/y/", L"", L""}, Case{L"tool", L"", L"", L"tool", L""},
                    Case{L"tool.", L"", L"", L"tool", L"."}, Case{L".lsp", L"", L"", L"", L".lsp"},
                    Case{L"a.b.c", L"", L"", L"a.b", L".c"},
                    Case{L"dir.old/tool", L"", L"dir.old/", L"tool", L""},
                    Case{L"dir.old\\tool", L"", L"dir.old\\", L"tool", L""},
                    Case{L"/x/..", L"", L"/x/", L".", L"."},
                    Case{L"/x/100%s \"a\".lsp", L"", L"/x/", L"100%s \"a\"", L".lsp"},
                    Case{L"/büro/größe.LSP", L"", L"/büro/", L"größe", L".LSP"}),
    [](const auto& which) { return caseName(which.index, which.param.path); });

TEST(SplitPathBuffers, MayFitExactly)
{
    Parts parts;
    EXPECT_EQ(parts.split(L"C:/xy/tool.lsp", 3, 5, 5, 5), 0);
    EXPECT_STREQ(parts.folder.c_str(), L"/xy/");
    EXPECT_STREQ(parts.extension.c_str(), L".lsp");
}

TEST(SplitPathBuffers, AreAllEmptiedWhenOnePartDoesNotFit)
{
    constexpr std::size_t kSizes[][4] = {{2, 5, 5, 5}, {3, 4, 5, 5}, {3, 5, 4, 5}, {3, 5, 5, 4}};
    for (const auto& size : kSizes)
    {
        Parts parts;
        EXPECT_EQ(parts.split(L"C:/xy/tool.lsp", size[0], size[1], size[2], size[3]), ERANGE);
        EXPECT_TRUE(parts.areEmpty());
        EXPECT_TRUE(parts.areUntouchedAfterTheFirst());
    }
}

TEST(SplitPathBuffers, TakeAPathOfFourThousandCharactersOrNothing)
{
    const std::wstring folder = L"/" + std::wstring(3989, L'd') + L"/";
    const std::wstring path = folder + L"tool.lsp";
    std::wstring room(4096, L'?');
    wchar_t name[256];
    wchar_t extension[256];
    EXPECT_EQ(_wsplitpath_s(path.c_str(), nullptr, 0, room.data(), room.size(), name, 256, extension, 256),
              0);
    EXPECT_EQ(std::wstring(room.c_str()), folder);
    EXPECT_STREQ(name, L"tool");
    Parts parts;
    EXPECT_EQ(parts.split(path.c_str()), ERANGE);
    EXPECT_TRUE(parts.areEmpty());
}

TEST(SplitPathBuffers, MayBeNullWithoutASize)
{
    wchar_t name[kPartRoom];
    EXPECT_EQ(_wsplitpath_s(L"C:/x/tool.lsp", nullptr, 0, nullptr, 0, name, kPartRoom, nullptr, 0), 0);
    EXPECT_STREQ(name, L"tool");
}

TEST(SplitPathBuffers, MustAgreeWithTheirSizes)
{
    Parts parts;
    EXPECT_EQ(_wsplitpath_s(L"x", nullptr, kPartRoom, parts.folder.data(), kPartRoom, parts.name.data(),
                            kPartRoom, parts.extension.data(), kPartRoom),
              EINVAL);
    EXPECT_EQ(parts.folder[0], L'\0');
    EXPECT_EQ(parts.name[0], L'\0');
    EXPECT_EQ(parts.extension[0], L'\0');
    Parts sized;
    EXPECT_EQ(sized.split(L"x", 0), EINVAL);
    EXPECT_EQ(sized.drive[0], L'?');
    EXPECT_EQ(sized.name[0], L'\0');
}

TEST(SplitPathBuffers, AreEmptiedForANullPath)
{
    Parts parts;
    EXPECT_EQ(parts.split(nullptr), EINVAL);
    EXPECT_TRUE(parts.areEmpty());
}
