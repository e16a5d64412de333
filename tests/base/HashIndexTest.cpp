#include "modrig/base/HashIndex.h"

#include <map>
#include <random>
#include <vector>

#include <gmock/gmock.h>

using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;

namespace
{
std::vector<int> under(const HashIndex<int>& index, std::size_t hash)
{
    std::vector<int> found;
    EXPECT_FALSE(index.AnyUnder(hash,
                                [&](int value)
                                {
                                    found.push_back(value);
                                    return false;
                                }));
    return found;
}
} // namespace

TEST(HashIndex, HoldsNothingAtFirstAndNothingOnceCleared)
{
    HashIndex<int> index;
    EXPECT_THAT(under(index, 5), IsEmpty());
    index.Add(5, 1);
    EXPECT_THAT(under(index, 5), ElementsAre(1));
    index.Clear();
    EXPECT_THAT(under(index, 5), IsEmpty());
    index.Add(5, 2);
    EXPECT_THAT(under(index, 5), ElementsAre(2));
}

TEST(HashIndex, TellsHashesApartThatShareAPlace)
{
    HashIndex<int> index;
    for (int value = 0; value < 4; ++value)
        index.Add(static_cast<std::size_t>(value) << 20U, value);
    EXPECT_THAT(under(index, std::size_t{2} << 20U), ElementsAre(2));
    EXPECT_THAT(under(index, std::size_t{5} << 20U), IsEmpty());
}

TEST(HashIndex, HoldsSeveralValuesUnderOneHash)
{
    HashIndex<int> index;
    for (const int value : {7, 8, 9, 8})
        index.Add(3, value);
    EXPECT_THAT(under(index, 3), UnorderedElementsAre(7, 8, 8, 9));
    index.Remove(3, 8);
    EXPECT_THAT(under(index, 3), UnorderedElementsAre(7, 8, 9));
}

TEST(HashIndex, StopsAtTheValueThatWasLookedFor)
{
    HashIndex<int> index;
    for (const int value : {1, 2, 3})
        index.Add(3, value);
    int asked = 0;
    EXPECT_TRUE(index.AnyUnder(3, [&](int) { return ++asked == 2; }));
    EXPECT_EQ(asked, 2);
}

TEST(HashIndex, StaysRightThroughThousandsOfChanges)
{
    // Spread over the places, and crowded at the last one, where the row goes on at the first.
    for (const unsigned crowding : {0U, 20U})
    {
        HashIndex<int> index;
        std::map<std::size_t, std::vector<int>> expected;
        std::mt19937 random(11);
        for (int value = 0; value < 5000; ++value)
        {
            const std::size_t hash = ((random() % 300) << crowding) | (crowding > 0 ? 0xFFFFU : 0U);
            std::vector<int>& values = expected[hash];
            if (values.empty() || random() % 3 != 0)
            {
                values.push_back(value);
                index.Add(hash, value);
                continue;
            }
            const auto gone = values.begin() + static_cast<std::ptrdiff_t>(random() % values.size());
            index.Remove(hash, *gone);
            values.erase(gone);
        }
        for (const auto& [hash, values] : expected)
            EXPECT_THAT(under(index, hash), testing::UnorderedElementsAreArray(values)) << hash;
    }
}
