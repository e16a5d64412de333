#include "host/applications/DemandLoading.h"

#include <tessel/tsappinfo.h>

#include "host/applications/ApplicationRecords.h"
#include "host/registry/LayeredRegistry.h"
#include "tests/host/support/HostWithModules.h"

using tessel::toWide;

class Demand : public HostWithModules
{
protected:
    // The record that an application writes about itself, while it is called.
    void record(const std::wstring& name, const std::filesystem::path& module, unsigned reasons)
    {
        const std::wstring path = toWide(module.native());
        const tessel::CallingApplication::Scope calling(mCalls, path);
        TesselAppInfo info;
        info.setAppName(name.c_str());
        info.setModuleName(path.c_str());
        info.setLoadReason(reasons);
        ASSERT_EQ(info.writeToRegistry(false, true), TSRX_APPINFO_OK);
    }

    void takeRecordsAlong()
    {
        for (const auto& sentence : mDemand.takeRecordsAlong())
            mCommandLine.say(sentence);
    }

    tessel::Registry mOwnRegistry{mFolder / "registry.db"};
    tessel::LayeredRegistry mRegistry{mOwnRegistry};
    tessel::Owned<tessel::ApplicationRecords> mRecords{mRegistry, mCommands, mCalls,
                                                       L"Software\\Tessel\\R21"};
    tessel::DemandLoading mDemand{mFolder / "PlugIns", *mRecords, mLinker, mAdmission,
                                  [this](const std::wstring& path)
                                  {
                                      return mCommandLine.tell(mLinker.load(path, tessel::kResolveNow));
                                  }};
};

TEST_F(Demand, LoadsAtTheStartWhatItsRecordsAskFor)
{
    record(L"Second", fixture("Good.omp"), 6);
    record(L"First", fixture("Good.zmb"), 2);
    record(L"OnCommandOnly", fixture("Command.zmb"), 4);
    mDemand.loadAtStart(false);
    EXPECT_EQ(output(), "Good.omp: message 1\nGood.zmb: message 1\n");
}

TEST_F(Demand, LoadsWithNewsWhatWaitsForACommandInThePlugInsFolderAlone)
{
    record(L"Plug-in", fixture("Good.zmb", "PlugIns/Good.zmb"), 4);
    record(L"Elsewhere", fixture("Good.omp"), 4);
    record(L"Switched off", fixture("Command.zmb", "PlugIns/Command.zmb"), 0);
    tessel::ApplicationRecord shipped;
    shipped.name = L"Comes with Tessel";
    shipped.module = toWide(fixture("Good.omp", "PlugIns/Good.omp").native());
    shipped.loadReasons = 4;
    mRecords->add(shipped);
    mDemand.loadAtStart(true);
    EXPECT_EQ(output(), "Good.zmb: message 1\n");
}

TEST_F(Demand, GoesOnAfterARecordWhoseFileIsMissing)
{
    record(L"Gone", mFolder / "gone.zmb", 2);
    record(L"There", fixture("Good.zmb"), 2);
    mDemand.loadAtStart(false);
    EXPECT_EQ(output(),
              notLoaded(mFolder / "gone.zmb", "No such file or directory") + "Good.zmb: message 1\n");
}

TEST_F(Demand, TellsOnceThatTheFileOfARecordIsGone)
{
    const auto path = fixture("Good.zmb");
    record(L"Comes and goes", path, 2);
    const std::string gone = notLoaded(path, "No such file or directory");
    std::filesystem::rename(path, mFolder / "away.zmb");
    mDemand.loadAtStart(false);
    EXPECT_EQ(output(), gone);
    mDemand.loadAtStart(false);
    EXPECT_EQ(output(), "") << "told at the start before";
    std::filesystem::rename(mFolder / "away.zmb", path);
    mDemand.loadAtStart(false);
    EXPECT_EQ(output(), "Good.zmb: message 1\n");
    unload(path);
    std::filesystem::remove(path);
    output();
    mDemand.loadAtStart(false);
    EXPECT_EQ(output(), gone) << "it was there in between";
}

TEST_F(Demand, TakesARecordAlongToThePlugInsOfAHostThatWasMoved)
{
    const auto plugIn = fixture("Good.zmb", "PlugIns/Good.zmb");
    record(L"Good", mFolder / "before/PlugIns/Good.zmb", 6);
    takeRecordsAlong();
    mDemand.loadAtStart(false);
    EXPECT_EQ(output(), "The application \"Good\" is " + plugIn.native() + " now; " +
                            (mFolder / "before/PlugIns/Good.zmb").native() +
                            " is not there any more.\nGood.zmb: message 1\n");
    const auto now = mRecords->read(L"Good");
    ASSERT_TRUE(now);
    EXPECT_EQ(now->module, toWide(plugIn.native()));
    EXPECT_EQ(now->loadReasons, 6u);
    unload(plugIn);
    output();
    takeRecordsAlong();
    mDemand.loadAtStart(false);
    EXPECT_EQ(output(), "Good.zmb: message 1\n") << "told once";
}

TEST_F(Demand, TakesARecordAlongWhenItsCommandIsTyped)
{
    const auto before = fixture("Command.zmb");
    load(before);
    record(L"Commands", before, 4);
    unload(before);
    std::filesystem::create_directories(mFolder / "PlugIns");
    const auto plugIn = mFolder / "PlugIns/Command.zmb";
    std::filesystem::rename(before, plugIn);
    output();
    takeRecordsAlong();
    EXPECT_TRUE(mDemand.loadForCommand(L"PFAD"));
    EXPECT_EQ(output(), "The application \"Commands\" is " + plugIn.native() + " now; " + before.native() +
                            " is not there any more.\nCommand.zmb: message 1\n");
}

TEST_F(Demand, TakesOverTheRecordOfAPlugInOfAnotherCopyOfTheHostWithoutAWord)
{
    const auto own = fixture("Good.zmb", "PlugIns/Good.zmb");
    record(L"Good", fixture("Good.zmb", "other/PlugIns/Good.zmb"), 2);
    takeRecordsAlong();
    mDemand.loadAtStart(false);
    EXPECT_EQ(output(), "Good.zmb: message 1\n") << "one of the two";
    EXPECT_EQ(mRecords->read(L"Good")->module, toWide(own.native()));
    EXPECT_TRUE(mLinker.isModuleLoaded(own.wstring().c_str()));
}

TEST_F(Demand, LeavesARecordWhoseFileIsThereToThatFile)
{
    const auto elsewhere = fixture("Good.zmb");
    record(L"Good", elsewhere, 2);
    std::filesystem::create_directories(mFolder / "PlugIns");
    mFolder.write("PlugIns/Good.zmb", "no module");
    takeRecordsAlong();
    mDemand.loadAtStart(false);
    EXPECT_EQ(mRecords->read(L"Good")->module, toWide(elsewhere.native()));
    EXPECT_EQ(output(), "Good.zmb: message 1\n" +
                            notLoaded(mFolder / "PlugIns/Good.zmb", "it is not a shared library"));
}

TEST_F(Demand, LoadsPlugInsWithoutARecordInTheOrderOfTheirNames)
{
    fixture("Good.zmb", "PlugIns/b.zmb");
    fixture("Good.omp", "PlugIns/c.OMP");
    fixture("Good.bundle", "PlugIns/Good.bundle");
    mFolder.write("PlugIns/notes.txt", "no application");
    mDemand.loadAtStart(false);
    EXPECT_EQ(output(), "Good.bundle: message 1\nb.zmb: message 1\nc.OMP: message 1\n");
}

TEST_F(Demand, LeavesPlugInsWithARecordToTheirRecord)
{
    const auto onCommand = fixture("Good.zmb", "PlugIns/OnCommand.zmb");
    fixture("Good.omp", "PlugIns/New.omp");
    std::filesystem::create_symlink(mFolder / "PlugIns", mFolder / "link");
    record(L"OnCommand", mFolder / "link" / "OnCommand.zmb", 4);
    mDemand.loadAtStart(false);
    EXPECT_EQ(output(), "New.omp: message 1\n");
}

TEST_F(Demand, StartsWithoutAPlugInsFolder)
{
    mDemand.loadAtStart(false);
    EXPECT_EQ(output(), "");
}

TEST_F(Demand, LoadsTheApplicationThatHasTheCommand)
{
    const auto path = fixture("Command.zmb");
    load(path);
    record(L"Commands", path, 4);
    unload(path);
    output();
    tessel::CommandRunner runner(mCommands, mCommandLine, mCalls,
                                 [this](const std::wstring& name) { return mDemand.loadForCommand(name); });
    EXPECT_TRUE(runner.run(L"pfad"));
    EXPECT_EQ(output(), "Command.zmb: message 1\n" + path.native() + "\n");
    unload(path);
    output();
    EXPECT_TRUE(runner.run(L"_tellpath"));
    EXPECT_EQ(output(), "Command.zmb: message 1\n" + path.native() + "\n");
}

TEST_F(Demand, LoadsNothingForACommandWhoseApplicationIsLoadedOrDoesNotWantItOrIsUnknown)
{
    const auto path = fixture("Command.zmb");
    load(path);
    record(L"Commands", path, 4);
    output();
    EXPECT_FALSE(mDemand.loadForCommand(L"PFAD"));
    record(L"Commands", path, 2);
    unload(path);
    output();
    EXPECT_FALSE(mDemand.loadForCommand(L"PFAD"));
    EXPECT_FALSE(mDemand.loadForCommand(L"SOMETHING"));
    EXPECT_FALSE(mDemand.loadForCommand(L""));
    EXPECT_EQ(output(), "");
}

TEST_F(Demand, SaysWhyTheApplicationOfACommandCannotBeLoaded)
{
    const auto path = fixture("Command.zmb");
    load(path);
    record(L"Commands", path, 4);
    unload(path);
    std::filesystem::remove(path);
    output();
    EXPECT_FALSE(mDemand.loadForCommand(L"PFAD"));
    EXPECT_EQ(output(), notLoaded(path, "No such file or directory"));
}
