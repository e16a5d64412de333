#include "modrig/loader/LoadedApplications.h"

#include "modrig/lists/Globals.h"
#include "modrig/messages/MessageIds.h"
#include "tests/support/ModuleTest.h"
#include "tests/support/recording/RecordingLoans.h"

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class Rebuilding : public ModuleTest
{
protected:
    void SetUp() override
    {
        ModuleTest::SetUp();
        host().loadedModules.applicationName = L"/host/PlugIns/Modrig.bundle";
        host().loadedModules.add(L"/host/PlugIns/Modrig.bundle");
    }
    static std::vector<std::wstring> Rebuilt()
    {
        PopulateLoadedApps();
        return Texts(gLoadedAppList);
    }
};

class AskingWhatIsLoaded : public ModuleTest
{
};

class AskingWhatMayBeUnloaded : public ModuleTest
{
};

class Unloading : public ModuleTest
{
protected:
    static void Load(std::initializer_list<const wchar_t*> paths)
    {
        for (const wchar_t* path : paths)
            host().linker.setLoaded(path);
        Fill(gLoadedAppList, paths);
    }
    // The indexes of those unloaded.
    std::vector<std::size_t> Unload(const std::vector<UnloadCandidate>& candidates)
    {
        std::vector<std::size_t> unloaded;
        UnloadApplications(candidates,
                           [&](std::size_t index)
                           {
                               unloaded.push_back(index);
                               mEntriesLeft.push_back(gLoadedAppList.GetCount());
                           });
        return unloaded;
    }

    // What the list held each time that a row went.
    std::vector<std::size_t> mEntriesLeft;
};
} // namespace

TEST_F(Rebuilding, ListsModulesLoadedElsewhereWithTheirFullPathsInTheHostsOrder)
{
    host().loadedModules.add(L"/b/two.zmb");
    host().loadedModules.add(L"/a/one.bundle");
    EXPECT_THAT(Rebuilt(), ElementsAre(L"/b/two.zmb", L"/a/one.bundle"));
}

TEST_F(Rebuilding, DropsWhatTheHostReportsNoMore)
{
    Fill(gLoadedAppList, {L"/a/gone.zmb", L"/a/tool.lsp", L"/a/package.rpk", L"/a/nodot", L"/a/x.xyz"});
    host().loadedModules.add(L"/a/one.zmb");
    EXPECT_THAT(Rebuilt(), ElementsAre(L"/a/one.zmb"));
}

TEST_F(Rebuilding, KeepsMacroProjectsInTheirOrder)
{
    Fill(gLoadedAppList, {L"/a/one.mcp", L"/a/gone.zmb", L"/b/TWO.MCP", L"/a/one.mcp", L"/a/GONE.zmb"});
    host().loadedModules.add(L"/a/one.zmb");
    for (int rebuild = 0; rebuild < 3; ++rebuild)
        EXPECT_THAT(Rebuilt(), ElementsAre(L"/a/one.mcp", L"/b/TWO.MCP", L"/a/one.mcp", L"/a/one.zmb"));
}

TEST_F(Rebuilding, DropsTheSamePathInEverySpelling)
{
    Fill(gLoadedAppList, {L"/a/gone.zmb", L"/A/GONE.ZMB", L"/a/Gone.zmb"});
    EXPECT_THAT(Rebuilt(), IsEmpty());
}

TEST_F(Rebuilding, NeverListsTheModuleItself)
{
    EXPECT_THAT(Rebuilt(), IsEmpty());
    host().loadedModules.remove(L"/host/PlugIns/Modrig.bundle");
    host().loadedModules.add(L"MODRIG.BUNDLE", L"/elsewhere/modrig.bundle");
    host().loadedModules.add(L"/a/Modrig.zmb");
    EXPECT_THAT(Rebuilt(), ElementsAre(L"/a/Modrig.zmb"));
}

TEST_F(Rebuilding, KeepsMacroProjectsOnlyAndDoesNotAskTheDocumentWhenTheHostReportsNoModules)
{
    host().loadedModules.reportsNothing = true;
    host().document.applications = {L"/d/tool.lsp"};
    Fill(gLoadedAppList, {L"/a/one.mcp", L"/a/gone.zmb"});
    EXPECT_THAT(Rebuilt(), ElementsAre(L"/a/one.mcp"));
    EXPECT_EQ(0u, host().journal.count(L"curDoc"));
    EXPECT_EQ(1u, host().journal.count(L"tsedQmbLoaded"));
}

TEST_F(Rebuilding, AsksForThePathsOfNamesOnly)
{
    host().loadedModules.addOther(RecordingValue::Long(4711));
    host().loadedModules.addOther(RecordingValue::Nil());
    host().loadedModules.add(L"/a/one.zmb");
    EXPECT_THAT(Rebuilt(), ElementsAre(L"/a/one.zmb"));
    EXPECT_THAT(host().journal.entriesOf(L"tsedGetModuleFileName"),
                ElementsAre(L"tsedGetModuleFileName(Modrig.bundle)", L"tsedGetModuleFileName(one.zmb)"));
}

TEST_F(Rebuilding, PassesOverAModuleWithoutAPath)
{
    host().loadedModules.add(L"/a/one.zmb");
    host().loadedModules.add(L"/a/two.zmb");
    host().loadedModules.namesWithoutPath = {L"one.zmb"};
    for (const int status : {TS_ERROR, 1, -1})
    {
        host().loadedModules.failure = status;
        EXPECT_THAT(Rebuilt(), ElementsAre(L"/a/two.zmb")) << status;
    }
    EXPECT_THAT(boxes(), IsEmpty());
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(Rebuilding, PassesOverAModuleWhosePathDoesNotFitAndTakesTheLongestThatDoes)
{
    const std::wstring longest = LongPath(1023, L"one.zmb");
    host().loadedModules.add(longest);
    host().loadedModules.add(LongPath(1024, L"two.zmb"));
    EXPECT_THAT(Rebuilt(), ElementsAre(longest));
}

TEST_F(Rebuilding, AddsNoModuleThatTheListHoldsAlready)
{
    host().loadedModules.add(L"one.zmb", L"/a/one.zmb");
    host().loadedModules.add(L"second.zmb", L"/A/ONE.zmb");
    host().loadedModules.add(L"tool.omp", L"/a/tool.omp");
    host().loadedModules.add(L"other.omp", L"/b/TOOL.omp");
    host().loadedModules.add(L"t.bundle", L"/a/t.bundle");
    host().loadedModules.add(L"u.bundle", L"/b/t.bundle");
    EXPECT_THAT(Rebuilt(), ElementsAre(L"/a/one.zmb", L"/a/tool.omp", L"/a/t.bundle", L"/b/t.bundle"));
}

TEST_F(Rebuilding, ListsOneOfTwoModulesThatShareTheirNameSinceTheHostGivesThePathOfTheFirstForBoth)
{
    host().loadedModules.add(L"/a/one.zmb");
    host().loadedModules.add(L"/b/one.zmb");
    EXPECT_THAT(Rebuilt(), ElementsAre(L"/a/one.zmb"));
    EXPECT_THAT(Rebuilt(), ElementsAre(L"/a/one.zmb"));
}

TEST_F(Rebuilding, AsksForEachPathAndThenForTheModulesOwnName)
{
    host().loadedModules.add(L"/a/one.zmb");
    host().loadedModules.add(L"/a/two.zmb");
    host().loadedModules.namesWithoutPath = {L"one.zmb"};
    PopulateLoadedApps();
    EXPECT_THAT(WithoutBookkeeping(host().journal.entries()),
                ElementsAre(L"tsedQmbLoaded()",                                                  //
                            L"tsedGetModuleFileName(Modrig.bundle)", L"tsedGetAppName()",        //
                            L"tsedGetModuleFileName(one.zmb)",                                   //
                            L"tsedGetModuleFileName(two.zmb)", L"tsedGetAppName()", L"curDoc()", //
                            L"loadedApplicationCount()"));
}

TEST_F(Rebuilding, GivesTheHostsListBackBeforeItAsksTheDocument)
{
    std::vector<std::string> out = {"not asked"};
    host().document.whenAskedFor = [&out]
    {
        out = recording_loans::outstanding();
    };
    PopulateLoadedApps();
    EXPECT_THAT(out, IsEmpty());
}

TEST_F(Rebuilding, AddsTheDocumentsApplicationsAfterTheModulesAsTheyAreNamed)
{
    host().loadedModules.add(L"/a/one.zmb");
    host().document.applications = {L"/d/Tööl 100%.lsp", L"no folder", L"/D/TÖÖL 100%.LSP", L"/A/ONE.ZMB"};
    EXPECT_THAT(Rebuilt(), ElementsAre(L"/a/one.zmb", L"/d/Tööl 100%.lsp", L"no folder"));
    EXPECT_THAT(host().journal.entriesOf(L"loadedApplicationName"),
                ElementsAre(L"loadedApplicationName(0)", L"loadedApplicationName(1)",
                            L"loadedApplicationName(2)", L"loadedApplicationName(3)"));
}

TEST_F(Rebuilding, DoesWithoutADocument)
{
    host().document.exists = false;
    host().loadedModules.add(L"/a/one.zmb");
    EXPECT_THAT(Rebuilt(), ElementsAre(L"/a/one.zmb"));
}

TEST_F(Rebuilding, AsksTheHostForItsModulesBeforeItsDocument)
{
    host().document.applications = {L"/d/tool.lsp"};
    PopulateLoadedApps();
    const std::vector<std::wstring> entries = host().journal.entries();
    EXPECT_EQ(L"tsedQmbLoaded()", entries.front());
    EXPECT_EQ(L"loadedApplicationName(0)", entries.back());
}

TEST_F(AskingWhatIsLoaded, RefusesAPathWithoutADotWithAnAnswerOfNo)
{
    EXPECT_FALSE(ApplicationIsLoaded(L"/a/tool"));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/a/tool")));
    EXPECT_EQ(0u, host().journal.count(L"tsedQmbLoaded"));
}

TEST_F(AskingWhatIsLoaded, AnswersYesForEverythingButCompiledModulesWithoutAskingTheHost)
{
    for (const wchar_t* path :
         {L"/a/t.lsp", L"/a/t.qbc", L"/a/t.mcp", L"/a/t.rpk", L"/a/t.xyz", L"/a/t.", L"/a.zmb/t"})
        EXPECT_TRUE(ApplicationIsLoaded(path)) << path;
    EXPECT_THAT(host().journal.entries(), IsEmpty());
}

TEST_F(AskingWhatIsLoaded, AsksTheHostForCompiledModulesByFileNameInAnyCase)
{
    host().loadedModules.add(L"/elsewhere/Tööl.zmb");
    EXPECT_TRUE(ApplicationIsLoaded(L"/a/TÖÖL.ZMB"));
    EXPECT_TRUE(ApplicationIsLoaded(L"C:\\a\\tööl.zmb"));
    EXPECT_FALSE(ApplicationIsLoaded(L"/a/Tööl.omp"));
    EXPECT_FALSE(ApplicationIsLoaded(L"/a/other.zmb"));
}

TEST_F(AskingWhatIsLoaded, AnswersNoWhenTheHostReportsNothing)
{
    Fill(gLoadedAppList, {L"/a/tool.zmb"});
    EXPECT_FALSE(ApplicationIsLoaded(L"/a/tool.zmb")) << "the module's own list does not count";
}

TEST_F(AskingWhatIsLoaded, LooksAtNamesOnly)
{
    host().loadedModules.addOther(RecordingValue::Short(1));
    host().loadedModules.addOther(RecordingValue::True());
    EXPECT_FALSE(ApplicationIsLoaded(L"/a/tool.zmb"));
    host().loadedModules.add(L"/a/tool.zmb");
    EXPECT_TRUE(ApplicationIsLoaded(L"/a/tool.zmb"));
}

TEST_F(AskingWhatMayBeUnloaded, AnswersYesForAPathWithoutADotAndSaysSo)
{
    EXPECT_TRUE(IsAppUnloadAble(L"/a/tool"));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/a/tool")));
}

TEST_F(AskingWhatMayBeUnloaded, AsksTheLinkerForTheLockOfACompiledModule)
{
    host().linker.setLoaded(L"/a/free.zmb");
    host().linker.setLocked(L"/a/locked.omp");
    EXPECT_TRUE(IsAppUnloadAble(L"/a/free.zmb"));
    EXPECT_FALSE(IsAppUnloadAble(L"/a/locked.omp"));
    EXPECT_THAT(host().journal.entries(),
                ElementsAre(L"at(DynamicLinker)", L"isModuleLocked(/a/free.zmb)", L"at(DynamicLinker)",
                            L"isModuleLocked(/a/locked.omp)"));
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(AskingWhatMayBeUnloaded, AnswersNoForEverythingElseWithoutAskingTheHost)
{
    for (const wchar_t* path : {L"/a/t.lsp", L"/a/t.qbc", L"/a/t.mcp", L"/a/t.rpk", L"/a/t.xyz", L"/a/t."})
        EXPECT_FALSE(IsAppUnloadAble(path)) << path;
    EXPECT_THAT(host().journal.entries(), IsEmpty());
}

TEST_F(Unloading, OneModuleTakesItOutOfTheListAndNamesIt)
{
    Load({L"/a/one.zmb", L"/a/two.zmb"});
    EXPECT_THAT(Unload({{L"/A/Two.zmb", false}, {L"/a/two.zmb", true}}), ElementsAre(1u));
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(L"/a/one.zmb"));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneUnloaded, L"two.zmb")));
    EXPECT_THAT(recordingDialog().messages, ElementsAre(Message(ModrigMessages::kOneUnloaded, L"two.zmb")));
}

TEST_F(Unloading, SeveralModulesCountsThem)
{
    Load({L"/a/one.zmb", L"/a/two.zmb", L"/a/three.bundle"});
    EXPECT_THAT(Unload({{L"/a/three.bundle", true}, {L"/a/one.zmb", true}}), ElementsAre(0u, 1u));
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(L"/a/two.zmb"));
    EXPECT_THAT(mEntriesLeft, ElementsAre(3u, 2u));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kManyUnloaded, L"2")));
}

TEST_F(Unloading, GoesInTheOrderOfTheSelectionAndAsksForEachLockAgain)
{
    Load({L"/a/one.zmb", L"/a/two.zmb"});
    Unload({{L"/a/two.zmb", true}, {L"/a/one.zmb", true}});
    std::vector<std::wstring> linkerCalls = host().journal.entries();
    std::erase_if(linkerCalls,
                  [](const std::wstring& entry) { return entry.find(L".zmb") == std::wstring::npos; });
    EXPECT_THAT(linkerCalls, ElementsAre(L"isModuleLocked(/a/two.zmb)", L"unloadModule(/a/two.zmb, true)",
                                         L"isModuleLocked(/a/one.zmb)", L"unloadModule(/a/one.zmb, true)"));
}

TEST_F(Unloading, NothingSaysNothing)
{
    Load({L"/a/one.zmb"});
    EXPECT_THAT(Unload({}), IsEmpty());
    EXPECT_THAT(Unload({{L"/a/one.zmb", false}, {L"/a/tool.lsp", false}}), IsEmpty());
    EXPECT_THAT(host().journal.entries(), IsEmpty());
    EXPECT_THAT(recordingDialog().messages, IsEmpty());
    EXPECT_EQ(1u, gLoadedAppList.GetCount());
}

TEST_F(Unloading, ALockedModuleStaysAndIsTheOnlyThingSaid)
{
    Load({L"/a/one.zmb"});
    host().linker.setLocked(L"/a/one.zmb");
    EXPECT_THAT(Unload({{L"/a/one.zmb", true}}), IsEmpty());
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kModuleLocked, L"one.zmb")));
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(L"/a/one.zmb"));
}

TEST_F(Unloading, NamesTheLastOneTriedAlsoWhenAnotherWasUnloaded)
{
    Load({L"/a/a.zmb", L"/a/b.zmb"});
    host().linker.setLocked(L"/a/b.zmb");
    EXPECT_THAT(Unload({{L"/a/a.zmb", true}, {L"/a/b.zmb", true}}), ElementsAre(0u));
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kModuleLocked, L"b.zmb"),
                                     Message(ModrigMessages::kOneUnloaded, L"b.zmb")));
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(L"/a/b.zmb"));
}

TEST_F(Unloading, DoesNotCountARowThatIsNotUnloadableAsTried)
{
    Load({L"/a/a.zmb", L"/a/b.zmb"});
    Unload({{L"/a/a.zmb", true}, {L"/a/b.zmb", false}});
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneUnloaded, L"a.zmb")));
}

TEST_F(Unloading, GoesOnAfterAModuleThatDoesNotUnload)
{
    Load({L"/a/a.zmb", L"/a/b.zmb", L"/a/c.zmb"});
    host().linker.refuseToUnload(L"/a/a.zmb", L"it will not go");
    EXPECT_THAT(Unload({{L"/a/a.zmb", true}, {L"/a/b.zmb", true}, {L"/a/c.zmb", true}}), ElementsAre(1u, 2u));
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(L"/a/a.zmb"));
    EXPECT_EQ(Message(ModrigMessages::kManyUnloaded, L"2"), lines().back());
}

TEST_F(Unloading, TakesAnObjectDatabaseModuleOutByItsWholePath)
{
    Load({L"/a/tool.omp"});
    host().linker.setLoaded(L"/b/tool.omp");
    EXPECT_THAT(Unload({{L"/b/tool.omp", true}}), ElementsAre(0u));
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(L"/a/tool.omp"));
}

TEST_F(Unloading, APathWithoutADotThatCountsAsUnloadableIsRefusedByTheLoader)
{
    EXPECT_THAT(Unload({{L"/a/tool", true}}), IsEmpty());
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/a/tool")));
    EXPECT_THAT(lines(), IsEmpty());
}

TEST_F(Unloading, ModulesWithPerCentSignsInTheirNamesPrintsThemAsTheyAre)
{
    Load({L"/a/100%s%n.zmb"});
    Unload({{L"/a/100%s%n.zmb", true}});
    EXPECT_THAT(lines(), ElementsAre(Message(ModrigMessages::kOneUnloaded, L"100%s%n.zmb")));
}

TEST_F(AskingWhatIsLoaded, ShowsWhatTheHostHasOfTheLoadedAndThenOfTheStartupSuite)
{
    host().loadedModules.add(L"/a/one.zmb");
    host().loadedModules.add(L"/a/two.zmb");
    Fill(gLoadedAppList, {L"/a/gone.zmb", L"/a/two.zmb", L"/a/tool.lsp"});
    Fill(gStartupList, {L"/a/one.zmb", L"/a/missing.zmb", L"/a/two.zmb"});
    std::vector<std::wstring> shown;
    for (const CStdStr& path : ApplicationsShownAsLoaded())
        shown.push_back(path.Text());
    EXPECT_THAT(shown, ElementsAre(L"/a/two.zmb", L"/a/tool.lsp", L"/a/one.zmb", L"/a/two.zmb"));
}
