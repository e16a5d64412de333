#include "host/applications/DemandLoading.h"

#include <tessel/tsappinfo.h>

#include "host/applications/ApplicationRecords.h"
#include "host/registry/Registry.h"
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

    tessel::Registry mRegistry{mFolder / "registry.db"};
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
    mDemand.loadAtStart();
    EXPECT_EQ(output(), "Good.omp: message 1\nGood.zmb: message 1\n");
}

TEST_F(Demand, GoesOnAfterARecordWhoseFileIsMissing)
{
    record(L"Gone", mFolder / "gone.zmb", 2);
    record(L"There", fixture("Good.zmb"), 2);
    mDemand.loadAtStart();
    EXPECT_EQ(output(),
              notLoaded(mFolder / "gone.zmb", "No such file or directory") + "Good.zmb: message 1\n");
}

TEST_F(Demand, LoadsPlugInsWithoutARecordInTheOrderOfTheirNames)
{
    fixture("Good.zmb", "PlugIns/b.zmb");
    fixture("Good.omp", "PlugIns/c.OMP");
    fixture("Good.bundle", "PlugIns/Good.bundle");
    mFolder.write("PlugIns/notes.txt", "no application");
    mDemand.loadAtStart();
    EXPECT_EQ(output(), "Good.bundle: message 1\nb.zmb: message 1\nc.OMP: message 1\n");
}

TEST_F(Demand, LeavesPlugInsWithARecordToTheirRecord)
{
    const auto onCommand = fixture("Good.zmb", "PlugIns/OnCommand.zmb");
    fixture("Good.omp", "PlugIns/New.omp");
    std::filesystem::create_symlink(mFolder / "PlugIns", mFolder / "link");
    record(L"OnCommand", mFolder / "link" / "OnCommand.zmb", 4);
    mDemand.loadAtStart();
    EXPECT_EQ(output(), "New.omp: message 1\n");
}

TEST_F(Demand, StartsWithoutAPlugInsFolder)
{
    mDemand.loadAtStart();
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
