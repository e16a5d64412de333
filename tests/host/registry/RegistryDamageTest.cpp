// A registry's file that was changed behind Tessel's back: what is read is right, or a person is told, and
// nothing is written over what cannot be read.
#include <gmock/gmock.h>

#include <algorithm>
#include <cstdint>
#include <random>
#include <sstream>

#include "host/registry/Soundness.h"
#include "host/text/Unicode.h"
#include "tests/host/registry/StoredList.h"
#include "tests/host/support/RegistryHost.h"
#include "tests/support/Database.h"

namespace fs = std::filesystem;

using tessel::Registry;
using testing::AllOf;
using testing::EndsWith;
using testing::HasSubstr;
using testing::IsEmpty;

namespace
{
constexpr int kStoredEntries = 60;
constexpr std::size_t kPageBytes = 4096;

class DamagedRegistry : public testing::Test
{
protected:
    fs::path file() const { return folder / "registry.db"; }
    fs::path copy() const { return folder / "registry.db.sound"; }

    void makeFile(int entries = kStoredEntries)
    {
        Registry registry(file());
        ASSERT_TRUE(rewriteList(registry, 1, entries));
        ASSERT_TRUE(registry.endOfCommand());
        ASSERT_TRUE(registry.keepCopy());
    }

    // Puts the bytes in the place of the file, as nobody had opened it since.
    void putFile(const std::string& bytes)
    {
        for (const char* journal : {"-wal", "-shm", "-journal"})
            fs::remove(file().string() + journal);
        folder.write("registry.db", bytes);
    }

    // Every entry under its name, and all of them in a row.
    bool readsRight(Registry& registry, int entries = kStoredEntries)
    {
        const Registry::Key key = registry.find(kListKey);
        for (int number = 1; number <= entries; ++number)
        {
            const auto data = registry.readValue(key, std::to_wstring(number) + L"History");
            if (!data || data->find(L"1 /büro/" + std::to_wstring(number) + L"x") != 0)
                return false;
        }
        return generationOf(registry) == 1;
    }

    struct Outcome
    {
        bool told = false;
        bool right = false;
        bool unchanged = true; // of one that was told: after an attempt to write over all of it
    };

    // What a session makes of the bytes that reads everything and then stores another list.
    Outcome sessionWith(const std::string& bytes)
    {
        putFile(bytes);
        Outcome outcome;
        {
            Registry registry(file());
            outcome.right = readsRight(registry);
            const auto read = registry.endOfCommand();
            outcome.told = !registry.canStore() || !read || registry.notice();
            const bool written = rewriteList(registry, 2, kStoredEntries);
            const auto stored = registry.endOfCommand();
            EXPECT_TRUE(!outcome.told || !written);
            outcome.told = outcome.told || !stored;
            EXPECT_NE(written && stored, outcome.told);
        }
        outcome.unchanged = !outcome.told || contentOf(file()) == bytes;
        return outcome;
    }

    std::string sentenceOf(const tessel::Result<>& result) const { return tessel::toUtf8(result.sentence()); }

    // The pages of a table or an index, the root first.
    std::vector<std::size_t> pagesOf(const std::string& name) const
    {
        const std::string sql =
            "SELECT group_concat(pageno, ' ') FROM (SELECT pageno FROM dbstat WHERE name='" + name +
            "' ORDER BY path)";
        std::istringstream numbers(runSql(file(), sql.c_str()));
        return {std::istream_iterator<std::size_t>(numbers), {}};
    }

    TemporaryFolder folder;
};
} // namespace

TEST_F(DamagedRegistry, WithOneFlippedBitIsReadRightOrTold)
{
    makeFile();
    const std::string whole = contentOf(file());
    std::mt19937 random(17);
    int told = 0;
    for (int round = 0; round < 200; ++round)
    {
        std::string flipped = whole;
        const std::size_t bit = random() % (flipped.size() * 8);
        flipped[bit / 8] = static_cast<char>(flipped[bit / 8] ^ (1 << bit % 8));
        const Outcome outcome = sessionWith(flipped);
        told += outcome.told;
        EXPECT_TRUE(outcome.told || outcome.right) << "bit " << bit;
        EXPECT_TRUE(outcome.unchanged) << "bit " << bit;
    }
    EXPECT_GT(told, 20) << "the flips reach what is stored";
}

TEST_F(DamagedRegistry, WithAFlippedBitInItsHeadIsReadRightOrTold)
{
    makeFile();
    const std::string whole = contentOf(file());
    constexpr std::size_t kHeadBits = 800;
    for (std::size_t bit = 0; bit < kHeadBits; ++bit)
    {
        std::string flipped = whole;
        flipped[bit / 8] = static_cast<char>(flipped[bit / 8] ^ (1 << bit % 8));
        const Outcome outcome = sessionWith(flipped);
        EXPECT_TRUE(outcome.told || outcome.right) << "bit " << bit;
        EXPECT_TRUE(outcome.unchanged) << "bit " << bit;
    }
}

TEST_F(DamagedRegistry, ThatWasCutShortIsTold)
{
    makeFile();
    const std::string whole = contentOf(file());
    std::vector<std::size_t> lengths = {whole.size() - 1, whole.size() - 2, whole.size() / 2};
    for (std::size_t length = whole.size() / 2; length < whole.size(); length += 997)
        lengths.push_back(length);
    for (const std::size_t length : lengths)
    {
        const Outcome outcome = sessionWith(whole.substr(0, length));
        EXPECT_TRUE(outcome.told) << length;
        EXPECT_TRUE(outcome.unchanged) << length;
    }
}

TEST_F(DamagedRegistry, IsToldByWhatIsDamagedAndWhatHelps)
{
    makeFile();
    ASSERT_EQ(runSql(file(), "UPDATE value SET data='other' WHERE name='7History'"), "");
    Registry registry(file());
    EXPECT_THAT(sentenceOf(registry.canStore()),
                AllOf(HasSubstr("The registry " + file().string() +
                                " is damaged: the value \"7History\" in "
                                "\"Software\\Tessel\\R21\\Profiles\\Default\\Dialogs\\Modrig\\History\" is "
                                "not what was stored there. It was left as it is, and nothing will be "
                                "stored. REGISTRY RESTORE puts back the copy of 2"),
                      EndsWith(".")));
    fs::remove(copy());
    EXPECT_THAT(sentenceOf(Registry(file()).canStore()),
                EndsWith("There is no copy of an earlier state. REGISTRY RESET sets it aside and begins "
                         "with an empty one."));
}

TEST_F(DamagedRegistry, WithAChangedKeyIsTold)
{
    makeFile();
    ASSERT_EQ(runSql(file(), "UPDATE key SET name='Fog' WHERE name='Dialogs'"), "");
    EXPECT_THAT(sentenceOf(Registry(file()).canStore()),
                HasSubstr("the key \"Fog\" in \"Software\\Tessel\\R21\\Profiles\\Default\" is not what was "
                          "stored there"));
}

TEST_F(DamagedRegistry, IsReadWhereItIsSound)
{
    makeFile();
    ASSERT_EQ(runSql(file(), "UPDATE value SET data='other' WHERE name='7History'"), "");
    Registry registry(file());
    const Registry::Key key = registry.find(kListKey);
    EXPECT_FALSE(registry.readValue(key, L"7History"));
    EXPECT_TRUE(registry.readValue(key, L"8History"));
}

TEST_F(DamagedRegistry, IsNotWrittenOverInTheSessionInWhichAReadFailed)
{
    makeFile();
    Registry registry(file());
    ASSERT_TRUE(readsRight(registry));
    registry.storeSoFar();
    ASSERT_EQ(runSql(file(), "UPDATE value SET data='other' WHERE name='7History'"), "");
    EXPECT_FALSE(readsRight(registry));
    EXPECT_FALSE(registry.write(L"A", L"name", L"1")) << "in the same command";
    const auto told = registry.endOfCommand();
    EXPECT_THAT(sentenceOf(told), AllOf(HasSubstr("The registry " + file().string() + " could not be read: "),
                                        HasSubstr("Nothing more is stored in this session"),
                                        HasSubstr("REGISTRY RESTORE puts back the copy of 2")));
    EXPECT_FALSE(registry.removeKey(registry.find(L"Software"))) << "in a later one";
    EXPECT_FALSE(writeList(registry, 2, 3));
    EXPECT_TRUE(registry.endOfCommand()) << "that it fails was told";
    EXPECT_EQ(runSql(file(), "SELECT count(*) FROM value"), std::to_string(kStoredEntries + 1));
    ASSERT_TRUE(registry.keepCopy());
    EXPECT_THAT(sentenceOf(Registry(file()).canStore()), HasSubstr("is damaged"))
        << "the next session sees it";
}

TEST_F(DamagedRegistry, IsStoredAgainByTheNextSessionWhenWhatFailedWasPassing)
{
    makeFile();
    {
        Registry registry(file());
        ASSERT_EQ(runSql(file(), "UPDATE value SET data=data||'!' WHERE name='7History'"), "");
        EXPECT_FALSE(readsRight(registry));
        ASSERT_EQ(runSql(file(), "UPDATE value SET data=rtrim(data,'!') WHERE name='7History'"), "");
        registry.storeSoFar();
        EXPECT_TRUE(readsRight(registry));
        EXPECT_FALSE(rewriteList(registry, 2, 3)) << "what was read before may be in use";
    }
    Registry next(file());
    EXPECT_TRUE(rewriteList(next, 2, 3));
    EXPECT_TRUE(next.endOfCommand());
}

// Two cells of a page that have changed places, for each of the index's pages that has two.
TEST_F(DamagedRegistry, WithAnIndexOutOfOrderIsToldAndComesToAnEnd)
{
    constexpr int kMany = 3000;
    makeFile(kMany);
    const std::string whole = contentOf(file());
    const auto pages = pagesOf("value_order");
    ASSERT_GT(pages.size(), 3u);
    for (const std::size_t page : pages)
    {
        std::string changed = whole;
        char* const start = &changed[(page - 1) * kPageBytes];
        const std::size_t pointers = start[0] == 2 ? 12 : 8;
        std::swap_ranges(start + pointers, start + pointers + 2, start + pointers + 6);
        putFile(changed);
        Registry registry(file());
        EXPECT_FALSE(registry.canStore()) << page;
        const Registry::Key key = registry.find(kListKey);
        EXPECT_LE(registry.values(key).size(), kMany + 1u);
        DWORD index = 0;
        while (index < 2 * kMany && registry.valueName(key, index))
            ++index;
        EXPECT_LT(index, 2 * kMany) << "page " << page;
    }
}

TEST_F(DamagedRegistry, WithAPageThatLeadsBackToItselfComesToAnEnd)
{
    constexpr int kMany = 3000;
    makeFile(kMany);
    const auto pages = pagesOf("value_order");
    std::string changed = contentOf(file());
    // The last branch of the root: itself.
    char* const branch = &changed[(pages.front() - 1) * kPageBytes + 8];
    const auto root = static_cast<std::uint32_t>(pages.front());
    for (int byte = 0; byte < 4; ++byte)
        branch[byte] = static_cast<char>(root >> (24 - 8 * byte));
    putFile(changed);
    Registry registry(file());
    EXPECT_FALSE(registry.canStore());
    EXPECT_LE(registry.values(registry.find(kListKey)).size(), kMany + 1u);
    EXPECT_TRUE(registry.endOfCommand()) << "that it is damaged was told when it was opened";
}

// A look costs as much as the file is long, and a person waits for it.
TEST_F(DamagedRegistry, IsLookedForAtEveryStartUpToSomeThousandValuesAndLessOftenBeyond)
{
    const auto startsBetweenLooks = [this](int entries)
    {
        fs::remove(file());
        fs::remove(copy());
        makeFile(entries);
        sqlite3* database = nullptr;
        sqlite3_open(file().c_str(), &database);
        const unsigned starts = tessel::startsBetweenLooks(database);
        sqlite3_close(database);
        return starts;
    };
    EXPECT_EQ(startsBetweenLooks(3000), 1U);
    EXPECT_EQ(startsBetweenLooks(12'000), 3U);
}

TEST_F(DamagedRegistry, ThatIsHugeIsNotWrittenOverEither)
{
    constexpr int kHuge = 60'000; // no longer looked at as a whole at each start
    makeFile(kHuge);
    const auto pages = pagesOf("sqlite_autoindex_value_1");
    std::string changed = contentOf(file());
    changed[pages.back() * kPageBytes - 100] =
        static_cast<char>(changed[pages.back() * kPageBytes - 100] ^ 1);
    for (int round = 0; round < 6; ++round)
    {
        putFile(changed);
        {
            Registry registry(file());
            EXPECT_FALSE(rewriteList(registry, 2, 3));
            const bool told = !registry.endOfCommand();
            EXPECT_TRUE(told || !registry.canStore());
        }
        EXPECT_TRUE(contentOf(file()) == changed);
    }
}

TEST_F(DamagedRegistry, IsRestoredFromTheCopy)
{
    makeFile();
    const std::string whole = contentOf(file());
    const std::string damaged = whole.substr(0, whole.size() / 2);
    putFile(damaged);
    Registry registry(file());
    const auto restored = registry.restoreCopy();
    EXPECT_THAT(tessel::toUtf8(*restored),
                AllOf(HasSubstr("The registry " + file().string() + " was restored from the copy of 2"),
                      HasSubstr("is kept as " + file().string() + ".damaged")));
    EXPECT_TRUE(contentOf(file().string() + ".damaged") == damaged);
    EXPECT_TRUE(readsRight(registry)) << "at once";
    EXPECT_FALSE(rewriteList(registry, 2, 3)) << "what was read before may be in use";
    EXPECT_THAT(sentenceOf(registry.canStore()), HasSubstr("before Tessel is started again"));
    Registry next(file());
    EXPECT_EQ(next.canStore().sentence(), L"");
    EXPECT_TRUE(readsRight(next));
    EXPECT_TRUE(rewriteList(next, 2, 3));
}

TEST_F(DamagedRegistry, IsNotRestoredFromACopyThatIsDamagedItself)
{
    makeFile();
    ASSERT_EQ(runSql(copy(), "UPDATE value SET data='other' WHERE name='7History'"), "");
    const std::string damaged = contentOf(file()).substr(0, 3 * kPageBytes);
    putFile(damaged);
    Registry registry(file());
    const auto restored = registry.restoreCopy();
    EXPECT_THAT(tessel::toUtf8(restored.sentence()),
                AllOf(HasSubstr("was not restored"), HasSubstr(copy().string()), HasSubstr("7History")));
    EXPECT_TRUE(contentOf(file()) == damaged);
}

TEST_F(DamagedRegistry, IsNotRestoredWithoutACopyOrWithoutDamage)
{
    makeFile();
    {
        Registry sound(file());
        EXPECT_THAT(tessel::toUtf8(sound.restoreCopy().sentence()), HasSubstr("not known to be damaged"));
        EXPECT_TRUE(sound.write(L"A", L"name", L"1"));
    }
    fs::remove(copy());
    const std::string damaged = contentOf(file()).substr(0, 3 * kPageBytes);
    putFile(damaged);
    Registry registry(file());
    EXPECT_THAT(tessel::toUtf8(registry.restoreCopy().sentence()),
                HasSubstr("was not restored: there is no copy of an earlier state."));
    EXPECT_TRUE(contentOf(file()) == damaged);
}

TEST_F(DamagedRegistry, ThatIsGoneOrEmptyIsNotMadeAgainBesideItsCopy)
{
    makeFile();
    const std::string kept = contentOf(copy());
    fs::remove(file());
    {
        Registry registry(file());
        EXPECT_THAT(sentenceOf(registry.canStore()),
                    AllOf(HasSubstr("it is empty or missing, but the copy of what it held is there"),
                          HasSubstr("REGISTRY RESTORE puts back the copy of 2")));
        EXPECT_FALSE(registry.write(L"A", L"name", L"1"));
    }
    EXPECT_FALSE(fs::exists(file()));
    folder.write("registry.db", "");
    Registry registry(file());
    EXPECT_FALSE(registry.canStore());
    ASSERT_TRUE(registry.restoreCopy());
    EXPECT_TRUE(readsRight(registry));
    EXPECT_TRUE(contentOf(copy()) == kept);
}

TEST_F(DamagedRegistry, NeverBecomesTheCopy)
{
    makeFile();
    const std::string kept = contentOf(copy());
    Registry registry(file());
    ASSERT_TRUE(registry.write(L"A", L"name", L"1"));
    ASSERT_TRUE(registry.endOfCommand());
    ASSERT_EQ(runSql(file(), "UPDATE value SET data='other' WHERE name='7History'"), "");
    EXPECT_FALSE(readsRight(registry));
    static_cast<void>(registry.endOfCommand());
    EXPECT_TRUE(registry.keepCopy());
    EXPECT_TRUE(contentOf(copy()) == kept);
}

TEST_F(DamagedRegistry, HasACopyOfWhatWasStoredLastInGoodOrderOrFoundSoundAfterwards)
{
    makeFile();
    const auto inCopy = [this](const char* name)
    {
        return runSql(copy(), ("SELECT data FROM value WHERE name='" + std::string(name) + "'").c_str());
    };
    {
        Registry registry(file());
        ASSERT_TRUE(registry.write(L"A", L"first", L"1"));
        ASSERT_TRUE(registry.endOfCommand());
        EXPECT_EQ(inCopy("first"), "");
        ASSERT_TRUE(registry.keepCopy());
        EXPECT_EQ(inCopy("first"), "1");
        ASSERT_TRUE(registry.write(L"A", L"second", L"2"));
        ASSERT_TRUE(registry.endOfCommand());
        // Killed.
        fs::copy_file(file(), folder / "killed.db");
        fs::copy_file(file().string() + "-wal", folder / "killed.db-wal");
    }
    fs::copy_file(folder / "killed.db", file(), fs::copy_options::overwrite_existing);
    fs::copy_file(folder / "killed.db-wal", file().string() + "-wal");
    fs::last_write_time(copy(), fs::last_write_time(copy()) - std::chrono::hours(1));
    const Registry registry(file());
    EXPECT_EQ(inCopy("second"), "2");
}

TEST_F(DamagedRegistry, IsToldWhenItsPlaceWasTaken)
{
    makeFile();
    Registry registry(file());
    const std::string whole = contentOf(file());
    fs::remove(file());
    folder.write("registry.db", whole);
    EXPECT_FALSE(registry.write(L"A", L"name", L"1"));
    EXPECT_THAT(sentenceOf(registry.endOfCommand()), HasSubstr("another file was put in its place"));
    EXPECT_TRUE(contentOf(file()) == whole);
}
