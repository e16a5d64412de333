#include "bench/Judging.h"

#include <gmock/gmock.h>

#include <cmath>

namespace
{
using ::testing::DoubleEq;
using ::testing::ElementsAre;
using ::testing::IsEmpty;

// Runs whose ratio to those of a base of one second each is as given, and the base itself.
bench::SamplesByName samplesOf(const std::string& name, const std::vector<double>& seconds)
{
    return {{name, {seconds, {}}}, {"base", {std::vector<double>(seconds.size(), 1.0), {}}}};
}

bench::Ratio ratioOf(const std::string& name, double most)
{
    return {.what = name + " / base", .measured = name, .base = "base", .most = most};
}

std::vector<std::set<std::string>> namesRunAgain(const std::vector<bench::Ratio>& ratios,
                                                 const bench::SamplesByName& samples)
{
    std::vector<std::set<std::string>> all;
    bench::runWhileInDoubt(ratios, samples,
                           [&](const std::set<std::string>& names) { all.push_back(names); });
    return all;
}

TEST(Median, IsTheValueInTheMiddleInWhateverOrderTheyCame)
{
    EXPECT_THAT(bench::median({9, 1, 4}), DoubleEq(4));
    EXPECT_THAT(bench::median({5}), DoubleEq(5));
}

TEST(Median, IsHalfWayBetweenBothInTheMiddleOfAnEvenNumber)
{
    EXPECT_THAT(bench::median({10, 1, 2, 4}), DoubleEq(3));
}

TEST(Median, IsNothingOfNone)
{
    EXPECT_THAT(bench::median({}), DoubleEq(0));
}

TEST(Wobble, IsHalfOfTheDistanceBetweenTheQuartiles)
{
    const bench::Measured measured = bench::measuredOf({100, 1, 3, 2, 4});
    EXPECT_THAT(measured.value, DoubleEq(3));
    EXPECT_THAT(measured.wobble, DoubleEq(1)); // 2 and 4; the one that took far longer widens nothing
}

TEST(Wobble, TakesQuartilesBetweenTwoValuesInProportion)
{
    EXPECT_THAT(bench::measuredOf({0, 1, 2, 3}).wobble, DoubleEq(0.75)); // 0.75 and 2.25
}

TEST(Wobble, IsNoneOfOneValue)
{
    EXPECT_THAT(bench::measuredOf({7}).wobble, DoubleEq(0));
    EXPECT_THAT(bench::measuredOf({}).wobble, DoubleEq(0));
}

TEST(MeasuredRatio, IsTheRatioOfTheMedians)
{
    const bench::SamplesByName samples = {{"ours", {{6, 100, 4}, {}}}, {"base", {{1, 2, 50}, {}}}};
    const bench::Ratio ratio = {.what = "", .measured = "ours", .base = "base"};
    EXPECT_THAT(bench::measuredRatio(ratio, samples, bench::kProcessorTime).value, DoubleEq(3));
}

TEST(MeasuredRatio, WobblesAsTheRatiosOfRunsInTheSamePlaceDo)
{
    // A machine that is slower for a while is slower for both.
    const bench::SamplesByName samples = {{"ours", {{2, 20, 6, 60, 4}, {}}},
                                          {"base", {{1, 10, 2, 20, 4}, {}}}};
    const bench::Ratio ratio = {.what = "", .measured = "ours", .base = "base"};
    // 2, 2, 3, 3, 1
    EXPECT_THAT(bench::measuredRatio(ratio, samples, bench::kProcessorTime).wobble, DoubleEq(0.5));
}

TEST(MeasuredRatio, DividesBothByTheirUnits)
{
    const bench::SamplesByName samples = {{"many", {{30, 50, 40}, {}}}, {"few", {{1, 1, 1}, {}}}};
    const bench::Ratio ratio = {
        .what = "", .measured = "many", .base = "few", .measuredUnits = 100, .baseUnits = 5};
    const bench::Measured measured = bench::measuredRatio(ratio, samples, bench::kProcessorTime);
    EXPECT_THAT(measured.value, DoubleEq(2));
    EXPECT_THAT(measured.wobble, DoubleEq(0.25)); // of 35 and 45 times
}

TEST(MeasuredRatio, GivesEachRunOfTheShorterRowSeveralPartners)
{
    const bench::SamplesByName samples = {{"ours", {{2, 4, 30, 50}, {}}}, {"base", {{1, 10}, {}}}};
    bench::Ratio ratio = {.what = "", .measured = "ours", .base = "base"};
    // 2, 4, 3, 5
    EXPECT_THAT(bench::measuredRatio(ratio, samples, bench::kProcessorTime).wobble, DoubleEq(0.75));
    std::swap(ratio.measured, ratio.base);
    // 1/2, 1/4, 1/3, 1/5
    EXPECT_THAT(
        bench::measuredRatio(ratio, samples, bench::kProcessorTime).wobble,
        testing::DoubleNear(
            ((1.0 / 3 + (1.0 / 2 - 1.0 / 3) / 4) - (1.0 / 5 + (1.0 / 4 - 1.0 / 5) * 3 / 4)) / 2, 1e-12));
}

TEST(MeasuredRatio, IsByInstructionsWhenTheseAreAskedFor)
{
    const bench::SamplesByName samples = {{"ours", {{10}, {300, 330}}}, {"base", {{1}, {100, 100}}}};
    const bench::Ratio ratio = {.what = "", .measured = "ours", .base = "base"};
    const bench::Measured measured = bench::measuredRatio(ratio, samples, bench::kInstructions);
    EXPECT_THAT(measured.value, DoubleEq(3.15));
    EXPECT_THAT(measured.wobble, testing::DoubleNear(0.075, 1e-12));
    EXPECT_THAT(bench::measuredRatio(ratio, samples, bench::kProcessorTime).value, DoubleEq(10));
}

TEST(MeasuredRatio, IsNothingWhenEitherWasNotMeasured)
{
    const bench::Ratio ratio = {.what = "", .measured = "ours", .base = "base"};
    const bench::SamplesByName samples[] = {{},
                                            {{"ours", {{1}, {}}}},
                                            {{"base", {{1}, {}}}},
                                            {{"ours", {{1}, {}}}, {"base", {{0}, {}}}},
                                            {{"ours", {{}, {}}}, {"base", {{1}, {}}}}};
    for (const bench::SamplesByName& some : samples)
    {
        const bench::Measured measured = bench::measuredRatio(ratio, some, bench::kProcessorTime);
        EXPECT_THAT(measured.value, DoubleEq(0));
        EXPECT_THAT(measured.wobble, DoubleEq(0));
    }
}

TEST(Limit, IsMissedAboveItAlone)
{
    EXPECT_FALSE(bench::isMissed({1.49, 0}, 1.5));
    EXPECT_FALSE(bench::isMissed({1.5, 0}, 1.5));
    EXPECT_TRUE(bench::isMissed({1.51, 0}, 1.5));
}

TEST(Limit, IsMissedByWhatWasNotMeasured)
{
    EXPECT_TRUE(bench::isMissed({}, 1.5));
    EXPECT_TRUE(bench::isMissed({std::nan(""), 0}, 1.5));
}

TEST(Limit, IsNoneWhenItIsZero)
{
    EXPECT_FALSE(bench::isMissed({100, 0}, 0));
    EXPECT_FALSE(bench::isMissed({}, 0));
    EXPECT_FALSE(bench::isInDoubt({0.1, 0.2}, 0));
}

TEST(Limit, IsInDoubtNoFurtherAwayThanTheValueWobbles)
{
    EXPECT_TRUE(bench::isInDoubt({1.25, 0.25}, 1.5));
    EXPECT_TRUE(bench::isInDoubt({1.75, 0.25}, 1.5));
    EXPECT_FALSE(bench::isInDoubt({1.25, 0.125}, 1.5));
    EXPECT_FALSE(bench::isInDoubt({1.75, 0.125}, 1.5));
}

TEST(Limit, IsInNoDoubtWhenNothingWasMeasured)
{
    EXPECT_FALSE(bench::isInDoubt({0, 5}, 1.5));
}

TEST(RunAgain, AreBothBenchmarksOfARatioInDoubtAndNoOthers)
{
    bench::SamplesByName samples = samplesOf("close", {1, 1.5, 2});
    samples["far"] = {{1, 1, 1}, {}};
    EXPECT_THAT(namesRunAgain({ratioOf("far", 1.5), ratioOf("close", 1.5)}, samples).front(),
                ElementsAre("base", "close"));
}

TEST(RunAgain, IsNothingWhenAllIsSure)
{
    EXPECT_THAT(namesRunAgain({ratioOf("far", 1.5)}, samplesOf("far", {1, 1, 1})), IsEmpty());
    EXPECT_THAT(namesRunAgain({ratioOf("far", 1.5)}, samplesOf("far", {3, 3, 3})), IsEmpty());
}

TEST(RunAgain, EndsWhenItIsStillInDoubtAfterThreeTimes)
{
    const auto runs = namesRunAgain({ratioOf("close", 1.5)}, samplesOf("close", {1, 1.5, 2}));
    EXPECT_EQ(runs.size(), 3U);
}

TEST(RunAgain, EndsAsSoonAsWhatWasAddedLeavesNoDoubt)
{
    bench::SamplesByName samples = samplesOf("close", {1, 1.5, 2});
    int runs = 0;
    bench::runWhileInDoubt({ratioOf("close", 1.5)}, samples,
                           [&](const std::set<std::string>&)
                           {
                               ++runs;
                               for (int i = 0; i < 9; ++i)
                                   samples["close"].seconds.push_back(1);
                           });
    EXPECT_EQ(runs, 1);
    EXPECT_THAT(bench::measuredRatio(ratioOf("close", 1.5), samples, bench::kProcessorTime).value,
                DoubleEq(1));
}

TEST(RunAgain, GoesByInstructionsForARatioThatIsJudgedByThem)
{
    bench::Ratio ratio = ratioOf("close", 1.5);
    ratio.by = bench::kInstructions;
    bench::SamplesByName samples = samplesOf("close", {1, 1.5, 2});
    samples["close"].instructions = {100, 101};
    samples["base"].instructions = {100, 100};
    EXPECT_THAT(namesRunAgain({ratio}, samples), IsEmpty());
    samples["close"].instructions = {149, 151};
    EXPECT_THAT(namesRunAgain({ratio}, samples).front(), ElementsAre("base", "close"));
}
} // namespace
