#include "modrig/loader/LoadBatch.h"

#include "modrig/lists/Globals.h"
#include "modrig/messages/MessageIds.h"
#include "tests/support/ModuleTest.h"

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class LoadingABatch : public ModuleTest
{
protected:
    // Answers what `RunLoadBatch` answers; indexes of the callbacks are kept.
    unsigned Load(std::initializer_list<const wchar_t*> paths)
    {
        for (const wchar_t* path : paths)
            mBatch.files.push_back({CStdStr(path), false});
        mBatch.succeeded = [this](std::size_t index)
        {
            mSucceeded.push_back(index);
        };
        mBatch.added = [this](std::size_t index)
        {
            mAdded.push_back(index);
        };
        return RunLoadBatch(mBatch);
    }

    LoadBatch mBatch;
    std::vector<std::size_t> mSucceeded;
    std::vector<std::size_t> mAdded;
};
} // namespace

TEST_F(LoadingABatch, NamesTheOnlyFileLoaded)
{
    EXPECT_EQ(1u, Load({L"/a/tool.zmb"}));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneLoaded, L"tool.zmb")));
}

TEST_F(LoadingABatch, CountsSeveralFiles)
{
    EXPECT_EQ(2u, Load({L"/a/one.zmb", L"/a/two.zmb"}));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyLoaded, L"2")));
    EXPECT_THAT(mAdded, ElementsAre(0, 1));
}

TEST_F(LoadingABatch, SaysThatTheOnlyFileWasLoadedAlready)
{
    Fill(gLoadedAppList, {L"/a/tool.zmb"});
    EXPECT_EQ(0u, Load({L"/a/tool.zmb"}));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kAlreadyLoaded, L"tool.zmb")));
    EXPECT_THAT(mSucceeded, ElementsAre(0));
    EXPECT_THAT(mAdded, IsEmpty());
}

TEST_F(LoadingABatch, CountsFilesLoadedAlreadyAmongTheProcessedOnes)
{
    Fill(gLoadedAppList, {L"/a/one.zmb"});
    EXPECT_EQ(1u, Load({L"/a/one.zmb", L"/a/two.zmb"}));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyLoaded, L"2")));
    EXPECT_THAT(mSucceeded, ElementsAre(0, 1));
    EXPECT_THAT(mAdded, ElementsAre(1));
}

TEST_F(LoadingABatch, StopsAtTheFirstFailureWithoutASummary)
{
    host().linker.refuseToLoad(L"/a/two.zmb");
    EXPECT_EQ(0u, Load({L"/a/one.zmb", L"/a/two.zmb", L"/a/three.zmb"}));
    EXPECT_THAT(mAdded, ElementsAre(0));
    EXPECT_FALSE(host().linker.isLoaded(L"/a/three.zmb"));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kLoadFailed, L"/a/two.zmb")));
    EXPECT_THAT(recordingDialog().messages, IsEmpty());
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(L"/a/one.zmb"));
}

TEST_F(LoadingABatch, PassesOverTheHostsFolderWithoutCountingIt)
{
    mBatch.files.push_back({CStdStr(L"/host/Tessel.app"), true});
    EXPECT_EQ(1u, Load({L"/a/tool.zmb"}));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneLoaded, L"tool.zmb")));
    EXPECT_THAT(boxes(), IsEmpty());
    EXPECT_THAT(mAdded, ElementsAre(1));
}

TEST_F(LoadingABatch, SaysNothingWhenNothingWasProcessed)
{
    mBatch.files.push_back({CStdStr(L"/host/Tessel.app"), true});
    EXPECT_EQ(0u, Load({}));
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(LoadingABatch, DoesNothingWithoutFiles)
{
    EXPECT_EQ(0u, Load({}));
    EXPECT_THAT(host().journal.entries(), IsEmpty());
}

TEST_F(LoadingABatch, RecordsFilesInTheHistoryOnlyWhenAskedTo)
{
    Load({L"/a/one.zmb"});
    EXPECT_TRUE(gHistoryList.IsEmpty());
    mBatch.saveHistory = true;
    Load({L"/a/two.zmb"});
    EXPECT_THAT(Texts(gHistoryList), ElementsAre(L"/a/two.zmb"));
}

TEST_F(LoadingABatch, CallsAFileLoadedBeforeItTriesTheNext)
{
    host().linker.setEntryPoint(L"/a/two.zmb",
                                [this](unsigned, void*)
                                {
                                    EXPECT_THAT(mAdded, ElementsAre(0));
                                    return TSRX_RET_OK;
                                });
    Load({L"/a/one.zmb", L"/a/two.zmb"});
    EXPECT_THAT(mAdded, ElementsAre(0, 1));
}

TEST_F(LoadingABatch, EndsBetweenTwoFilesWhenItIsStopped)
{
    std::vector<std::size_t> asked;
    mBatch.isStopped = [&](std::size_t done)
    {
        asked.push_back(done);
        return done == 2;
    };
    EXPECT_EQ(2u, Load({L"/a/one.zmb", L"/a/two.zmb", L"/a/three.zmb"}));
    EXPECT_THAT(asked, ElementsAre(1, 2));
    EXPECT_THAT(mAdded, ElementsAre(0, 1));
    EXPECT_FALSE(host().linker.isLoaded(L"/a/three.zmb"));
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(LoadingABatch, IsNotStoppedAfterItsLastFile)
{
    mBatch.isStopped = [](std::size_t done)
    {
        return done == 2;
    };
    EXPECT_EQ(2u, Load({L"/a/one.zmb", L"/a/two.zmb"}));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyLoaded, L"2")));
}
