#include "modrig/loader/ApplicationLoader.h"

#include "modrig/lists/Globals.h"
#include "modrig/messages/MessageIds.h"
#include "tests/support/ModuleTest.h"

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class PerformingALoad : public ModuleTest
{
protected:
    static int Perform(const std::wstring& path, int addToHistory = 0, signed char reportFailure = 1)
    {
        return PerformModrig(CStdStr(path), addToHistory, 0, reportFailure);
    }
    static void SetLispEnabled(const RecordingValue& value) { host().variables.set(L"LISPENABLED", value); }
};

class LoadingAnApplication : public ModuleTest
{
};

class LoadingACompiledModule : public ModuleTest
{
};

// A linker that another one takes the place of while it is asked for a lock.
class VanishingLinker : public RecordingLinker
{
public:
    bool isModuleLocked(const wchar_t* path) const override
    {
        recordingHost().services.set(TSRX_DYNAMIC_LINKER, &recordingHost().linker);
        return RecordingLinker::isModuleLocked(path);
    }
    bool unloadModule(const wchar_t*, bool) override
    {
        ADD_FAILURE() << "the linker of the call before was asked";
        return false;
    }
};
} // namespace

TEST_F(PerformingALoad, ReadsTheVariableThenLoadsThenListsTheFile)
{
    EXPECT_EQ(1, Perform(L"/a/tool.zmb"));
    EXPECT_THAT(host().journal.entries(), ElementsAre(L"tsedGetVar(LISPENABLED)", L"at(DynamicLinker)",
                                                      L"loadModule(/a/tool.zmb, true, true)"));
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(L"/a/tool.zmb"));
    EXPECT_TRUE(gHistoryList.IsEmpty());
    EXPECT_THAT(boxes(), IsEmpty());
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(PerformingALoad, RecordsTheFileInTheHistoryWhenAsked)
{
    EXPECT_EQ(1, Perform(L"/a/one.zmb", 1));
    EXPECT_EQ(1, Perform(L"/a/two.lsp", -5));
    EXPECT_EQ(1, Perform(L"/a/three.lsp", 0));
    EXPECT_THAT(Texts(gHistoryList), ElementsAre(L"/a/one.zmb", L"/a/two.lsp"));
}

TEST_F(PerformingALoad, RecordsAFileInTheHistoryOnce)
{
    Fill(gHistoryList, {L"/A/ONE.zmb", L"/b/two.omp"});
    EXPECT_EQ(1, Perform(L"/a/one.zmb", 1));
    EXPECT_EQ(1, Perform(L"/a/two.omp", 1));
    EXPECT_THAT(Texts(gHistoryList), ElementsAre(L"/A/ONE.zmb", L"/b/two.omp"));
}

TEST_F(PerformingALoad, AnswersTwoForAModuleThatIsListedAndTouchesNothing)
{
    Fill(gLoadedAppList, {L"/A/Tool.zmb"});
    host().journal.clear();
    EXPECT_EQ(2, Perform(L"/a/tool.ZMB", 1));
    EXPECT_THAT(host().journal.entries(), ElementsAre(L"tsedGetVar(LISPENABLED)"));
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(L"/A/Tool.zmb"));
    EXPECT_TRUE(gHistoryList.IsEmpty());
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(PerformingALoad, AnswersTwoWhenTheSameModuleIsLoadedTwice)
{
    EXPECT_EQ(1, Perform(L"/a/tool.zmb", 1));
    EXPECT_EQ(2, Perform(L"/a/tool.zmb", 1));
    EXPECT_EQ(1u, gLoadedAppList.GetCount());
    EXPECT_EQ(1u, gHistoryList.GetCount());
    EXPECT_EQ(1u, host().linker.calls.size());
}

TEST_F(PerformingALoad, AnswersTwoForAnObjectDatabaseModuleOfThatNameInAnotherFolderButLoadsSuchABundle)
{
    Fill(gLoadedAppList, {L"/a/tool.omp", L"/a/tool.bundle"});
    EXPECT_EQ(2, Perform(L"/b/TOOL.OMP"));
    EXPECT_EQ(1, Perform(L"/b/tool.bundle"));
}

TEST_F(PerformingALoad, AnswersTwoForAListedMacroProjectOrAnyOtherListedFileThatIsNoLisp)
{
    Fill(gLoadedAppList, {L"/a/tool.mcp", L"/a/tool", L"/a/tool.xyz"});
    EXPECT_EQ(2, Perform(L"/a/tool.mcp"));
    EXPECT_EQ(2, Perform(L"/a/tool"));
    EXPECT_EQ(2, Perform(L"/a/tool.xyz"));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(PerformingALoad, LoadsALispFileEachTimeAndListsItOnce)
{
    EXPECT_EQ(1, Perform(L"/a/tool.lsp"));
    EXPECT_EQ(1, Perform(L"/A/TOOL.LSP"));
    EXPECT_EQ(6u, host().lisp.queued.size());
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(L"/a/tool.lsp"));
}

TEST_F(PerformingALoad, CanRecordALispFileInTheHistoryWithItsSecondLoad)
{
    EXPECT_EQ(1, Perform(L"/a/tool.qbc", 0));
    EXPECT_TRUE(gHistoryList.IsEmpty());
    EXPECT_EQ(1, Perform(L"/a/tool.qbc", 1));
    EXPECT_THAT(Texts(gHistoryList), ElementsAre(L"/a/tool.qbc"));
    EXPECT_EQ(1u, gLoadedAppList.GetCount());
}

TEST_F(PerformingALoad, ReportsAModuleThatDoesNotLoadAndListsItNowhere)
{
    host().linker.refuseToLoad(L"/a/tool.zmb", L"it is truncated");
    EXPECT_EQ(0, Perform(L"/a/tool.zmb", 1));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kLoadFailed, L"/a/tool.zmb")));
    EXPECT_TRUE(gLoadedAppList.IsEmpty());
    EXPECT_TRUE(gHistoryList.IsEmpty());
}

TEST_F(PerformingALoad, KeepsAFailureToItselfWhenAskedTo)
{
    host().linker.refuseToLoad(L"/a/tool.zmb");
    EXPECT_EQ(0, Perform(L"/a/tool.zmb", 1, 0));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(PerformingALoad, ReportsAFailureForAnyFlagButZero)
{
    host().linker.refuseToLoad(L"/a/tool.zmb");
    for (const int flag : {-1, 1, 2, -128, 127})
    {
        host().output.boxes.clear();
        EXPECT_EQ(0, Perform(L"/a/tool.zmb", 1, static_cast<signed char>(flag)));
        EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kLoadFailed, L"/a/tool.zmb"))) << flag;
    }
}

TEST_F(PerformingALoad, ReportsAPathWithoutADotTwice)
{
    EXPECT_EQ(0, Perform(L"/a/tool"));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/a/tool"),
                                     Message(ModrigMessages::kLoadFailed, L"/a/tool")));
}

TEST_F(PerformingALoad, ReportsAPathWithoutADotOnceWhenFailuresAreNotReported)
{
    EXPECT_EQ(0, Perform(L"/a/tool", 0, 0));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/a/tool")));
}

TEST_F(PerformingALoad, AlwaysRefusesPackagedLispAndMacroProjectsAloudWhileLispIsOn)
{
    EXPECT_EQ(0, Perform(L"/a/tool.rpk", 1));
    EXPECT_EQ(0, Perform(L"/a/tool.mcp", 1));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/a/tool.rpk"),
                                     Message(ModrigMessages::kLoadFailed, L"/a/tool.rpk"),
                                     Message(ModrigMessages::kCannotLoadFile, L"/a/tool.mcp"),
                                     Message(ModrigMessages::kLoadFailed, L"/a/tool.mcp")));
    EXPECT_TRUE(gLoadedAppList.IsEmpty());
}

TEST_F(PerformingALoad, RefusesAListedPackagedLispAloudInsteadOfAnsweringTwo)
{
    Fill(gLoadedAppList, {L"/a/tool.rpk"});
    EXPECT_EQ(0, Perform(L"/a/tool.rpk"));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/a/tool.rpk"),
                                     Message(ModrigMessages::kLoadFailed, L"/a/tool.rpk")));
}

TEST_F(PerformingALoad, RefusesLispAndMacroFilesSilentlyWhileLispIsOff)
{
    SetLispEnabled(RecordingValue::Short(0));
    for (const wchar_t* path : {L"/a/t.lsp", L"/a/t.LSP", L"/a/t.qbc", L"/a/t.RPK", L"/a/t.Mcp"})
    {
        Fill(gLoadedAppList, {path});
        EXPECT_EQ(0, Perform(path, 1)) << "even when it is listed";
    }
    EXPECT_THAT(host().lisp.queued, IsEmpty());
    EXPECT_THAT(boxes(), IsEmpty());
    EXPECT_THAT(lines(), IsEmpty());
    EXPECT_TRUE(gHistoryList.IsEmpty());
}

TEST_F(PerformingALoad, LoadsCompiledModulesWhileLispIsOff)
{
    SetLispEnabled(RecordingValue::Short(0));
    EXPECT_EQ(1, Perform(L"/a/tool.zmb"));
    EXPECT_EQ(1, Perform(L"/a.lsp/tool.omp"));
}

TEST_F(PerformingALoad, RefusesUnknownFilesAloudWhileLispIsOff)
{
    SetLispEnabled(RecordingValue::Short(0));
    EXPECT_EQ(0, Perform(L"/a/tool.txt"));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/a/tool.txt"),
                                     Message(ModrigMessages::kLoadFailed, L"/a/tool.txt")));
}

TEST_F(PerformingALoad, LoadsLispUnlessTheVariableIsAShortZero)
{
    const RecordingValue on[] = {RecordingValue::Short(1), RecordingValue::Short(-1),
                                 RecordingValue::Long(0),  RecordingValue::Real(0),
                                 RecordingValue::Nil(),    RecordingValue::String(L"0")};
    for (const RecordingValue& value : on)
    {
        SetLispEnabled(value);
        EXPECT_EQ(1, Perform(L"/a/tool.lsp")) << value.type;
    }
    host().variables.remove(L"LISPENABLED");
    EXPECT_EQ(1, Perform(L"/a/tool.lsp"));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(PerformingALoad, HandsTheLoadAllFlagToTheLispRoad)
{
    EXPECT_EQ(kLoaded, PerformModrig(L"/a/tool.lsp", 0, 0, 1));
    EXPECT_EQ(kLoaded, PerformModrig(L"/a/tool.lsp", 0, 1, 1));
    ASSERT_EQ(6u, host().lisp.queued.size());
    EXPECT_EQ(L"(load \"/a/tool.lsp\")", host().lisp.queued[0]);
    EXPECT_EQ(L"(progn (_INTERNAL-LOAD-ALL-FILE \"/a/tool.lsp\" nil T T nil)(princ))", host().lisp.queued[3]);
}

TEST_F(PerformingALoad, LoadsPathsWithBlanksQuotesPerCentSignsAndLettersOfAnyScript)
{
    for (const wchar_t* path : {L"/a b/tool 1.zmb", L"/a/\"q\".zmb", L"/a/100%s%n.zmb", L"C:\\ä\\tööl.zmb"})
    {
        EXPECT_EQ(1, Perform(path, 1));
        EXPECT_EQ(path, host().linker.calls.back().path);
    }
    EXPECT_EQ(4u, gHistoryList.GetCount());
}

TEST_F(PerformingALoad, LoadsAPathOf4000CharactersWhole)
{
    const std::wstring path = LongPath(4000, L"tool.zmb");
    ASSERT_EQ(4000u, path.size());
    EXPECT_EQ(1, Perform(path, 1));
    EXPECT_EQ(path, host().linker.calls.back().path);
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(path));
    EXPECT_THAT(Texts(gHistoryList), ElementsAre(path));
    EXPECT_EQ(2, Perform(path));
}

TEST_F(PerformingALoad, ReportsAPathOf4000CharactersThatDoesNotLoadByItsHead)
{
    const std::wstring path = LongPath(4000, L"tool.txt");
    EXPECT_EQ(0, Perform(path));
    ASSERT_EQ(2u, boxes().size());
    EXPECT_TRUE(boxes()[1].starts_with(Message(ModrigMessages::kLoadFailed, path.substr(0, 1000))));
}

TEST_F(PerformingALoad, DoesNotTakeALispPathThatIsTooLongToBeTakenApartForLisp)
{
    SetLispEnabled(RecordingValue::Short(0));
    EXPECT_EQ(1, Perform(LongPath(4000, L"tool.lsp")));
}

TEST_F(LoadingAnApplication, ChoosesTheRoadByTheTextAfterTheLastDot)
{
    EXPECT_TRUE(LoadApplication(L"/a.lsp/tool.x.ZMB", 1, 0));
    EXPECT_TRUE(LoadApplication(L"/a.zmb/tool.x.QBC", 1, 0));
    EXPECT_EQ(1u, host().linker.calls.size());
    EXPECT_EQ(3u, host().lisp.queued.size());
}

TEST_F(LoadingAnApplication, HandsEveryCompiledKindToTheLinker)
{
    for (const wchar_t* path : {L"/a/t.bundle", L"/a/t.zmb", L"/a/t.omp"})
        EXPECT_TRUE(LoadApplication(path, 1, 1));
    EXPECT_EQ(3u, host().linker.calls.size());
    EXPECT_TRUE(gLoadedAppList.IsEmpty()) << "the lists are the caller's";
}

TEST_F(LoadingAnApplication, RefusesAPathWithoutADotInBothDirections)
{
    EXPECT_FALSE(LoadApplication(L"/a/tool", 1, 0));
    EXPECT_FALSE(LoadApplication(L"/a/tool", 0, 0));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/a/tool"),
                                     Message(ModrigMessages::kCannotLoadFile, L"/a/tool")));
}

TEST_F(LoadingAnApplication, RefusesAFileWhoseFolderAloneHasADot)
{
    EXPECT_FALSE(LoadApplication(L"/a.lsp/tool", 1, 0));
    EXPECT_FALSE(LoadApplication(L"/a/tool.lsp.", 1, 0));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/a.lsp/tool"),
                                     Message(ModrigMessages::kCannotLoadFile, L"/a/tool.lsp.")));
}

TEST_F(LoadingAnApplication, HasNoRoadForMacroProjectsAndPackagedLispInEitherDirection)
{
    for (const wchar_t* path : {L"/a/t.mcp", L"/a/t.rpk", L"/a/t.txt"})
        for (const signed char load : {kLoad, kUnload})
        {
            host().output.boxes.clear();
            EXPECT_FALSE(LoadApplication(path, load, 1));
            EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, path)));
        }
    EXPECT_THAT(host().lisp.queued, IsEmpty());
    EXPECT_THAT(host().linker.calls, IsEmpty());
}

TEST_F(LoadingACompiledModule, PassesBothFlagsAndAnswersWhatTheLinkerAnswers)
{
    EXPECT_TRUE(LoadQMBFile(L"/a/tool.zmb", 1));
    host().linker.refuseToLoad(L"/a/other.zmb");
    EXPECT_FALSE(LoadQMBFile(L"/a/other.zmb", 1));
    EXPECT_THAT(host().journal.entries(),
                ElementsAre(L"at(DynamicLinker)", L"loadModule(/a/tool.zmb, true, true)",
                            L"at(DynamicLinker)", L"loadModule(/a/other.zmb, true, true)"));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(LoadingACompiledModule, AsksForTheLockBeforeItUnloads)
{
    host().linker.setLoaded(L"/a/tool.zmb");
    EXPECT_TRUE(LoadQMBFile(L"/a/tool.zmb", 0));
    EXPECT_THAT(host().journal.entries(),
                ElementsAre(L"at(DynamicLinker)", L"isModuleLocked(/a/tool.zmb)", L"at(DynamicLinker)",
                            L"unloadModule(/a/tool.zmb, true)"));
    EXPECT_FALSE(host().linker.isLoaded(L"/a/tool.zmb"));
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(LoadingACompiledModule, LeavesALockedModuleAndNamesIt)
{
    host().linker.setLocked(L"/a/100%s.zmb");
    EXPECT_FALSE(LoadQMBFile(L"/a/100%s.zmb", 0));
    EXPECT_EQ(0u, host().journal.count(L"unloadModule"));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kModuleLocked, L"100%s.zmb")));
    EXPECT_THAT(recordingDialog().messages,
                ElementsAre(Message(ModrigMessages::kModuleLocked, L"100%s.zmb")));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(LoadingACompiledModule, AnswersFalseWhenTheLinkerCannotUnload)
{
    host().linker.setLoaded(L"/a/tool.zmb");
    host().linker.refuseToUnload(L"/a/tool.zmb", L"it will not go");
    EXPECT_FALSE(LoadQMBFile(L"/a/tool.zmb", 0));
    EXPECT_EQ(1u, host().journal.count(L"unloadModule"));
    EXPECT_THAT(recordingDialog().messages, IsEmpty()) << "the linker has said why itself";
}

TEST_F(LoadingACompiledModule, LooksTheLinkerUpAgainBetweenTheLockQueryAndTheUnload)
{
    VanishingLinker vanishing;
    host().services.set(TSRX_DYNAMIC_LINKER, &vanishing);
    host().linker.setLoaded(L"/a/tool.zmb");
    EXPECT_TRUE(LoadQMBFile(L"/a/tool.zmb", 0));
}

TEST_F(LoadingACompiledModule, AnswersFalseInAHostWithoutALinker)
{
    host().services.miss(TSRX_DYNAMIC_LINKER);
    EXPECT_FALSE(LoadQMBFile(L"/a/tool.zmb", 1));
    EXPECT_FALSE(LoadQMBFile(L"/a/tool.zmb", 0));
}
