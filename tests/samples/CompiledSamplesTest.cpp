#include <gmock/gmock.h>

#include <algorithm>

#include <tessel/tsrx.h>

#include "samples/moon/MoonTexts.h"
#include "tests/support/RecordingHost.h"

extern "C"
{
    int moonEntryPoint(unsigned message, void* application);
    int primesEntryPoint(unsigned message, void* application);
    int gearsEntryPoint(unsigned message, void* application);
}

using testing::ElementsAre;
using testing::EndsWith;
using testing::HasSubstr;
using testing::SizeIs;

namespace
{
struct Sample
{
    TsRxEntryPoint entryPoint;
    std::vector<std::wstring> commands;
};

const std::vector<Sample> kSamples = {
    {moonEntryPoint, {L"MOONPHASE", L"LOCKMOON", L"UNLOCKMOON"}},
    {primesEntryPoint, {L"PRIMES"}},
    {gearsEntryPoint, {L"GEARS"}},
};

const RecordingResources::Texts kMoonTexts = {
    {moon::kFirstPhaseName, L"phase 0"},
    {moon::kFirstPhaseName + 1, L"phase 1"},
    {moon::kFirstPhaseName + 2, L"phase 2"},
    {moon::kFirstPhaseName + 3, L"phase 3"},
    {moon::kFirstPhaseName + 4, L"phase 4"},
    {moon::kFirstPhaseName + 5, L"phase 5"},
    {moon::kFirstPhaseName + 6, L"phase 6"},
    {moon::kFirstPhaseName + 7, L"phase 7"},
    {moon::kGreeting, L"greeting"},
    {moon::kTonight, L"%s, %d %%, %d days"},
    {moon::kLocked, L"locked"},
    {moon::kUnlocked, L"unlocked"},
    {moon::kShowsTheMoon, L"shows"},
    {moon::kLocksTheModule, L"locks"},
    {moon::kUnlocksTheModule, L"unlocks"},
};

class CompiledSamples : public testing::Test
{
protected:
    void SetUp() override
    {
        recordingHost().reset();
        recordingHost().resources.addModule(L"MoonRes.dll", kMoonTexts);
    }

    int load(TsRxEntryPoint entryPoint) { return entryPoint(TSRX_MSG_LOAD, this); }
    int unload(TsRxEntryPoint entryPoint) { return entryPoint(TSRX_MSG_UNLOAD, this); }

    std::vector<std::wstring> linesOf(const std::wstring& command)
    {
        recordingHost().output.printed.clear();
        EXPECT_TRUE(recordingHost().commands.type(command));
        return recordingHost().output.lines();
    }
};

TEST_F(CompiledSamples, GreetInOneLineAndOfferTheirCommands)
{
    for (const Sample& sample : kSamples)
    {
        recordingHost().output.printed.clear();
        ASSERT_EQ(load(sample.entryPoint), TSRX_RET_OK);
        EXPECT_THAT(recordingHost().output.lines(), SizeIs(1));
        for (const std::wstring& command : sample.commands)
            EXPECT_TRUE(recordingHost().commands.has(command));
        EXPECT_EQ(unload(sample.entryPoint), TSRX_RET_OK);
    }
}

TEST_F(CompiledSamples, DescribeTheirCommands)
{
    for (const Sample& sample : kSamples)
        ASSERT_EQ(load(sample.entryPoint), TSRX_RET_OK);
    const auto& commands = recordingHost().commands;
    EXPECT_EQ(commands.descriptionOf(L"MOONPHASE"), L"shows");
    EXPECT_EQ(commands.descriptionOf(L"LOCKMOON"), L"locks");
    EXPECT_EQ(commands.descriptionOf(L"UNLOCKMOON"), L"unlocks");
    EXPECT_EQ(commands.descriptionOf(L"PRIMES"), L"Shows the primes on a spiral");
    EXPECT_EQ(commands.descriptionOf(L"GEARS"), L"Shows the table of a speed reducer");
    for (const Sample& sample : kSamples)
        unload(sample.entryPoint);
}

TEST_F(CompiledSamples, TakeTheirCommandsAlongAndCanBeLoadedAgain)
{
    for (const Sample& sample : kSamples)
    {
        for (int round = 0; round < 2; ++round)
        {
            ASSERT_EQ(load(sample.entryPoint), TSRX_RET_OK);
            ASSERT_EQ(unload(sample.entryPoint), TSRX_RET_OK);
        }
        for (const std::wstring& command : sample.commands)
            EXPECT_FALSE(recordingHost().commands.has(command));
    }
}

TEST_F(CompiledSamples, DoNothingOnAMessageThatTheyDoNotKnow)
{
    for (const Sample& sample : kSamples)
        EXPECT_EQ(sample.entryPoint(7, this), TSRX_RET_OK);
    EXPECT_THAT(recordingHost().output.lines(), SizeIs(0));
    EXPECT_THAT(recordingHost().commands.added, SizeIs(0));
}

TEST_F(CompiledSamples, FailToLoadWhenTheirCommandIsRefused)
{
    recordingHost().commands.answerToAdd = TSED_COMMAND_DUPLICATE;
    for (const Sample& sample : kSamples)
        EXPECT_EQ(load(sample.entryPoint), TSRX_RET_ERROR);
    EXPECT_THAT(recordingHost().output.lines(), SizeIs(0));
}

TEST_F(CompiledSamples, ShowTheMoonAndWhatItIsCalled)
{
    ASSERT_EQ(load(moonEntryPoint), TSRX_RET_OK);
    const auto lines = linesOf(L"MOONPHASE");
    ASSERT_THAT(lines, SizeIs(19)); // the disc, a blank line, what it is
    EXPECT_THAT(lines.back(), HasSubstr(L"phase "));
    EXPECT_THAT(lines.back(), EndsWith(L" days"));
    EXPECT_EQ(unload(moonEntryPoint), TSRX_RET_OK);
}

TEST_F(CompiledSamples, GiveTheTextsOfTheMoonBackOnceForEveryLoad)
{
    ASSERT_EQ(load(moonEntryPoint), TSRX_RET_OK);
    EXPECT_THAT(recordingHost().resources.freed, SizeIs(0));
    EXPECT_EQ(unload(moonEntryPoint), TSRX_RET_OK);
    EXPECT_THAT(recordingHost().resources.freed, SizeIs(1));
    EXPECT_THAT(recordingHost().resources.madeCurrent, SizeIs(0)); // nobody else's texts are touched
}

TEST_F(CompiledSamples, DoNotLoadTheMoonWithoutItsTexts)
{
    recordingHost().resources.removeModule(L"MoonRes.dll");
    EXPECT_EQ(load(moonEntryPoint), TSRX_RET_ERROR);
    EXPECT_FALSE(recordingHost().commands.has(L"MOONPHASE"));
}

TEST_F(CompiledSamples, LockTheMoonUntilItIsUnlocked)
{
    constexpr const wchar_t* kMoon = L"/samples/moon.bundle";
    RecordingLinker& linker = recordingHost().linker;
    linker.setEntryPoint(kMoon, moonEntryPoint);
    ASSERT_TRUE(linker.loadModule(kMoon, true, true));
    EXPECT_FALSE(linker.isModuleLocked(kMoon));
    EXPECT_THAT(linesOf(L"LOCKMOON"), ElementsAre(L"locked"));
    EXPECT_TRUE(linker.isModuleLocked(kMoon));
    EXPECT_THAT(linesOf(L"UNLOCKMOON"), ElementsAre(L"unlocked"));
    EXPECT_FALSE(linker.isModuleLocked(kMoon));
    EXPECT_TRUE(linker.unloadModule(kMoon, true));
}

TEST_F(CompiledSamples, MarkThePrimesAroundTheMiddleOfTheSpiral)
{
    ASSERT_EQ(load(primesEntryPoint), TSRX_RET_OK);
    const auto lines = linesOf(L"PRIMES");
    ASSERT_THAT(lines, SizeIs(32));
    std::vector<std::wstring> middle;
    for (std::size_t row = 13; row <= 17; ++row)
        middle.push_back(lines[row].substr(26, 9));
    EXPECT_THAT(middle, ElementsAre(L"*       *", // 17 16 15 14 13
                                    L"  *   *  ", // 18  5  4  3 12
                                    L"*     * *", // 19  6  1  2 11
                                    L"  *",       // 20  7  8  9 10
                                    L"    *"));   // 21 22 23 24 25
    EXPECT_EQ(unload(primesEntryPoint), TSRX_RET_OK);
}

TEST_F(CompiledSamples, MarkAsManyPrimesAsThereAre)
{
    constexpr std::ptrdiff_t kPrimesUpTo961 = 162;
    ASSERT_EQ(load(primesEntryPoint), TSRX_RET_OK);
    linesOf(L"PRIMES");
    const std::wstring& printed = recordingHost().output.printed;
    EXPECT_EQ(std::count(printed.begin(), printed.end(), L'*'), kPrimesUpTo961);
    EXPECT_THAT(printed, HasSubstr(L" 961,"));
    EXPECT_EQ(unload(primesEntryPoint), TSRX_RET_OK);
}

TEST_F(CompiledSamples, TabulateTheGears)
{
    ASSERT_EQ(load(gearsEntryPoint), TSRX_RET_OK);
    EXPECT_THAT(linesOf(L"GEARS"),
                ElementsAre(L"  pair  tooth size   driving    driven    ratio axis distance         speed",
                            L"     1       1.5 mm        17        68    4.000       63.8 mm     362.5/min",
                            L"     2       2.0 mm        19        57    3.000       76.0 mm     120.8/min",
                            L"     3       3.0 mm        21        52    2.476      109.5 mm      48.8/min",
                            L"The motor turns at 1450/min, the last shaft 29.71 times slower."));
    EXPECT_EQ(unload(gearsEntryPoint), TSRX_RET_OK);
}
} // namespace
