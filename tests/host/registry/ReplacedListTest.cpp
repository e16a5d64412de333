// Lists that are removed and written again, value by value: what stays in its row, and that nobody sees it.
#include <gmock/gmock.h>

#include <algorithm>
#include <random>
#include <string>
#include <vector>

#include "host/text/Unicode.h"
#include "tests/host/registry/StoredList.h"
#include "tests/host/support/RegistryHost.h"
#include "tests/support/ChildProcess.h"
#include "tests/support/Database.h"

using tessel::Registry;
using testing::ElementsAre;

namespace
{
constexpr const wchar_t* kReplacedKey = L"List";
// More than the registry stores one by one, and at once, and reads at once.
constexpr int kLong = 250;

class ReplacedList : public testing::Test
{
protected:
    Registry& registry() { return host.registry(); }
    Registry::Key key() { return *registry().create(kReplacedKey, Registry::kRoot); }

    void write(const std::wstring& name, const std::wstring& data)
    {
        EXPECT_TRUE(registry().writeValue(key(), name, data));
    }
    void writeNumbered(int count, const std::wstring& data)
    {
        for (int number = 1; number <= count; ++number)
            write(std::to_wstring(number), data + std::to_wstring(number));
    }
    void removeAll()
    {
        for (const auto& value : registry().values(key()))
            EXPECT_TRUE(registry().removeValue(key(), value.name));
    }
    // Name and data of each.
    std::vector<std::wstring> stored(Registry& from)
    {
        std::vector<std::wstring> all;
        for (const auto& value : from.values(from.find(kReplacedKey)))
            all.push_back(value.name + L"=" + value.data);
        return all;
    }
    std::vector<std::wstring> storedAfterTheCommand()
    {
        EXPECT_TRUE(registry().endOfCommand());
        host.open();
        EXPECT_TRUE(registry().canStore()) << tessel::toUtf8(registry().canStore().sentence());
        EXPECT_EQ(runSql(host.file(), "PRAGMA integrity_check"), "ok");
        return stored(registry());
    }
    // The places of the rows in the file.
    std::string places()
    {
        EXPECT_TRUE(registry().endOfCommand());
        return runSql(host.file(), "SELECT group_concat(seq) FROM value WHERE key="
                                   "(SELECT id FROM key WHERE name='List')");
    }

    RegistryHost host;
};
} // namespace

TEST_F(ReplacedList, StaysInItsRowsWhereItIsWrittenAgainUnderTheSameNames)
{
    writeNumbered(kLong, L"a");
    const std::string before = places();
    removeAll();
    writeNumbered(kLong, L"a");
    EXPECT_EQ(places(), before);
    removeAll();
    writeNumbered(kLong, L"b");
    EXPECT_EQ(places(), before);
    const auto now = storedAfterTheCommand();
    ASSERT_EQ(now.size(), static_cast<std::size_t>(kLong));
    EXPECT_EQ(now.front(), L"1=b1");
    EXPECT_EQ(now.back(), L"250=b250");
}

TEST_F(ReplacedList, LosesWhatIsNotWrittenAgain)
{
    writeNumbered(kLong, L"a");
    EXPECT_TRUE(registry().endOfCommand());
    removeAll();
    writeNumbered(2, L"b");
    EXPECT_THAT(storedAfterTheCommand(), ElementsAre(L"1=b1", L"2=b2"));
}

TEST_F(ReplacedList, IsGoneWhenNothingIsWrittenAgain)
{
    writeNumbered(kLong, L"a");
    EXPECT_TRUE(registry().endOfCommand());
    removeAll();
    EXPECT_THAT(storedAfterTheCommand(), ElementsAre());
}

TEST_F(ReplacedList, IsGoneAtOnceForWhoLooksInTheSameCommand)
{
    writeNumbered(3, L"a");
    EXPECT_TRUE(registry().endOfCommand());
    for (const wchar_t* name : {L"1", L"2"})
        EXPECT_TRUE(registry().removeValue(key(), name));
    EXPECT_FALSE(registry().readValue(key(), L"1"));
    EXPECT_FALSE(registry().removeValue(key(), L"2"));
    EXPECT_EQ(*registry().valueName(key(), 0), L"3");
    EXPECT_THAT(stored(registry()), ElementsAre(L"3=a3"));
}

TEST_F(ReplacedList, ShowsWhatHasComeBackAndNoneOfTheRest)
{
    writeNumbered(3, L"a");
    EXPECT_TRUE(registry().endOfCommand());
    removeAll();
    write(L"1", L"b");
    EXPECT_EQ(*registry().readValue(key(), L"1"), L"b");
    EXPECT_FALSE(registry().readValue(key(), L"2"));
    write(L"2", L"c");
    EXPECT_THAT(storedAfterTheCommand(), ElementsAre(L"1=b", L"2=c"));
}

TEST_F(ReplacedList, TakesTheOrderInWhichItIsWrittenAgain)
{
    writeNumbered(3, L"a");
    EXPECT_TRUE(registry().endOfCommand());
    removeAll();
    for (const wchar_t* name : {L"1", L"3", L"2"})
        write(name, L"b");
    EXPECT_THAT(storedAfterTheCommand(), ElementsAre(L"1=b", L"3=b", L"2=b"));
}

TEST_F(ReplacedList, StandsAfterWhatWasNotRemoved)
{
    writeNumbered(3, L"a");
    EXPECT_TRUE(registry().endOfCommand());
    for (const wchar_t* name : {L"1", L"2"})
        EXPECT_TRUE(registry().removeValue(key(), name));
    for (const wchar_t* name : {L"1", L"2"})
        write(name, L"b");
    EXPECT_THAT(storedAfterTheCommand(), ElementsAre(L"3=a3", L"1=b", L"2=b"));
}

// Some of what was written before stands in the file by then, and some does not.
TEST_F(ReplacedList, StandsAfterWhatTheSameCommandHasWrittenBefore)
{
    for (int removed = 184; removed < 200; ++removed)
    {
        writeNumbered(kLong, L"a");
        for (int number = 1; number <= removed; ++number)
            EXPECT_TRUE(registry().removeValue(key(), std::to_wstring(number)));
        writeNumbered(removed, L"b");
        const auto now = storedAfterTheCommand();
        ASSERT_EQ(now.size(), static_cast<std::size_t>(kLong));
        EXPECT_EQ(now.front(), std::to_wstring(removed + 1) + L"=a" + std::to_wstring(removed + 1));
        EXPECT_EQ(now.back(), std::to_wstring(removed) + L"=b" + std::to_wstring(removed));
        removeAll();
        EXPECT_TRUE(registry().endOfCommand());
    }
}

TEST_F(ReplacedList, StaysInItsRowsAlsoAfterACommandThatRemovedInAnotherOrder)
{
    writeNumbered(kLong, L"a");
    EXPECT_TRUE(registry().endOfCommand());
    for (const wchar_t* name : {L"250", L"249"})
        EXPECT_TRUE(registry().removeValue(key(), name));
    const std::string before = places();
    removeAll();
    writeNumbered(kLong - 2, L"b");
    EXPECT_EQ(places(), before);
}

TEST_F(ReplacedList, TakesTheSpellingInWhichANameIsWrittenAgain)
{
    write(L"name", L"data");
    EXPECT_TRUE(registry().endOfCommand());
    removeAll();
    write(L"NAME", L"data");
    EXPECT_THAT(storedAfterTheCommand(), ElementsAre(L"NAME=data"));
}

TEST_F(ReplacedList, KeepsItsPlaceAndSpellingWhereAValueIsOnlyWrittenAgain)
{
    writeNumbered(kLong, L"a");
    write(L"Last", L"1");
    write(L"LAST", L"2");
    const auto now = storedAfterTheCommand();
    ASSERT_EQ(now.size(), static_cast<std::size_t>(kLong) + 1);
    EXPECT_EQ(now.back(), L"Last=2");
}

TEST_F(ReplacedList, IsWhatAnotherProcessStoredWhenTheNextCommandReplacesIt)
{
    ASSERT_TRUE(rewriteList(registry(), 1, kLong));
    ASSERT_TRUE(registry().endOfCommand());
    const std::string other = askChild(
        [this]
        {
            Registry theirs(host.file());
            const bool done = rewriteList(theirs, 2, 2 * kLong) && theirs.endOfCommand();
            return std::string(done ? "stored" : "failed");
        });
    ASSERT_EQ(other, "stored");
    EXPECT_EQ(generationOf(registry()), 2);
    ASSERT_TRUE(rewriteList(registry(), 3, kLong));
    EXPECT_EQ(generationOf(registry()), 3);
    ASSERT_TRUE(registry().endOfCommand());
    EXPECT_EQ(generationInOneLook(host.file()), 3);
}

namespace
{
// What the registry is to look like: values in the order of creation.
class PlainList
{
public:
    void write(const std::wstring& name, const std::wstring& data)
    {
        if (const auto found = find(name); found != mValues.end())
            found->data = data;
        else
            mValues.push_back({name, data});
    }
    bool remove(const std::wstring& name)
    {
        const auto found = find(name);
        const bool isThere = found != mValues.end();
        if (isThere)
            mValues.erase(found);
        return isThere;
    }
    const std::vector<Registry::Value>& values() const { return mValues; }
    std::vector<Registry::Value>::iterator find(const std::wstring& name)
    {
        return std::find_if(mValues.begin(), mValues.end(),
                            [&](const Registry::Value& value)
                            { return tessel::equalIgnoringCase(value.name, name); });
    }
    bool holds(const std::wstring& name) { return find(name) != mValues.end(); }

private:
    std::vector<Registry::Value> mValues;
};

// Two lists of which much is removed first to last and written again first to last, but not all of it.
class RandomReplacing : public ReplacedList, public testing::WithParamInterface<unsigned>
{
protected:
    int below(int count) { return static_cast<int>(mRandom() % static_cast<unsigned>(count)); }
    std::wstring someName()
    {
        const std::wstring number = std::to_wstring(1 + below(kLong));
        return (below(2) == 0 ? L"Name" : L"NAME") + number;
    }
    Registry::Key keyOf(int list) { return *registry().create(std::to_wstring(list), Registry::kRoot); }

    void write(int list, const std::wstring& name)
    {
        const std::wstring data = std::to_wstring(below(3));
        EXPECT_TRUE(registry().writeValue(keyOf(list), name, data));
        mPlain[list].write(name, data);
    }
    void remove(int list, const std::wstring& name)
    {
        EXPECT_EQ(static_cast<bool>(registry().removeValue(keyOf(list), name)), mPlain[list].remove(name));
    }
    void removeFirst(int list, int count)
    {
        const auto values = mPlain[list].values();
        for (int i = 0; i < std::min(count, static_cast<int>(values.size())); ++i)
            remove(list, values[static_cast<std::size_t>(i)].name);
    }
    void writeNumbers(int list, int first, int last)
    {
        for (int number = first; number <= last; ++number)
            write(list, L"Name" + std::to_wstring(number));
    }
    void readOne(int list)
    {
        const std::wstring name = someName();
        const auto read = registry().readValue(keyOf(list), name);
        ASSERT_EQ(static_cast<bool>(read), mPlain[list].holds(name));
        EXPECT_EQ(read ? *read : L"", read ? mPlain[list].find(name)->data : L"");
    }
    void compare(int list)
    {
        const auto values = registry().values(keyOf(list));
        const auto& plain = mPlain[list].values();
        ASSERT_EQ(values.size(), plain.size());
        for (std::size_t i = 0; i < plain.size(); ++i)
            EXPECT_EQ(values[i].name + L"=" + values[i].data, plain[i].name + L"=" + plain[i].data);
    }
    void doSomething()
    {
        const int list = below(2);
        switch (below(8))
        {
        case 0:
            return write(list, someName());
        case 1:
            return remove(list, someName());
        case 2:
            return removeFirst(list, below(kLong));
        case 3:
            return readOne(list);
        case 4:
            return compare(list);
        case 5:
        {
            EXPECT_TRUE(registry().endOfCommand());
            return;
        }
        default:
            removeFirst(list, kLong);
            return writeNumbers(list, 1 + below(2), 1 + below(kLong));
        }
    }

    std::minstd_rand mRandom{GetParam()};
    PlainList mPlain[2];
};
} // namespace

TEST_P(RandomReplacing, LeavesWhatAPlainListHolds)
{
    for (int step = 0; step < 200 && !HasFailure(); ++step)
        doSomething();
    EXPECT_TRUE(registry().endOfCommand());
    host.open();
    EXPECT_TRUE(registry().canStore());
    EXPECT_EQ(runSql(host.file(), "PRAGMA integrity_check"), "ok");
    for (int list : {0, 1})
        compare(list);
}

INSTANTIATE_TEST_SUITE_P(Lists, RandomReplacing, testing::Range(1u, 9u));
