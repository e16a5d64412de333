#include "modrig/loader/StartupSuite.h"

#include "modrig/lists/Globals.h"
#include "modrig/messages/MessageIds.h"
#include "tests/support/ModuleTest.h"

using ModrigUtils::InitializeStartupFiles;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class StartupSuite : public ModuleTest
{
protected:
    static void Store(const std::vector<std::wstring>& paths)
    {
        const std::wstring key = host().moduleKey() + L"\\Startup";
        host().registry.setValue(key, L"NumStartup", std::to_wstring(paths.size()));
        for (std::size_t i = 0; i < paths.size(); ++i)
            host().registry.setValue(key, std::to_wstring(i + 1) + L"Startup", paths[i]);
    }
    static std::vector<std::wstring> LoadedModules() { return host().journal.entriesOf(L"loadModule"); }
    static std::wstring Load(const std::wstring& path) { return L"loadModule(" + path + L", true, true)"; }
    static std::wstring LoadAll(const std::wstring& path)
    {
        return L"(progn (_INTERNAL-LOAD-ALL-FILE \"" + path + L"\" nil T T nil)(princ))";
    }
    static std::size_t QueuedOf(const std::wstring& expression)
    {
        const auto& queued = host().lisp.queued;
        return static_cast<std::size_t>(std::count(queued.begin(), queued.end(), expression));
    }
};
} // namespace

TEST_F(StartupSuite, LoadsEachApplicationInOrderByTheRoadOfItsKind)
{
    Store({L"/a/one.zmb", L"/a/two.lsp", L"/a/three.bundle", L"/a/four.qbc", L"/a/five.omp"});
    InitializeStartupFiles();
    std::vector<std::wstring> loads = host().journal.entriesOf(L"loadModule");
    EXPECT_THAT(loads, ElementsAre(Load(L"/a/one.zmb"), Load(L"/a/three.bundle"), Load(L"/a/five.omp")));
    EXPECT_EQ(1u, QueuedOf(LoadAll(L"/a/two.lsp")));
    EXPECT_EQ(1u, QueuedOf(LoadAll(L"/a/four.qbc")));
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(L"/a/one.zmb", L"/a/two.lsp", L"/a/three.bundle",
                                                   L"/a/four.qbc", L"/a/five.omp"));
}

TEST_F(StartupSuite, LoadsAnApplicationAsItJoinsTheList)
{
    Store({L"/a/one.zmb", L"/a/two.zmb"});
    std::vector<std::wstring> seen;
    host().linker.setEntryPoint(L"/a/one.zmb",
                                [&seen](unsigned, void*)
                                {
                                    seen = Texts(gStartupList);
                                    return TSRX_RET_OK;
                                });
    InitializeStartupFiles();
    EXPECT_THAT(seen, ElementsAre(L"/a/one.zmb"));
}

TEST_F(StartupSuite, ListsAPathWithoutADotAndLoadsNothing)
{
    Store({L"/a/tool"});
    InitializeStartupFiles();
    EXPECT_THAT(Texts(gStartupList), ElementsAre(L"/a/tool"));
    EXPECT_THAT(WithoutBookkeeping(host().journal.entries()), IsEmpty()) << "and says nothing";
}

TEST_F(StartupSuite, DoesNotLoadACompiledModuleThatTheHostHasLoadedAlready)
{
    host().linker.setLoaded(L"/elsewhere/TOOL.zmb");
    Store({L"/a/tool.zmb"});
    InitializeStartupFiles();
    EXPECT_THAT(LoadedModules(), IsEmpty());
    EXPECT_THAT(Texts(gStartupList), ElementsAre(L"/a/tool.zmb"));
    EXPECT_TRUE(gLoadedAppList.IsEmpty());
}

TEST_F(StartupSuite, LoadsLispAgainAndCompiledModulesOnceWhenItStartsAgain)
{
    Store({L"/a/one.zmb", L"/a/two.lsp"});
    InitializeStartupFiles();
    InitializeStartupFiles();
    EXPECT_THAT(LoadedModules(), ElementsAre(Load(L"/a/one.zmb")));
    EXPECT_EQ(2u, QueuedOf(LoadAll(L"/a/two.lsp")));
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(L"/a/one.zmb", L"/a/two.lsp"));
}

TEST_F(StartupSuite, AsksTheHostAboutCompiledModulesOnly)
{
    Store({L"/a/two.lsp", L"/a/three.mcp", L"/a/four.xyz"});
    InitializeStartupFiles();
    EXPECT_EQ(0u, host().journal.count(L"tsedQmbLoaded"));
}

TEST_F(StartupSuite, HandsEveryOtherKindToTheLoaderWhichRefusesItAndSaysSo)
{
    Store({L"/a/one.mcp", L"/a/two.rpk", L"/a/three.xyz", L"/a.b/four", L"/a/five."});
    InitializeStartupFiles();
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kCannotLoadFile, L"/a/one.mcp"),
                                     Message(ModrigMessages::kLoadFailed, L"/a/one.mcp"), //
                                     Message(ModrigMessages::kCannotLoadFile, L"/a/two.rpk"),
                                     Message(ModrigMessages::kLoadFailed, L"/a/two.rpk"), //
                                     Message(ModrigMessages::kCannotLoadFile, L"/a/three.xyz"),
                                     Message(ModrigMessages::kLoadFailed, L"/a/three.xyz"), //
                                     Message(ModrigMessages::kCannotLoadFile, L"/a.b/four"),
                                     Message(ModrigMessages::kLoadFailed, L"/a.b/four"), //
                                     Message(ModrigMessages::kCannotLoadFile, L"/a/five."),
                                     Message(ModrigMessages::kLoadFailed, L"/a/five.")));
    EXPECT_EQ(5u, gStartupList.GetCount());
    EXPECT_TRUE(gLoadedAppList.IsEmpty());
}

TEST_F(StartupSuite, KeepsAnApplicationThatDoesNotLoadAndGoesOnAfterIt)
{
    host().linker.refuseToLoad(L"/a/broken.zmb", L"it is truncated");
    Store({L"/a/good.zmb", L"/a/broken.zmb", L"/a/better.zmb"});
    InitializeStartupFiles();
    EXPECT_THAT(Texts(gStartupList), ElementsAre(L"/a/good.zmb", L"/a/broken.zmb", L"/a/better.zmb"));
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(L"/a/good.zmb", L"/a/better.zmb"));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kLoadFailed, L"/a/broken.zmb")));
}

TEST_F(StartupSuite, AddsNothingToTheHistory)
{
    Store({L"/a/one.zmb", L"/a/two.lsp"});
    InitializeStartupFiles();
    EXPECT_TRUE(gHistoryList.IsEmpty());
}

TEST_F(StartupSuite, LoadsADuplicateOnce)
{
    Store({L"/a/tool.lsp", L"/A/TOOL.LSP", L"/a/tool.omp", L"/b/Tool.omp"});
    InitializeStartupFiles();
    EXPECT_THAT(Texts(gStartupList), ElementsAre(L"/a/tool.lsp", L"/a/tool.omp"));
    EXPECT_THAT(LoadedModules(), ElementsAre(Load(L"/a/tool.omp")));
    EXPECT_EQ(3u, host().lisp.queued.size());
}

TEST_F(StartupSuite, LoadsNothingAfterAGap)
{
    Store({L"/a/one.zmb", L"/a/two.zmb", L"/a/three.zmb"});
    host().registry.removeValue(host().moduleKey() + L"\\Startup", L"2Startup");
    InitializeStartupFiles();
    EXPECT_THAT(LoadedModules(), ElementsAre(Load(L"/a/one.zmb")));
}

TEST_F(StartupSuite, ClearsTheFlagOfTheLispEnvironmentBeforeItLoadsAnything)
{
    gbOrreryLoaded = true;
    Store({L"/a/tool.lsp"});
    InitializeStartupFiles();
    EXPECT_FALSE(gbOrreryLoaded);
    EXPECT_THAT(host().lisp.invoked, IsEmpty());
    EXPECT_EQ(1u, QueuedOf(LoadAll(L"/a/tool.lsp")));
}

TEST_F(StartupSuite, ClearsTheFlagOfTheLispEnvironmentAlsoWhenNothingIsStored)
{
    gbOrreryLoaded = true;
    InitializeStartupFiles();
    EXPECT_FALSE(gbOrreryLoaded);
}

TEST_F(StartupSuite, SkipsLispSilentlyWhileItIsSwitchedOff)
{
    host().variables.set(L"LISPENABLED", RecordingValue::Short(0));
    Store({L"/a/one.LSP", L"/a/two.mcp", L"/a/three.zmb"});
    InitializeStartupFiles();
    EXPECT_EQ(3u, gStartupList.GetCount());
    EXPECT_THAT(Texts(gLoadedAppList), ElementsAre(L"/a/three.zmb"));
    EXPECT_THAT(host().lisp.queued, IsEmpty());
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(StartupSuite, LoadsPathsWithBlanksQuotesPerCentSignsAndLettersOfAnyScript)
{
    Store({L"/a b/tööl.zmb", L"/100%s%n.zmb", L"/x/\"q\".zmb", L"/чертёж.zmb"});
    InitializeStartupFiles();
    EXPECT_THAT(LoadedModules(), ElementsAre(Load(L"/a b/tööl.zmb"), Load(L"/100%s%n.zmb"),
                                             Load(L"/x/\"q\".zmb"), Load(L"/чертёж.zmb")));
}
