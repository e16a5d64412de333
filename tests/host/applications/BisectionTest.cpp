#include "host/applications/Bisection.h"

#include <functional>
#include <set>

#include <gtest/gtest.h>

using tessel::Bisection;
using Verdict = tessel::Bisection::Verdict;

namespace
{
constexpr std::size_t kMost = 40;

std::size_t mostStarts(std::size_t suspects)
{
    std::size_t starts = 1;
    for (std::size_t reach = 1; reach < suspects; reach *= 2)
        ++starts;
    return starts;
}

// What the trouble makes of a start with those that are loaded.
using Trouble = std::function<bool(const std::set<std::size_t>& loaded)>;

struct Course
{
    Bisection bisection;
    std::size_t starts = 0;
};

Course follow(std::size_t suspects, const Trouble& trouble)
{
    Course course{Bisection(suspects)};
    std::vector<bool> answers;
    while (course.bisection.verdict() == Verdict::kOpen)
    {
        EXPECT_GE(course.bisection.startsLeft(), 1U);
        EXPECT_LE(course.starts + course.bisection.startsLeft(), mostStarts(suspects));
        std::set<std::size_t> loaded;
        for (std::size_t suspect = 0; suspect < suspects; ++suspect)
            if (course.bisection.isLoaded(suspect))
                loaded.insert(suspect);
        answers.push_back(!trouble(loaded));
        course.bisection.answer(answers.back());
        ++course.starts;
        // What is stored is the answers.
        const Bisection again(suspects, answers);
        EXPECT_EQ(again.verdict(), course.bisection.verdict());
        EXPECT_EQ(again.stillSuspected(), course.bisection.stillSuspected());
    }
    EXPECT_EQ(course.bisection.startsLeft(), 0U);
    return course;
}
} // namespace

TEST(Bisection, NamesEveryCulpritInAsManyStartsAsItMay)
{
    for (std::size_t suspects = 1; suspects <= kMost; ++suspects)
        for (std::size_t culprit = 0; culprit < suspects; ++culprit)
        {
            const auto course =
                follow(suspects, [=](const auto& loaded) { return loaded.contains(culprit); });
            EXPECT_EQ(course.bisection.verdict(), Verdict::kFound) << culprit << " of " << suspects;
            EXPECT_EQ(course.bisection.culprit(), culprit) << "of " << suspects;
            EXPECT_LE(course.starts, mostStarts(suspects)) << culprit << " of " << suspects;
        }
}

TEST(Bisection, SaysThatItIsNoneWhenTheTroubleIsAlwaysThere)
{
    for (std::size_t suspects = 1; suspects <= kMost; ++suspects)
    {
        const auto course = follow(suspects, [](const auto&) { return true; });
        EXPECT_EQ(course.bisection.verdict(), Verdict::kNone) << suspects;
        EXPECT_LE(course.starts, mostStarts(suspects));
    }
}

TEST(Bisection, SaysThatSeveralAreNeededForEveryPair)
{
    for (std::size_t suspects = 2; suspects <= kMost; ++suspects)
        for (std::size_t one = 0; one < suspects; ++one)
            for (std::size_t other = one + 1; other < suspects; ++other)
            {
                const auto course = follow(suspects, [=](const auto& loaded)
                                           { return loaded.contains(one) && loaded.contains(other); });
                EXPECT_EQ(course.bisection.verdict(), Verdict::kTogether)
                    << one << " and " << other << " of " << suspects;
            }
}

TEST(Bisection, SaysThatSeveralAreNeededWhenItTakesAll)
{
    for (std::size_t suspects = 2; suspects <= kMost; ++suspects)
    {
        const auto course = follow(suspects, [=](const auto& loaded) { return loaded.size() == suspects; });
        EXPECT_EQ(course.bisection.verdict(), Verdict::kTogether) << suspects;
    }
}

TEST(Bisection, FindsOneOfTwoThatMakeTheTroubleEach)
{
    for (std::size_t suspects = 2; suspects <= kMost; ++suspects)
        for (std::size_t one = 0; one < suspects; ++one)
            for (std::size_t other = one + 1; other < suspects; ++other)
            {
                const auto course = follow(suspects, [=](const auto& loaded)
                                           { return loaded.contains(one) || loaded.contains(other); });
                EXPECT_EQ(course.bisection.verdict(), Verdict::kFound);
                EXPECT_TRUE(course.bisection.culprit() == one || course.bisection.culprit() == other);
            }
}

TEST(Bisection, LoadsHalfOfThoseThatAreStillSuspected)
{
    for (std::size_t suspects = 2; suspects <= kMost; ++suspects)
    {
        std::size_t loaded = 0;
        const Bisection bisection(suspects);
        for (std::size_t suspect = 0; suspect < suspects; ++suspect)
            loaded += bisection.isLoaded(suspect) ? 1 : 0;
        EXPECT_EQ(loaded, suspects / 2);
    }
}

TEST(Bisection, PassesOverAnswersAfterTheVerdict)
{
    const Bisection bisection(1, {true, false, false});
    EXPECT_EQ(bisection.verdict(), Verdict::kFound);
    EXPECT_EQ(bisection.stillSuspected(), 1U);
}
