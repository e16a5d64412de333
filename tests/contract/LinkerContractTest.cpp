#include <tessel/tsed.h>
#include <tessel/tsrxlinker.h>

#include "tests/contract/ContractTest.h"

using testing::ElementsAre;
using testing::ElementsAreArray;
using testing::IsEmpty;

namespace
{
std::size_t countOf(const std::wstring& text, const std::wstring& part)
{
    std::size_t count = 0;
    for (auto at = text.find(part); at != std::wstring::npos; at = text.find(part, at + 1))
        ++count;
    return count;
}

class LinkerContract : public ContractTest
{
protected:
    bool load(const std::wstring& path) const { return linker->loadModule(path.c_str(), true, true); }
    bool unload(const std::wstring& path) const { return linker->unloadModule(path.c_str(), true); }
    bool isLocked(const std::wstring& path) const { return linker->isModuleLocked(path.c_str()); }

    static std::vector<std::wstring> loadedNames()
    {
        TsResultBuffer* list = tsedQmbLoaded();
        std::vector<std::wstring> names;
        for (const RecordingValue& value : recordedValues(list))
        {
            EXPECT_EQ(value.type, TS_STRING);
            names.push_back(value.text);
        }
        tsutRelRb(list);
        return names;
    }

    static std::wstring pathOf(const wchar_t* name)
    {
        wchar_t path[kPathSize] = L"untouched";
        const int status = tsedGetModuleFileName(name, path, kPathSize);
        EXPECT_EQ(status == 0, std::wstring(path) != L"untouched");
        return path;
    }

    std::size_t seenTimes(const std::wstring& text) const { return countOf(host->seen(), text); }

    TsRxDynamicLinker* linker = TsRxDynamicLinker::cast(tsrxSysRegistry()->at(TSRX_DYNAMIC_LINKER));
};

TEST_F(LinkerContract, SendsMessageOneToWhatItLoads)
{
    const std::wstring path = host->makeModule(L"tool.zmb", ContractModule::kPlain);
    EXPECT_TRUE(load(path));
    EXPECT_EQ(seenTimes(L"<message 1>"), 1u);
    EXPECT_THAT(loadedNames(), ElementsAre(L"tool.zmb"));
}

TEST_F(LinkerContract, DoesNothingForWhatIsLoadedAlready)
{
    const std::wstring path = host->makeModule(L"tool.zmb", ContractModule::kPlain);
    EXPECT_TRUE(load(path));
    EXPECT_TRUE(load(path));
    EXPECT_EQ(seenTimes(L"<message"), 1u);
    EXPECT_THAT(loadedNames(), ElementsAre(L"tool.zmb"));
}

TEST_F(LinkerContract, SaysWhichFileDoesNotLoadWhenAskedTo)
{
    const std::wstring path = host->makeFolder(L"folder") + L"/none.zmb";
    EXPECT_FALSE(linker->loadModule(path.c_str(), false, true));
    EXPECT_EQ(seenTimes(path), 0u);
    EXPECT_FALSE(linker->loadModule(path.c_str(), true, true));
    EXPECT_GE(seenTimes(path), 1u);
    EXPECT_THAT(loadedNames(), IsEmpty());
}

TEST_F(LinkerContract, DoesNotKeepWhatAnswersAnErrorToMessageOne)
{
    const std::wstring path = host->makeModule(L"tool.zmb", ContractModule::kRefusesToLoad);
    EXPECT_FALSE(load(path));
    EXPECT_GE(seenTimes(path), 1u);
    EXPECT_THAT(loadedNames(), IsEmpty());
    EXPECT_FALSE(unload(path));
}

TEST_F(LinkerContract, CountsWhatRegistersItselfAsLoadedFromThereOn)
{
    EXPECT_TRUE(load(host->makeModule(L"tool.zmb", ContractModule::kRegistersItself)));
    EXPECT_TRUE(contains(host->seen(), L"<not listed yet>\n<registered>\n<listed>\n<loaded already>\n"));
    EXPECT_EQ(seenTimes(L"<registered>"), 1u);
    EXPECT_THAT(loadedNames(), ElementsAre(L"tool.zmb"));
}

TEST_F(LinkerContract, SendsMessageTwoToWhatItUnloads)
{
    const std::wstring path = host->makeModule(L"tool.zmb", ContractModule::kPlain);
    EXPECT_TRUE(load(path));
    EXPECT_TRUE(unload(path));
    EXPECT_EQ(seenTimes(L"<message 2>"), 1u);
    EXPECT_THAT(loadedNames(), IsEmpty());
    EXPECT_TRUE(load(path));
    EXPECT_EQ(seenTimes(L"<message 1>"), 2u);
}

TEST_F(LinkerContract, TakesWhatStaysMappedOutOfServiceAndSaysSo)
{
    const std::wstring path = host->makeModule(L"tool.zmb", ContractModule::kStaysMapped);
    EXPECT_TRUE(load(path));
    const std::size_t before = host->seen().size();
    EXPECT_TRUE(unload(path));
    const std::wstring told = host->seen().substr(before);
    EXPECT_TRUE(told.starts_with(L"<message 2 to " + path + L">\n")) << told;
    EXPECT_EQ(countOf(told, L"\n"), 2u) << told;
    EXPECT_EQ(countOf(told, path), 2u) << told;
    EXPECT_TRUE(contains(told, L"memory")) << told;
    EXPECT_THAT(loadedNames(), IsEmpty());
    EXPECT_EQ(pathOf(L"tool.zmb"), L"untouched");
    EXPECT_FALSE(host->type(L"CONTRACTNAME"));
    EXPECT_FALSE(linker->unloadModule(path.c_str(), false));
}

TEST_F(LinkerContract, SaysNothingOfWhatStaysMappedWhenNotAskedTo)
{
    const std::wstring path = host->makeModule(L"tool.zmb", ContractModule::kStaysMapped);
    EXPECT_TRUE(load(path));
    const std::size_t before = host->seen().size();
    EXPECT_TRUE(linker->unloadModule(path.c_str(), false));
    EXPECT_EQ(host->seen().substr(before), L"<message 2 to " + path + L">\n");
}

TEST_F(LinkerContract, PutsWhatStayedMappedBackIntoService)
{
    const std::wstring path = host->makeModule(L"tool.zmb", ContractModule::kStaysMapped);
    EXPECT_TRUE(load(path));
    EXPECT_TRUE(unload(path));
    EXPECT_TRUE(load(path));
    EXPECT_EQ(seenTimes(L"<message 1 to " + path + L">"), 2u);
    EXPECT_THAT(loadedNames(), ElementsAre(L"tool.zmb"));
    EXPECT_EQ(pathOf(L"tool.zmb"), path);
    EXPECT_TRUE(host->type(L"CONTRACTNAME"));
    EXPECT_EQ(seenTimes(L"<command of " + path + L">"), 1u);
    EXPECT_TRUE(unload(path));
    EXPECT_EQ(seenTimes(L"<message 2 to " + path + L">"), 2u);
}

TEST_F(LinkerContract, DoesNotUnloadWhatIsNotLoaded)
{
    const std::wstring path = host->makeModule(L"tool.zmb", ContractModule::kPlain);
    EXPECT_FALSE(linker->unloadModule(path.c_str(), false));
    EXPECT_EQ(seenTimes(path), 0u);
    EXPECT_FALSE(unload(path));
    EXPECT_GE(seenTimes(path), 1u);
}

TEST_F(LinkerContract, KeepsWhatAnswersAnErrorToMessageTwo)
{
    const std::wstring path = host->makeModule(L"tool.zmb", ContractModule::kRefusesToUnload);
    EXPECT_TRUE(load(path));
    EXPECT_FALSE(unload(path));
    EXPECT_GE(seenTimes(path), 1u);
    EXPECT_THAT(loadedNames(), ElementsAre(L"tool.zmb"));
}

TEST_F(LinkerContract, KeepsWhatHasLockedItself)
{
    const std::wstring path = host->makeModule(L"tool.zmb", ContractModule::kLocksItself);
    EXPECT_FALSE(isLocked(path));
    EXPECT_TRUE(load(path));
    EXPECT_EQ(seenTimes(L"<locked>"), 1u);
    EXPECT_TRUE(isLocked(path));
    EXPECT_FALSE(unload(path));
    EXPECT_TRUE(host->type(L"CONTRACTUNLOCK"));
    EXPECT_FALSE(isLocked(path));
    EXPECT_TRUE(unload(path));
    EXPECT_FALSE(isLocked(path));
}

TEST_F(LinkerContract, DoesNotKnowAnotherHandle)
{
    int stranger = 0;
    EXPECT_FALSE(linker->registerApplication(&stranger));
    EXPECT_FALSE(linker->registerApplication(nullptr));
    EXPECT_FALSE(linker->setApplicationLocked(&stranger, true));
}

TEST_F(LinkerContract, ListsNothingWhenNothingIsLoaded)
{
    EXPECT_EQ(tsedQmbLoaded(), nullptr);
}

TEST_F(LinkerContract, ListsNamesInTheOrderOfLoading)
{
    for (const wchar_t* name : {L"zebra.zmb", L"Apple.omp", L"middle.zmb"})
        EXPECT_TRUE(load(host->makeModule(name, ContractModule::kPlain)));
    EXPECT_THAT(loadedNames(), ElementsAre(L"zebra.zmb", L"Apple.omp", L"middle.zmb"));
}

TEST_F(LinkerContract, ListsWhatIsLeftOfManyAfterSomeWereUnloaded)
{
    std::vector<std::wstring> names;
    std::vector<std::wstring> paths;
    for (int i = 10; i < 30; ++i)
    {
        names.push_back(L"tool" + std::to_wstring(i) + L".zmb");
        paths.push_back(host->makeModule(names.back(), ContractModule::kPlain));
        EXPECT_TRUE(load(paths.back()));
    }
    EXPECT_THAT(loadedNames(), ElementsAreArray(names));
    for (const std::size_t gone : {19U, 10U, 0U})
    {
        EXPECT_TRUE(linker->unloadModule(paths[gone].c_str(), false));
        names.erase(names.begin() + static_cast<std::ptrdiff_t>(gone));
        EXPECT_THAT(loadedNames(), ElementsAreArray(names));
    }
}

TEST_F(LinkerContract, FindsThePathOfALoadedNameInAnyCase)
{
    const std::wstring path = host->makeModule(L"T\u00F6ol.zmb", ContractModule::kPlain);
    EXPECT_EQ(pathOf(L"T\u00F6ol.zmb"), L"untouched");
    EXPECT_TRUE(load(path));
    EXPECT_EQ(pathOf(L"T\u00F6ol.zmb"), path);
    EXPECT_EQ(pathOf(L"t\u00D6OL.ZMB"), path);
    EXPECT_EQ(pathOf(L"T\u00F6ol"), L"untouched");
}

TEST_F(LinkerContract, FindsTheFirstLoadedOfTwoThatShareAName)
{
    host->makeFolder(L"one");
    host->makeFolder(L"two");
    const std::wstring first = host->makeModule(L"one/tool.zmb", ContractModule::kPlain);
    const std::wstring second = host->makeModule(L"two/TOOL.zmb", ContractModule::kTellsItsName);
    EXPECT_TRUE(load(first));
    EXPECT_TRUE(load(second));
    EXPECT_EQ(pathOf(L"tool.zmb"), first);
    EXPECT_TRUE(unload(first));
    EXPECT_EQ(pathOf(L"tool.zmb"), second);
}

TEST_F(LinkerContract, LeavesTheBufferAloneWhenAPathDoesNotFit)
{
    const std::wstring path = host->makeModule(L"tool.zmb", ContractModule::kPlain);
    EXPECT_TRUE(load(path));
    std::vector<wchar_t> buffer(path.size() + 1, L'?');
    EXPECT_NE(tsedGetModuleFileName(L"tool.zmb", buffer.data(), path.size()), 0);
    EXPECT_EQ(buffer[0], L'?');
    EXPECT_EQ(tsedGetModuleFileName(L"tool.zmb", buffer.data(), path.size() + 1), 0);
    EXPECT_EQ(std::wstring(buffer.data()), path);
}

TEST_F(LinkerContract, TellsAnApplicationItsOwnPathWhileItIsCalled)
{
    const std::wstring path = host->makeModule(L"tool.zmb", ContractModule::kTellsItsName);
    EXPECT_STREQ(tsedGetAppName(), L"");
    EXPECT_TRUE(load(path));
    EXPECT_EQ(seenTimes(L"<message 1 to " + path + L">"), 1u);
    EXPECT_STREQ(tsedGetAppName(), L"");
    EXPECT_TRUE(host->type(L"CONTRACTNAME"));
    EXPECT_EQ(seenTimes(L"<command of " + path + L">"), 1u);
    EXPECT_STREQ(tsedGetAppName(), L"");
    EXPECT_TRUE(unload(path));
    EXPECT_EQ(seenTimes(L"<message 2 to " + path + L">"), 1u);
    EXPECT_STREQ(tsedGetAppName(), L"");
}

TEST_F(LinkerContract, TakesTheCommandsOfAnApplicationAwayWithIt)
{
    const std::wstring path = host->makeModule(L"tool.zmb", ContractModule::kTellsItsName);
    EXPECT_TRUE(load(path));
    EXPECT_TRUE(unload(path));
    EXPECT_FALSE(host->type(L"CONTRACTNAME"));
}
} // namespace
