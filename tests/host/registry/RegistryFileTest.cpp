// Registry files that cannot be used, or not wholly: what is there stays, and one sentence says why.
#include <gmock/gmock.h>

#include <random>

#include <unistd.h>

#include "host/text/Unicode.h"
#include "tests/host/registry/StoredList.h"
#include "tests/host/support/RegistryHost.h"
#include "tests/support/ChildProcess.h"
#include "tests/support/Database.h"

namespace fs = std::filesystem;

using tessel::Registry;
using testing::AllOf;
using testing::HasSubstr;

namespace
{
constexpr fs::perms kNobodyWrites = fs::perms::owner_read | fs::perms::group_read | fs::perms::others_read;

// What a URI would take for something else belongs to the name.
const std::string kFile = "registry 100%41?#.db";

constexpr fs::perms kEverybodyEnters =
    kNobodyWrites | fs::perms::owner_exec | fs::perms::group_exec | fs::perms::others_exec;

class RegistryFile : public testing::Test
{
protected:
    fs::path file() const { return folder / kFile; }

    // A registry with a list of many pages, closed.
    void makeFile(int entries = 500)
    {
        Registry registry(file());
        ASSERT_TRUE(rewriteList(registry, 1, entries));
        ASSERT_TRUE(registry.endOfCommand());
    }

    // Nothing can be stored, nothing is found, and nobody stumbles over that.
    void expectUseless(Registry& registry)
    {
        EXPECT_EQ(registry.read(L"A", L"name"), std::nullopt);
        EXPECT_FALSE(registry.write(L"A", L"name", L"1"));
        EXPECT_EQ(registry.create(L"A", Registry::kRoot).code(), ERROR_ACCESS_DENIED);
        EXPECT_EQ(registry.writeValue(Registry::kRoot, L"name", L"1").code(), ERROR_ACCESS_DENIED);
        EXPECT_EQ(registry.removeValue(Registry::kRoot, L"name").code(), ERROR_ACCESS_DENIED);
        EXPECT_TRUE(registry.subKeys(Registry::kRoot).empty());
        EXPECT_TRUE(registry.values(Registry::kRoot).empty());
        EXPECT_EQ(registry.valueName(Registry::kRoot, 0).code(), ERROR_NO_MORE_ITEMS);
        EXPECT_TRUE(registry.endOfCommand());
        EXPECT_EQ(output.text(), "");
    }

    void expectRefusedAndLeftAlone(const char* reason)
    {
        const std::string before = contentOf(file());
        {
            Registry registry(file());
            EXPECT_THAT(tessel::toUtf8(registry.canStore().sentence()),
                        AllOf(HasSubstr(file().string()), HasSubstr(reason)));
            expectUseless(registry);
        }
        EXPECT_TRUE(contentOf(file()) == before) << "not left as it was";
    }

    bool tell(const tessel::Result<>& stored) { return output.commandLine().tell(stored); }

    TemporaryFolder folder;
    CapturedOutput output;
};
} // namespace

TEST_F(RegistryFile, ThatNobodyMayWriteIsRead)
{
    makeFile();
    fs::permissions(file(), kNobodyWrites);
    const std::string before = contentOf(file());
    Registry registry(file());
    EXPECT_THAT(tessel::toUtf8(registry.canStore().sentence()),
                AllOf(HasSubstr(file().string()), HasSubstr("only be read")));
    EXPECT_EQ(generationOf(registry), 1);
    EXPECT_FALSE(registry.write(L"A", L"name", L"1"));
    EXPECT_EQ(registry.create(L"Software", Registry::kRoot).code(), ERROR_ACCESS_DENIED);
    EXPECT_EQ(registry.removeKey(registry.find(L"Software")).code(), ERROR_ACCESS_DENIED);
    EXPECT_TRUE(registry.endOfCommand());
    EXPECT_EQ(output.text(), "");
    EXPECT_TRUE(contentOf(file()) == before);
}

TEST_F(RegistryFile, ThatAUserMayNotWriteIsReadInAFolderThatHeMayNotWriteEither)
{
    constexpr uid_t kNobody = 65534;
    makeFile();
    fs::permissions(file(), fs::perms::owner_all | kNobodyWrites);
    fs::permissions(folder.path(), fs::perms::owner_all | kEverybodyEnters);
    const std::string answer = askChild(
        [this]
        {
            if (geteuid() == 0 && setuid(kNobody) != 0)
                return std::string("still the superuser");
            if (geteuid() != kNobody) // who is not the superuser owns the folder, and gives up his right
            {
                fs::permissions(folder.path(), kEverybodyEnters);
                fs::permissions(file(), kNobodyWrites);
            }
            Registry registry(file());
            return "read " + std::to_string(generationOf(registry)) +
                   (registry.write(L"A", L"name", L"1") ? ", written" : ", not written") + ": " +
                   tessel::toUtf8(registry.canStore().sentence());
        });
    fs::permissions(folder.path(), fs::perms::owner_all);
    EXPECT_THAT(answer, AllOf(HasSubstr("read 1, not written: "), HasSubstr("only be read")));
}

TEST_F(RegistryFile, ThatIsAFolderIsNotUsed)
{
    folder.write(kFile + "/in the way", "");
    Registry registry(file());
    EXPECT_THAT(tessel::toUtf8(registry.canStore().sentence()),
                AllOf(HasSubstr(file().string()), HasSubstr("it is a folder, not a file")));
    expectUseless(registry);
}

TEST_F(RegistryFile, InAFolderThatIsMissingIsNotMade)
{
    Registry registry(folder / "missing" / "registry.db");
    EXPECT_THAT(tessel::toUtf8(registry.canStore().sentence()),
                HasSubstr("it cannot be made: No such file or directory"));
    expectUseless(registry);
    EXPECT_FALSE(fs::exists(folder / "missing"));
}

TEST_F(RegistryFile, ThatIsNoDatabaseIsLeftAsItIs)
{
    std::mt19937 random(7);
    for (const std::size_t size : {2u, 15u, 99u, 100u, 512u, 4096u, 100'000u})
    {
        std::string bytes(size, '\0');
        for (char& byte : bytes)
            byte = static_cast<char>(random());
        folder.write(kFile, bytes);
        expectRefusedAndLeftAlone("file is not a database");
    }
}

TEST_F(RegistryFile, OfAnotherProgramIsLeftAsItIs)
{
    ASSERT_EQ(runSql(file(), "CREATE TABLE contact(name TEXT); INSERT INTO contact VALUES('Ada')"), "");
    expectRefusedAndLeftAlone("it belongs to another program");
    ASSERT_EQ(runSql(file(), "PRAGMA user_version=1"), "");
    expectRefusedAndLeftAlone("its table \"contact\" is not as Tessel makes it");
}

TEST_F(RegistryFile, OfANewerTesselIsLeftAsItIs)
{
    makeFile(5);
    ASSERT_EQ(runSql(file(), "PRAGMA user_version=3"), "");
    expectRefusedAndLeftAlone("it was written by a newer Tessel");
}

TEST_F(RegistryFile, ThatIsEmptyBecomesARegistry)
{
    folder.write(kFile, "");
    Registry registry(file());
    EXPECT_EQ(registry.canStore().sentence(), L"");
    EXPECT_TRUE(registry.write(L"A", L"name", L"1"));
}

TEST_F(RegistryFile, ThatWasCutShortIsLeftAsItIs)
{
    makeFile();
    const std::string whole = contentOf(file());
    for (const std::size_t length : {50ul, 99ul, 100ul, 4096ul, 3 * 4096ul, whole.size() - 4096})
    {
        folder.write(kFile, whole.substr(0, length));
        expectRefusedAndLeftAlone("malformed");
    }
}

TEST_F(RegistryFile, WithADamagedPageIsNeverWrittenOverWhatCannotBeRead)
{
    makeFile();
    const std::string whole = contentOf(file());
    for (std::size_t page = 1; page * 4096 < whole.size(); ++page)
    {
        std::string damaged = whole;
        damaged.replace(page * 4096, 4096, std::string(4096, '\xA5'));
        folder.write(kFile, damaged);
        output.clear();
        bool stored = false;
        bool readable = false;
        bool told = false;
        {
            Registry registry(file());
            told = !registry.canStore();
            readable = generationOf(registry) == 1;
            stored = rewriteList(registry, 2, 500) && tell(registry.endOfCommand());
            tell(registry.endOfCommand());
        }
        EXPECT_TRUE(told || (stored && readable)) << "page " << page;
        if (!readable)
        {
            EXPECT_FALSE(stored) << "page " << page;
            EXPECT_TRUE(contentOf(file()) == damaged) << "page " << page;
        }
    }
}

TEST_F(RegistryFile, IsSoundAfterUse)
{
    makeFile(2000);
    EXPECT_EQ(runSql(file(), "PRAGMA integrity_check"), "ok");
    EXPECT_EQ(runSql(file(), "PRAGMA journal_mode"), "wal");
    EXPECT_FALSE(fs::exists(file().string() + "-wal")) << "all is in the one file";
}
