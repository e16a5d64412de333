#include "modrig/module/EntryPoint.h"

#include <tessel/tsappinfo.h>

#include "modrig/lists/Globals.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/messages/ResourceOverride.h"
#include "tests/support/ModuleTest.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
constexpr unsigned kLoadMessage = 1;
constexpr unsigned kUnloadMessage = 2;
constexpr const wchar_t* kModulePath = L"/host/PlugIns/Modrig.bundle";
constexpr const wchar_t* kRecordName = L"TesselModrig";

class EntryPoint : public ModuleTest
{
protected:
    void SetUp() override
    {
        ModuleTest::SetUp();
        host().resources.current = nullptr; // nobody has chosen one yet
        host().loadedModules.applicationName = kModulePath;
        mHandle = host().linker.handleOf(kModulePath);
    }

    int Send(unsigned message) { return tsrxEntryPoint(message, mHandle); }

    void StoreStartupSuite(const std::vector<std::wstring>& paths)
    {
        const std::wstring key = host().moduleKey() + L"\\Startup";
        host().registry.setValue(key, L"NumStartup", std::to_wstring(paths.size()));
        for (std::size_t i = 0; i < paths.size(); ++i)
            host().registry.setValue(key, std::to_wstring(i + 1) + L"Startup", paths[i]);
    }

    void* mHandle = nullptr;
};

// Looks, when the module is registered, which resource module it knows.
class LookingLinker : public RecordingLinker
{
public:
    bool registerApplication(void* application) override
    {
        resourcesSeen.push_back(recordingHost().resources.nameOf(hModrigRes));
        return RecordingLinker::registerApplication(application);
    }

    std::vector<std::wstring> resourcesSeen;
};

class UpdateRegistry : public ModuleTest
{
protected:
    static void Store(unsigned loadReason)
    {
        host().applicationRecords.set({kRecordName, L"/old/Modrig.bundle", L"old description", loadReason});
    }
    static const std::vector<RecordingApplicationRecords::Write>& writes()
    {
        return host().applicationRecords.writes;
    }
};
} // namespace

TEST_F(EntryPoint, LoadsTheTextsRegistersAndStartsInThisOrder)
{
    StoreStartupSuite({L"/apps/tool.zmb"});
    EXPECT_EQ(0, Send(kLoadMessage));
    EXPECT_THAT(WithoutBookkeeping(host().journal.entries()),
                ElementsAre(L"LoadLibrary(ModrigRes.dll)",                      //
                            L"at(DynamicLinker)",                               //
                            L"registerApplication()",                           //
                            L"AfxSetResourceHandle(ModrigRes.dll)",             //
                            L"tsedQmbLoaded()",                                 //
                            L"at(DynamicLinker)",                               //
                            L"loadModule(/apps/tool.zmb, true, true)",          //
                            L"loadStringFromWin32ResourceDLL(16)",              //
                            L"loadStringFromWin32ResourceDLL(17)",              //
                            L"loadStringFromWin32ResourceDLL(18)",              //
                            L"at(TESSEL_REGISTERED_COMMANDS)",                  //
                            L"addCommand(GROUP, GLOBALNAME, LOCALNAME, 0, -1)", //
                            L"readFromRegistry(TesselModrig)",                  //
                            L"tsedGetAppName()",                                //
                            L"writeToRegistry(TesselModrig, 6, false, true)",   //
                            L"AfxSetResourceHandle()"));
}

TEST_F(EntryPoint, ReadsTheStartupSuiteBeforeTheHistory)
{
    Send(kLoadMessage);
    std::vector<std::wstring> opened;
    for (const RecordingRegistry::Call& call : host().registry.calls())
        if (call.operation == RecordingRegistry::Operation::kOpen &&
            call.key.starts_with(host().moduleKey() + L"\\"))
            opened.push_back(call.key.substr(host().moduleKey().size() + 1));
    EXPECT_THAT(opened, ElementsAre(L"Startup", L"History"));
}

TEST_F(EntryPoint, HasReadTheHistoryBeforeItRegistersTheCommand)
{
    std::vector<bool> registered;
    host().registry.failWhen(
        [&registered](const RecordingRegistry::Call& call)
        {
            if (call.key == host().moduleKey() + L"\\History")
                registered.push_back(host().commands.has(L"LOCALNAME"));
            return ERROR_SUCCESS;
        });
    Send(kLoadMessage);
    EXPECT_THAT(registered, testing::Contains(false));
    EXPECT_THAT(registered, testing::Not(testing::Contains(true)));
    EXPECT_TRUE(host().commands.has(L"LOCALNAME"));
}

TEST_F(EntryPoint, KnowsItsResourceModuleWhenItTellsTheLinker)
{
    LookingLinker linker;
    host().services.set(TSRX_DYNAMIC_LINKER, &linker);
    Send(kLoadMessage);
    EXPECT_THAT(linker.resourcesSeen, ElementsAre(kResourceModuleName));
}

TEST_F(EntryPoint, ReadsBothListsFromTheRegistry)
{
    StoreStartupSuite({L"/apps/a.lsp", L"/apps/b.zmb"});
    host().registry.setValue(host().moduleKey() + L"\\History", L"NumHistory", L"1");
    host().registry.setValue(host().moduleKey() + L"\\History", L"1History", L"/apps/c.lsp");
    Send(kLoadMessage);
    EXPECT_THAT(Texts(gStartupList), ElementsAre(L"/apps/a.lsp", L"/apps/b.zmb"));
    EXPECT_THAT(Texts(gHistoryList), ElementsAre(L"/apps/c.lsp"));
}

TEST_F(EntryPoint, AnswersAnErrorAndDoesNothingElseWithoutItsTexts)
{
    StoreStartupSuite({L"/apps/tool.zmb"});
    host().resources.removeModule(kResourceModuleName);
    EXPECT_EQ(3, Send(kLoadMessage));
    EXPECT_THAT(host().journal.entries(), ElementsAre(L"LoadLibrary(ModrigRes.dll)"));
    EXPECT_TRUE(gStartupList.IsEmpty());
    EXPECT_THAT(host().commands.added, IsEmpty());
    EXPECT_EQ(nullptr, hModrigRes);
}

TEST_F(EntryPoint, AnswersAnErrorAndDoesNothingWhenItIsLoadedASecondTime)
{
    EXPECT_EQ(0, Send(kLoadMessage));
    StoreStartupSuite({L"/apps/tool.zmb"});
    host().journal.clear();
    EXPECT_EQ(3, Send(kLoadMessage));
    EXPECT_THAT(host().journal.entries(), IsEmpty());
    EXPECT_TRUE(gStartupList.IsEmpty());
    EXPECT_EQ(1u, host().commands.added.size());
}

TEST_F(EntryPoint, KeepsTheStaleHandleWhenItAnswersAnError)
{
    Send(kLoadMessage);
    const HMODULE before = hModrigRes;
    EXPECT_EQ(3, Send(kLoadMessage));
    EXPECT_EQ(before, hModrigRes);
    Send(kUnloadMessage);
    host().resources.removeModule(kResourceModuleName);
    EXPECT_EQ(3, Send(kLoadMessage));
    EXPECT_NE(nullptr, before);
    EXPECT_EQ(before, hModrigRes);
}

TEST_F(EntryPoint, LoadsAgainAfterAnUnload)
{
    EXPECT_EQ(0, Send(kLoadMessage));
    EXPECT_EQ(0, Send(kUnloadMessage));
    StoreStartupSuite({L"/apps/tool.zmb"});
    EXPECT_EQ(0, Send(kLoadMessage)) << "a command that is there already is no failure";
    EXPECT_THAT(Texts(gStartupList), ElementsAre(L"/apps/tool.zmb"));
    EXPECT_EQ(CTemporaryResourceOverride::m_hInstanceDefault, hModrigRes);
}

TEST_F(EntryPoint, HandsTheLinkerTheHandleThatCameWithTheMessage)
{
    Send(kLoadMessage);
    EXPECT_THAT(host().linker.registeredHandles, ElementsAre(mHandle));
}

TEST_F(EntryPoint, GoesOnWhenTheServicesAreMissingOrOfAnotherClass)
{
    host().services.set(TSRX_DYNAMIC_LINKER, &host().commands);
    host().services.miss(TSED_REGISTERED_COMMANDS);
    EXPECT_EQ(0, Send(kLoadMessage));
    EXPECT_THAT(host().linker.registeredHandles, IsEmpty());
    EXPECT_THAT(host().commands.added, IsEmpty());
    EXPECT_THAT(host().applicationRecords.reads, ElementsAre(kRecordName));
}

TEST_F(EntryPoint, KeepsTheResourceModuleForTheModulesOwnUse)
{
    Send(kLoadMessage);
    EXPECT_EQ(kResourceModuleName, host().resources.nameOf(hModrigRes));
    EXPECT_EQ(CTemporaryResourceOverride::m_hInstanceDefault, hModrigRes);
}

TEST_F(EntryPoint, ReleasesOnlyTheResourceModuleOnUnload)
{
    Send(kLoadMessage);
    Fill(gHistoryList, {L"/apps/new.lsp"});
    const HMODULE before = hModrigRes;
    host().journal.clear();
    EXPECT_EQ(0, Send(kUnloadMessage));
    EXPECT_THAT(host().journal.entries(), ElementsAre(L"FreeLibrary(ModrigRes.dll)"))
        << "no list is written and no command is removed";
    EXPECT_EQ(nullptr, CTemporaryResourceOverride::m_hInstanceDefault);
    EXPECT_EQ(before, hModrigRes) << "the copy is stale and stays";
    EXPECT_TRUE(host().commands.has(L"LOCALNAME"));
    EXPECT_THAT(Texts(gHistoryList), ElementsAre(L"/apps/new.lsp"));
}

TEST_F(EntryPoint, HasNothingToFreeWhenUnloadedBeforeALoadOrTwice)
{
    EXPECT_EQ(0, Send(kUnloadMessage));
    EXPECT_THAT(host().journal.entries(), IsEmpty());
    Send(kLoadMessage);
    EXPECT_EQ(0, Send(kUnloadMessage));
    EXPECT_EQ(0, Send(kUnloadMessage));
    EXPECT_EQ(1u, host().resources.freed.size());
}

TEST_F(EntryPoint, IgnoresEveryOtherMessage)
{
    for (const unsigned message : {0u, 3u, 7u, 0xFFFFFFFFu})
        EXPECT_EQ(0, Send(message));
    EXPECT_THAT(host().journal.entries(), IsEmpty());
}

TEST_F(EntryPoint, MakesItsTextsCurrentDuringStartUpOnly)
{
    host().resources.addModule(L"other.dll", {});
    const HMODULE other = host().resources.load(L"other.dll");
    host().resources.current = other;
    StoreStartupSuite({L"/apps/tool.zmb"});
    HMODULE during = nullptr;
    host().linker.setEntryPoint(L"/apps/tool.zmb",
                                [&during](unsigned, void*)
                                {
                                    during = host().resources.current;
                                    return TSRX_RET_OK;
                                });
    Send(kLoadMessage);
    EXPECT_EQ(hModrigRes, during);
    EXPECT_EQ(other, host().resources.current);
}

TEST_F(EntryPoint, AddsTheCommandWithItsNineArguments)
{
    Send(kLoadMessage);
    ASSERT_EQ(1u, host().commands.added.size());
    const TsEdCommand& command = host().commands.added.front();
    EXPECT_EQ(L"GROUP", command.group);
    EXPECT_EQ(L"GLOBALNAME", command.globalName);
    EXPECT_EQ(L"LOCALNAME", command.localName);
    EXPECT_EQ(0, command.flags);
    EXPECT_EQ(&ModrigUtils::ModrigCreate, command.handler);
    EXPECT_EQ(nullptr, command.uiContext);
    EXPECT_EQ(-1, command.functionCode);
    EXPECT_EQ(nullptr, command.resources);
    EXPECT_FALSE(command.hasResult);
}

TEST_F(EntryPoint, TakesTheCommandsNamesFromItsOwnModuleWhateverIsCurrent)
{
    host().resources.addModule(L"own.dll", {{ModrigMessages::kCommandGroup, L"OWN_GROUP"},
                                            {ModrigMessages::kCommandGlobalName, L"OWN_GLOBAL"},
                                            {ModrigMessages::kCommandLocalName, L"OWN"}});
    hModrigRes = host().resources.load(L"own.dll");
    CTemporaryResourceOverride::m_hInstanceDefault = host().resources.load(kResourceModuleName);
    initApp();
    ASSERT_EQ(1u, host().commands.added.size());
    EXPECT_EQ(L"OWN_GROUP", host().commands.added.front().group);
    EXPECT_EQ(L"OWN_GLOBAL", host().commands.added.front().globalName);
    EXPECT_EQ(L"OWN", host().commands.added.front().localName);
}

TEST_F(EntryPoint, AddsNoCommandSilentlyWhenOneOfItsNamesIsMissing)
{
    for (const unsigned missing : {ModrigMessages::kCommandGroup, ModrigMessages::kCommandGlobalName,
                                   ModrigMessages::kCommandLocalName})
    {
        SetUp();
        StoreStartupSuite({L"/apps/tool.zmb"});
        host().resources.removeText(kResourceModuleName, missing);
        EXPECT_EQ(0, Send(kLoadMessage));
        EXPECT_THAT(host().commands.added, IsEmpty());
        EXPECT_EQ(missing - ModrigMessages::kCommandGroup + 1,
                  host().journal.count(L"loadStringFromWin32ResourceDLL"))
            << "the first missing text ends the chain";
        EXPECT_THAT(host().services.asked, ElementsAre(L"DynamicLinker", L"DynamicLinker"));
        EXPECT_THAT(lines(), IsEmpty());
        EXPECT_THAT(boxes(), IsEmpty());
        EXPECT_EQ(1u, host().applicationRecords.writes.size()) << "the record is kept in step all the same";
    }
}

TEST_F(EntryPoint, IgnoresWhatBecameOfTheCommand)
{
    host().commands.answerToAdd = TSED_COMMAND_DUPLICATE;
    EXPECT_EQ(0, Send(kLoadMessage));
    EXPECT_THAT(host().applicationRecords.reads, ElementsAre(kRecordName));
    EXPECT_THAT(lines(), IsEmpty());
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(EntryPoint, RunsTheDialogWithItsTextsWhenTheCommandIsTyped)
{
    host().resources.addModule(L"other.dll", {});
    const HMODULE other = host().resources.load(L"other.dll");
    Send(kLoadMessage);
    host().resources.current = other;
    HMODULE during = nullptr;
    recordingDialog().duringRun = [&during]
    {
        during = host().resources.current;
    };
    EXPECT_TRUE(host().commands.type(L"localname"));
    EXPECT_TRUE(host().commands.type(L"_GLOBALNAME"));
    EXPECT_EQ(2, recordingDialog().runs);
    EXPECT_EQ(hModrigRes, during);
    EXPECT_EQ(other, host().resources.current);
}

TEST_F(EntryPoint, HasNothingToDoInUnloadApp)
{
    Send(kLoadMessage);
    Fill(gHistoryList, {L"/apps/new.lsp"});
    host().journal.clear();
    unloadApp();
    EXPECT_THAT(host().journal.entries(), IsEmpty());
    EXPECT_EQ(1u, gHistoryList.GetCount());
}

TEST_F(EntryPoint, RewritesTheRecordToLoadOnCommandOnlyWhenTheStartupSuiteIsEmpty)
{
    host().applicationRecords.set({kRecordName, kModulePath, L"d", 6});
    Send(kLoadMessage);
    EXPECT_EQ(4u, host().applicationRecords.find(kRecordName)->loadReason);
}

TEST_F(EntryPoint, StartsWithAnUnreadableRegistry)
{
    host().registry.failAfter(RecordingRegistry::Operation::kOpen, 0, ERROR_ACCESS_DENIED);
    EXPECT_EQ(0, Send(kLoadMessage));
    EXPECT_TRUE(gStartupList.IsEmpty());
    EXPECT_TRUE(host().commands.has(L"LOCALNAME"));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(UpdateRegistry, CreatesNoRecordForAnEmptyStartupSuite)
{
    ModrigUtils::updateRegistry();
    EXPECT_THAT(host().journal.entries(), ElementsAre(L"readFromRegistry(TesselModrig)"));
    EXPECT_FALSE(host().applicationRecords.find(kRecordName));
}

TEST_F(UpdateRegistry, CreatesARecordThatLoadsAtStartAndOnCommandForAStartupSuite)
{
    host().loadedModules.applicationName = kModulePath;
    Fill(gStartupList, {L"/apps/tool.lsp"});
    ModrigUtils::updateRegistry();
    ASSERT_EQ(1u, writes().size());
    EXPECT_EQ((RecordingApplicationRecord{kRecordName, kModulePath, L"TesselModrig Command Module", 6}),
              writes().front().record);
    EXPECT_FALSE(writes().front().forAllUsers);
    EXPECT_TRUE(writes().front().withCommands);
}

TEST_F(UpdateRegistry, TakesAnyFailureToReadForNoRecord)
{
    Fill(gStartupList, {L"/apps/tool.lsp"});
    for (const int status : {TSRX_APPINFO_NOT_FOUND, TSRX_APPINFO_ERROR, -1, 5100})
    {
        host().applicationRecords.answerToRead = status;
        host().applicationRecords.writes.clear();
        ModrigUtils::updateRegistry();
        ASSERT_EQ(1u, writes().size());
        EXPECT_EQ(6u, writes().front().record.loadReason);
    }
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(UpdateRegistry, AddsTheOneReasonToTheOldOnesForAStartupSuite)
{
    Fill(gStartupList, {L"/apps/tool.lsp"});
    Store(4);
    ModrigUtils::updateRegistry();
    ASSERT_EQ(1u, writes().size());
    EXPECT_EQ((RecordingApplicationRecord{kRecordName, L"/old/Modrig.bundle", L"old description", 6}),
              writes().front().record)
        << "module name and description are not refreshed";
    EXPECT_FALSE(writes().front().forAllUsers);
    EXPECT_TRUE(writes().front().withCommands);
}

TEST_F(UpdateRegistry, TakesTheOneReasonFromTheOldOnesForAnEmptyStartupSuite)
{
    Store(6);
    ModrigUtils::updateRegistry();
    ASSERT_EQ(1u, writes().size());
    EXPECT_EQ((RecordingApplicationRecord{kRecordName, L"/old/Modrig.bundle", L"old description", 4}),
              writes().front().record);
    EXPECT_FALSE(writes().front().forAllUsers);
    EXPECT_TRUE(writes().front().withCommands);
}

TEST_F(UpdateRegistry, ManagesOneReasonOnlyAndWritesOnlyAChange)
{
    for (unsigned reasons = 0; reasons < 64; ++reasons)
        for (const bool hasStartup : {false, true})
        {
            SetUp();
            if (hasStartup)
                Fill(gStartupList, {L"/apps/tool.lsp"});
            Store(reasons);
            ModrigUtils::updateRegistry();
            const unsigned expected = hasStartup ? reasons | 2u : reasons & ~2u;
            EXPECT_EQ(expected, host().applicationRecords.find(kRecordName)->loadReason);
            EXPECT_EQ(expected == reasons ? 0u : 1u, writes().size()) << reasons << hasStartup;
        }
}

TEST_F(UpdateRegistry, SaysNothingWhenTheRecordCannotBeWritten)
{
    Fill(gStartupList, {L"/apps/tool.lsp"});
    host().applicationRecords.answerToWrite = TSRX_APPINFO_ERROR;
    ModrigUtils::updateRegistry();
    Store(4);
    ModrigUtils::updateRegistry();
    EXPECT_EQ(2u, writes().size());
    EXPECT_THAT(boxes(), IsEmpty());
    EXPECT_THAT(lines(), IsEmpty());
}
