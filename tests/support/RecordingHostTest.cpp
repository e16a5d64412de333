// What a test can tell the recording host, beyond what the contract asks of every host.
#include "tests/support/RecordingHost.h"

#include <gmock/gmock.h>
#include <tessel/tsed.h>
#include <tessel/tsformat.h>

#include "tests/support/recording/RecordingLoans.h"

using testing::ElementsAre;
using testing::IsEmpty;
using testing::UnorderedElementsAre;

namespace
{
using Operation = RecordingRegistry::Operation;

class RecordingHostTest : public testing::Test
{
protected:
    RecordingHostTest() { host.reset(); }

    static HKEY create(const wchar_t* path)
    {
        HKEY key = nullptr;
        RegCreateKeyEx(HKEY_CURRENT_USER, path, 0, nullptr, 0, KEY_WRITE, nullptr, &key, nullptr);
        return key;
    }

    RecordingHost& host = recordingHost();
};

TEST_F(RecordingHostTest, AnswersAboutLispWhatTheProgramWasLinkedFor)
{
    const unsigned before = RecordingLisp::timesAskedForRemoving();
    EXPECT_EQ(RemovingTsLISP(), EXPECTED_REMOVING);
    host.lisp.removing = !EXPECTED_REMOVING;
    EXPECT_EQ(RemovingTsLISP(), !EXPECTED_REMOVING);
    host.reset();
    EXPECT_EQ(RemovingTsLISP(), EXPECTED_REMOVING);
    EXPECT_EQ(RecordingLisp::timesAskedForRemoving(), before + 3);
}

TEST_F(RecordingHostTest, WritesEveryCallDownInOrder)
{
    tsutPrintf(L"%d\n", 3);
    host.linker.loadModule(L"/a/tool.zmb", true, false);
    qxr_queueexpr(L"(princ)");
    EXPECT_THAT(
        host.journal.entries(),
        ElementsAre(L"tsutPrintf(3\n)", L"loadModule(/a/tool.zmb, true, false)", L"qxr_queueexpr((princ))"));
    EXPECT_EQ(host.journal.count(L"loadModule"), 1u);
}

TEST_F(RecordingHostTest, ForgetsEverythingOnReset)
{
    host.linker.setLocked(L"/a/tool.zmb");
    host.variables.set(L"LISPENABLED", RecordingValue::Short(0));
    host.setProfile(L"Other");
    host.reset();
    EXPECT_FALSE(host.linker.isLoaded(L"/a/tool.zmb"));
    EXPECT_EQ(host.variables.find(L"LISPENABLED"), nullptr);
    EXPECT_EQ(host.registry.value(L"Software\\Tessel\\R21\\Profiles", L""), L"Default");
    EXPECT_THAT(host.journal.entries(), IsEmpty());
}

TEST_F(RecordingHostTest, FailsAfterTheNumberOfCallsThatItWasTold)
{
    const HKEY key = create(L"Key");
    host.registry.failAfter(Operation::kWrite, 1, ERROR_DISK_FULL);
    EXPECT_EQ(tsudRegSetString(key, L"First", L"1"), ERROR_SUCCESS);
    EXPECT_EQ(tsudRegSetString(key, L"Second", L"2"), ERROR_DISK_FULL);
    EXPECT_EQ(RegDeleteValueW(key, L"First"), ERROR_SUCCESS);
    EXPECT_EQ(tsudRegSetString(key, L"Third", L"3"), ERROR_DISK_FULL);
    EXPECT_THAT(host.registry.valueNames(L"key"), IsEmpty());
    EXPECT_EQ(host.registry.callsOf(Operation::kWrite).size(), 3u);
    EXPECT_EQ(host.registry.openHandles(), 1u);
    EXPECT_EQ(RegCloseKey(key), ERROR_SUCCESS);
    EXPECT_EQ(host.registry.openHandles(), 0u);
}

TEST_F(RecordingHostTest, FailsForTheCallsThatATestPicks)
{
    host.registry.failWhen([](const RecordingRegistry::Call& call)
                           { return call.valueName == L"2History" ? ERROR_ACCESS_DENIED : ERROR_SUCCESS; });
    const HKEY key = create(L"Key");
    EXPECT_EQ(tsudRegSetString(key, L"1History", L"1"), ERROR_SUCCESS);
    EXPECT_EQ(tsudRegSetString(key, L"2History", L"2"), ERROR_ACCESS_DENIED);
    EXPECT_EQ(host.registry.value(L"Key", L"1History"), L"1");
    EXPECT_EQ(host.registry.value(L"Key", L"2History"), std::nullopt);
    EXPECT_EQ(RegCloseKey(key), ERROR_SUCCESS);
}

TEST_F(RecordingHostTest, MissesAServiceOrGivesAnotherForIt)
{
    host.services.miss(TSRX_DYNAMIC_LINKER);
    EXPECT_EQ(tsrxSysRegistry()->at(TSRX_DYNAMIC_LINKER), nullptr);
    host.services.set(TSRX_DYNAMIC_LINKER, &host.commands);
    EXPECT_EQ(TsRxDynamicLinker::cast(tsrxSysRegistry()->at(TSRX_DYNAMIC_LINKER)), nullptr);
}

TEST_F(RecordingHostTest, RunsWhatATestHasAnEntryPointDo)
{
    host.linker.setEntryPoint(L"/a/tool.zmb",
                              [this](unsigned message, void* application)
                              {
                                  EXPECT_EQ(message, TSRX_MSG_LOAD);
                                  EXPECT_EQ(application, host.linker.handleOf(L"/a/tool.zmb"));
                                  EXPECT_STREQ(tsedGetAppName(), L"/a/tool.zmb");
                                  host.linker.setLocked(L"/a/other.zmb");
                                  return TSRX_RET_OK;
                              });
    EXPECT_TRUE(host.linker.loadModule(L"/a/tool.zmb", true, true));
    EXPECT_TRUE(host.linker.isModuleLocked(L"/a/other.zmb"));
    EXPECT_FALSE(host.linker.unloadModule(L"/a/other.zmb", true));
    host.linker.refuseToLoad(L"/a/third.zmb", L"it is truncated");
    EXPECT_FALSE(host.linker.loadModule(L"/a/third.zmb", true, true));
    EXPECT_TRUE(host.output.printed.ends_with(L"Cannot load /a/third.zmb: it is truncated.\n"));
}

TEST_F(RecordingHostTest, ReportsModulesThatNoLinkerKnows)
{
    EXPECT_EQ(tsedQmbLoaded(), nullptr);
    host.loadedModules.add(L"/a/one.zmb");
    host.loadedModules.addOther(RecordingValue::Short(7));
    host.loadedModules.add(L"Alias.zmb", L"/a/two.zmb");
    TsResultBuffer* list = tsedQmbLoaded();
    EXPECT_THAT(recordedValues(list),
                ElementsAre(RecordingValue::String(L"one.zmb"), RecordingValue::Short(7),
                            RecordingValue::String(L"Alias.zmb")));
    tsutRelRb(list);
    host.loadedModules.namesWithoutPath.insert(L"one.zmb");
    wchar_t path[16] = {};
    EXPECT_NE(tsedGetModuleFileName(L"one.zmb", path, 16), 0);
    EXPECT_EQ(tsedGetModuleFileName(L"ALIAS.zmb", path, 16), 0);
    EXPECT_STREQ(path, L"/a/two.zmb");
    host.loadedModules.reportsNothing = true;
    EXPECT_EQ(tsedQmbLoaded(), nullptr);
}

TEST_F(RecordingHostTest, AnswersFetchesAsTold)
{
    host.applicationServices.remotes[L"http://a/b"] = {TS_FROM_CACHE, L"/copy"};
    wchar_t path[16] = {};
    EXPECT_EQ(host.applicationServices.fetchRemoteFile(L"http://a/b", path, 16, false), TS_FROM_CACHE);
    EXPECT_STREQ(path, L"/copy");
    EXPECT_EQ(host.applicationServices.fetchRemoteFile(L"http://a/c", path, 16, true), TS_FETCH_FAILED);
    EXPECT_EQ(host.applicationServices.fetches.back().ignoreCache, true);
}

TEST_F(RecordingHostTest, KnowsWhatHasNotBeenGivenBack)
{
    host.resources.addModule(L"Texts.dll", {});
    TsResultBuffer* list = tsutBuildList({TsRbValue::String(L"name"), TsRbValue::Short(1)});
    const HMODULE module = LoadLibrary(L"Texts.dll");
    const HKEY key = create(L"Key");
    auto record = std::make_unique<TesselAppInfo>();
    EXPECT_THAT(recording_loans::outstanding(),
                UnorderedElementsAre("result buffer", "result buffer", "resource module", "registry key",
                                     "application record"));
    tsutRelRb(list);
    EXPECT_NE(FreeLibrary(module), 0);
    EXPECT_EQ(RegCloseKey(key), ERROR_SUCCESS);
    record.reset();
    EXPECT_THAT(recording_loans::outstanding(), IsEmpty());
}

TEST_F(RecordingHostTest, MissesOnlyTheValuesOfAListThatAreNotGivenBack)
{
    TsResultBuffer* list = tsutBuildList({TsRbValue::Short(1), TsRbValue::Short(2), TsRbValue::Short(3)});
    TsResultBuffer* rest = list->next;
    list->next = nullptr;
    tsutRelRb(list);
    EXPECT_THAT(recording_loans::outstanding(), ElementsAre("result buffer", "result buffer"));
    tsutRelRb(rest);
}

TEST_F(RecordingHostTest, RefusesCommandsAndRecordsAsTold)
{
    host.commands.answerToAdd = TSED_COMMAND_DUPLICATE;
    EXPECT_EQ(host.commands.addCommand(
                  L"G", L"N", L"N", 0, [] {}, nullptr, -1, nullptr, nullptr),
              TSED_COMMAND_DUPLICATE);
    EXPECT_FALSE(host.commands.has(L"N"));
    EXPECT_EQ(host.commands.added.size(), 1u);
    host.applicationRecords.answerToWrite = TSRX_APPINFO_ERROR;
    TesselAppInfo record;
    record.setAppName(L"Tool");
    EXPECT_EQ(record.writeToRegistry(false, true), TSRX_APPINFO_ERROR);
    EXPECT_EQ(host.applicationRecords.find(L"Tool"), std::nullopt);
    EXPECT_EQ(host.applicationRecords.writes.size(), 1u);
}
} // namespace
