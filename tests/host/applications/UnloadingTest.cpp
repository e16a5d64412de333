#include "tests/host/support/HostWithModules.h"

#include <algorithm>
#include <fstream>
#include <iterator>
#include <vector>

#include <tessel/tsed.h>

class Unloading : public HostWithModules
{
protected:
    // Where the file is mapped: the lines that the system has about it.
    static std::vector<std::string> mappingsOf(const std::filesystem::path& file)
    {
        std::ifstream maps("/proc/self/maps");
        std::vector<std::string> lines;
        for (std::string line; std::getline(maps, line);)
            if (line.ends_with(file.native()))
                lines.push_back(line);
        return lines;
    }

    static std::string staysInMemory(const std::filesystem::path& path)
    {
        return "The application \"" + path.native() +
               "\" is out of service; its code stays in memory until the session ends.\n";
    }
};

TEST_F(Unloading, SendsMessage2AndTakesTheLibraryOut)
{
    for (const char* name : {"Good.zmb", "Good.bundle"})
    {
        const auto path = fixture(name);
        load(path);
        output();
        EXPECT_TRUE(unload(path));
        EXPECT_EQ(output(), name + std::string(": message 2\n"));
        EXPECT_FALSE(isMapped(name == std::string("Good.zmb") ? path : path / "Good"));
    }
    EXPECT_EQ(names(), L"");
}

// Two paths of one application, whichever of them it was loaded by.
class UnloadingThroughLinks : public Unloading
{
protected:
    static std::wstring wide(const std::filesystem::path& path) { return tessel::toWide(path.native()); }

    // Copies the fixture, with a link to it, and loads it by one of the two.
    void loadLinked(const std::string& name, bool byLink)
    {
        real = fixture(name, "real/" + name);
        link = mFolder / ("link" + real.extension().native());
        std::filesystem::create_symlink(real, link);
        EXPECT_TRUE(load(byLink ? link : real));
        output();
    }

    // As every build does: another file at the same path.
    void replace() const
    {
        const auto next = mFolder / "next";
        std::filesystem::copy_file(real, next);
        std::filesystem::rename(next, real);
    }

    void expectKnownBy(const std::filesystem::path& path)
    {
        EXPECT_TRUE(mLinker.isModuleLoaded(wide(path).c_str()));
        EXPECT_TRUE(mLinker.isModuleLocked(wide(path).c_str()));
        EXPECT_FALSE(unload(path));
        EXPECT_EQ(output(), notUnloaded(path, "it is locked"));
        EXPECT_TRUE(load(path)) << "a second load";
        EXPECT_EQ(output(), "");
    }

    std::filesystem::path real;
    std::filesystem::path link;
};

TEST_F(UnloadingThroughLinks, AnswersForEitherPath)
{
    for (const bool byLink : {false, true})
    {
        loadLinked("LocksItself.zmb", byLink);
        expectKnownBy(real);
        expectKnownBy(link);
        mRunner.run(L"UNLOCK");
        EXPECT_FALSE(mLinker.isModuleLocked(wide(byLink ? real : link).c_str()));
        EXPECT_TRUE(unload(byLink ? real : link));
        EXPECT_EQ(names(), L"");
        std::filesystem::remove(link);
        std::filesystem::remove(real);
    }
}

TEST_F(UnloadingThroughLinks, AnswersForEitherPathOfABundle)
{
    for (const bool byLink : {false, true})
    {
        loadLinked("Good.bundle", byLink);
        EXPECT_TRUE(mLinker.isModuleLoaded(wide(byLink ? real : link).c_str()));
        EXPECT_TRUE(unload(byLink ? real : link));
        EXPECT_EQ(names(), L"");
        std::filesystem::remove(link);
        std::filesystem::remove_all(real);
    }
}

TEST_F(UnloadingThroughLinks, AnswersForEitherPathOfAFileThatWasReplaced)
{
    for (const bool byLink : {false, true})
    {
        loadLinked("LocksItself.zmb", byLink);
        replace();
        expectKnownBy(real);
        expectKnownBy(link);
        mRunner.run(L"UNLOCK");
        EXPECT_TRUE(unload(byLink ? real : link));
        EXPECT_EQ(names(), L"");
        std::filesystem::remove(link);
        std::filesystem::remove(real);
    }
}

// By none of these paths the file would be known after it was replaced, were it not for where they lead.
TEST_F(UnloadingThroughLinks, AnswersForAPathWithDetoursAndForALinkedFolder)
{
    const auto folder = mFolder / "real";
    std::filesystem::create_directory(folder);
    std::filesystem::create_directory_symlink(folder, mFolder / "linked");
    for (const char* detour : {"real//", "real/./", "real/../real/", "linked/"})
    {
        real = fixture("LocksItself.zmb", "real/LocksItself.zmb");
        const auto path = std::filesystem::path(mFolder / detour).native() + "LocksItself.zmb";
        EXPECT_TRUE(load(path)) << path;
        output();
        replace();
        expectKnownBy(real);
        expectKnownBy(path);
        mRunner.run(L"UNLOCK");
        EXPECT_TRUE(unload(real));
        EXPECT_EQ(names(), L"");
        std::filesystem::remove(real);
    }
}

TEST_F(Unloading, TakesTheCommandsAlong)
{
    const auto path = fixture("Command.zmb");
    load(path);
    EXPECT_TRUE(mRunner.run(L"pfad"));
    EXPECT_EQ(output(), "Command.zmb: message 1\n" + path.native() + "\n");
    EXPECT_TRUE(unload(path));
    EXPECT_TRUE(mCommands.names().empty());
}

TEST_F(Unloading, SaysThatNothingIsLoadedFromThePath)
{
    const auto path = fixture("Good.zmb");
    EXPECT_FALSE(unload(path));
    EXPECT_EQ(output(), notUnloaded(path, "it is not loaded"));
}

TEST_F(Unloading, KeepsAnApplicationThatAnswersAnErrorOrThrows)
{
    const std::pair<const char*, const char*> cases[] = {
        {"RefusesToUnload.omp", "its entry point answered 3"},
        {"ThrowsAtUnload.zmb", "its entry point threw an exception: the door is stuck"}};
    for (const auto& [name, whyNot] : cases)
    {
        const auto path = fixture(name);
        load(path);
        output();
        EXPECT_FALSE(unload(path));
        EXPECT_EQ(output(), name + std::string(": message 2\n") + notUnloaded(path, whyNot));
    }
    EXPECT_EQ(names(), L"RefusesToUnload.omp ThrowsAtUnload.zmb ");
}

TEST_F(Unloading, KeepsALockedApplicationUntilItAllowsIt)
{
    const auto path = fixture("LocksItself.zmb");
    const std::wstring widePath = tessel::toWide(path.native());
    EXPECT_FALSE(mLinker.isModuleLocked(widePath.c_str()));
    load(path);
    output();
    EXPECT_TRUE(mLinker.isModuleLocked(widePath.c_str()));
    EXPECT_TRUE(mLinker.loadedModules()[0].locked);
    EXPECT_FALSE(unload(path));
    EXPECT_EQ(output(), notUnloaded(path, "it is locked"));
    mRunner.run(L"UNLOCK");
    EXPECT_FALSE(mLinker.isModuleLocked(widePath.c_str()));
    EXPECT_TRUE(unload(path));
    EXPECT_EQ(output(), "LocksItself.zmb: message 2\n");
}

TEST_F(Unloading, KeepsAnApplicationWhileOneOfItsCommandsRuns)
{
    const auto path = fixture("Command.zmb");
    load(path);
    output();
    EXPECT_TRUE(mRunner.run(L"UNLOADMYSELF"));
    EXPECT_EQ(output(), notUnloaded(path, "it is at work") + "still here\n");
    EXPECT_EQ(names(), L"Command.zmb ");
}

TEST_F(Unloading, TakesOutOfServiceWhatTheSystemKeepsMapped)
{
    for (const char* name : {"StaysMapped.zmb", "Classes.bundle"})
    {
        const auto path = fixture(name);
        const auto program = name == std::string("StaysMapped.zmb") ? path : path / "Classes";
        load(path);
        output();
        EXPECT_TRUE(unload(path));
        EXPECT_EQ(output(), name + std::string(": message 2\n") + staysInMemory(path));
        EXPECT_TRUE(isMapped(program));
        EXPECT_EQ(names(), L"");
        EXPECT_FALSE(unload(path));
        EXPECT_EQ(output(), notUnloaded(path, "it is not loaded"));
    }
}

TEST_F(Unloading, TakesOutALibraryWhoseDynamicSectionCannotBeWritten)
{
    const auto library = fixture("ReadOnlyDynamic.zmb");
    EXPECT_TRUE(load(library));
    EXPECT_TRUE(unload(library));
    EXPECT_EQ(output(), "ReadOnlyDynamic.zmb: message 1\nReadOnlyDynamic.zmb: message 2\n");
    EXPECT_FALSE(isMapped(library));
}

TEST_F(Unloading, KeepsMappedWhatBringsClassesInALibraryWhoseDynamicSectionCannotBeWritten)
{
    const auto bundle = fixture("ReadOnlyDynamic.bundle");
    EXPECT_TRUE(load(bundle));
    output();
    EXPECT_TRUE(unload(bundle));
    EXPECT_EQ(output(), "ReadOnlyDynamic.bundle: message 2\n" + staysInMemory(bundle));
    EXPECT_TRUE(isMapped(bundle / "ReadOnlyDynamic"));
}

TEST_F(Unloading, PutsBackIntoServiceWhatStayedMappedWithoutMappingItAgain)
{
    for (const char* name : {"StaysMapped.zmb", "Classes.bundle"})
    {
        const auto path = fixture(name);
        const auto program = name == std::string("StaysMapped.zmb") ? path : path / "Classes";
        load(path);
        const std::string firstLoad = output();
        const auto mappings = mappingsOf(program);
        EXPECT_FALSE(mappings.empty());
        EXPECT_TRUE(unload(path));
        output();
        EXPECT_TRUE(load(path));
        EXPECT_EQ(output(), firstLoad);
        EXPECT_EQ(names(), tessel::toWide(name) + L" ");
        EXPECT_EQ(mappingsOf(program), mappings);
        EXPECT_TRUE(unload(path));
        output();
    }
}

TEST_F(Unloading, RefusesAnotherFileAtThePathOfWhatStayedMapped)
{
    for (const char* name : {"StaysMapped.zmb", "Classes.bundle"})
    {
        const auto path = fixture(name);
        const auto program = name == std::string("StaysMapped.zmb") ? path : path / "Classes";
        load(path);
        EXPECT_TRUE(unload(path));
        output();
        std::filesystem::copy_file(program, mFolder / "next");
        std::filesystem::rename(mFolder / "next", program);
        EXPECT_FALSE(load(path));
        EXPECT_EQ(output(),
                  notLoaded(path, "the code of another file is in memory in its place, until the session "
                                  "ends"));
        EXPECT_EQ(names(), L"");
    }
}

TEST_F(Unloading, LoadsAnotherFileAtThePathOfWhatWentOut)
{
    const auto path = fixture("Good.zmb");
    load(path);
    EXPECT_TRUE(unload(path));
    std::filesystem::copy_file(path, mFolder / "next");
    std::filesystem::rename(mFolder / "next", path);
    EXPECT_TRUE(load(path)) << output();
}

TEST_F(Unloading, SaysNothingOfWhatStaysMappedWhenNotAskedTo)
{
    const auto path = fixture("StaysMapped.zmb");
    load(path);
    output();
    EXPECT_TRUE(mLinker.unloadModule(tessel::toWide(path.native()).c_str(), false));
    EXPECT_EQ(output(), "StaysMapped.zmb: message 2\n");
}

TEST_F(Unloading, OfTwoModulesThatShareANameTakesTheOneAtThePath)
{
    const auto first = fixture("Command.zmb", "first/Command.zmb");
    const auto second = fixture("Good.zmb", "second/Command.zmb");
    EXPECT_TRUE(load(first));
    EXPECT_TRUE(load(second));
    EXPECT_TRUE(unload(second));
    EXPECT_TRUE(mLinker.isModuleLoaded(tessel::toWide(first.native()).c_str()));
    EXPECT_FALSE(mLinker.isModuleLoaded(tessel::toWide(second.native()).c_str()));
    EXPECT_FALSE(mCommands.names().empty());
    EXPECT_TRUE(load(second));
    EXPECT_TRUE(unload(first));
    EXPECT_TRUE(mCommands.names().empty());
    EXPECT_TRUE(mLinker.isModuleLoaded(tessel::toWide(second.native()).c_str()));
}

TEST_F(Unloading, EndsEverythingInReverseOrderWhenTheHostEnds)
{
    const auto locked = fixture("LocksItself.zmb");
    const auto refusing = fixture("RefusesToUnload.omp");
    for (const auto& path : {fixture("Good.zmb"), locked, refusing})
        load(path);
    output();
    mLinker.unloadAll();
    EXPECT_EQ(output(), "RefusesToUnload.omp: message 2\nThe application \"" + refusing.native() +
                            "\" did not end as it should: its entry point answered 3.\n"
                            "LocksItself.zmb: message 2\nGood.zmb: message 2\n");
    EXPECT_EQ(names(), L"");
    EXPECT_TRUE(isMapped(locked));
    EXPECT_FALSE(load(locked));
    EXPECT_EQ(output(), notLoaded(locked, "the host is ending"));
}

class LoadedModuleFunctions : public HostWithModules
{
};

TEST_F(LoadedModuleFunctions, GiveNoListWhenNothingIsLoaded)
{
    EXPECT_EQ(tsedQmbLoaded(), nullptr);
}

TEST_F(LoadedModuleFunctions, ListTheNamesInTheOrderOfLoading)
{
    load(fixture("Good.zmb"));
    load(fixture("Good.bundle"));
    TsResultBuffer* list = tsedQmbLoaded();
    ASSERT_NE(list, nullptr);
    EXPECT_EQ(list->type, TS_STRING);
    EXPECT_STREQ(list->value.string, L"Good.zmb");
    ASSERT_NE(list->next, nullptr);
    EXPECT_STREQ(list->next->value.string, L"Good.bundle");
    EXPECT_EQ(list->next->next, nullptr);
    tsutRelRb(list);
}

TEST_F(LoadedModuleFunctions, FindAPathByNameInAnyCaseAndTheFirstLoadedOfSeveral)
{
    const auto first = fixture("Good.zmb", "first/Größe.zmb");
    const auto second = fixture("Good.zmb", "second/größe.ZMB");
    load(first);
    load(second);
    wchar_t path[1024] = {};
    EXPECT_EQ(tsedGetModuleFileName(L"GRÖSSE.zmb", path, std::size(path)), 1);
    EXPECT_EQ(tsedGetModuleFileName(L"GRÖßE.ZMB", path, std::size(path)), 0);
    EXPECT_EQ(path, tessel::toWide(first.native()));
    unload(first);
    EXPECT_EQ(tsedGetModuleFileName(L"größe.zmb", path, std::size(path)), 0);
    EXPECT_EQ(path, tessel::toWide(second.native()));
}

TEST_F(LoadedModuleFunctions, LeaveTheBufferAloneWhenThePathDoesNotFit)
{
    const auto path = fixture("Good.zmb");
    load(path);
    std::wstring buffer(path.native().size(), L'?');
    EXPECT_NE(tsedGetModuleFileName(L"Good.zmb", buffer.data(), buffer.size()), 0);
    EXPECT_NE(tsedGetModuleFileName(L"Other.zmb", buffer.data(), buffer.size()), 0);
    EXPECT_EQ(buffer, std::wstring(path.native().size(), L'?'));
    buffer.resize(path.native().size() + 1);
    EXPECT_EQ(tsedGetModuleFileName(L"Good.zmb", buffer.data(), buffer.size()), 0);
}
