// The list of loaded applications and unloading, with modules that the real host loads, locks and unloads.
#include "tests/integration/ModrigInHost.h"

#include <gmock/gmock.h>

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
using Places = std::vector<std::size_t>;

class Unloading : public ModrigInHost
{
protected:
    Unloading() { said(); }

    // Types LOAD, as somebody does who does not know of the dialog.
    std::wstring loadOutside(const std::filesystem::path& path)
    {
        EXPECT_TRUE(type(L"LOAD \"" + wide(path) + L"\"")) << said();
        said();
        return wide(path);
    }

    std::vector<std::wstring> listed()
    {
        dialog(ModrigUnderTest::populate);
        return ModrigUnderTest::loaded();
    }

    Places unload(const ModrigUnderTest::Paths& selection)
    {
        Places places;
        dialog([&] { places = ModrigUnderTest::unload(selection); });
        return places;
    }

    const std::filesystem::path zmb = module("Good.zmb");
    const std::filesystem::path omp = module("Good.omp");
    const std::filesystem::path locked = module("LocksItself.zmb");
};
} // namespace

TEST_F(Unloading, ListsWhatIsLoadedOutsideButNeverModrigItself)
{
    EXPECT_THAT(listed(), IsEmpty());
    const std::wstring first = loadOutside(omp);
    const std::wstring second = loadOutside(module("Good.bundle"));
    const std::wstring lisp = loadOutside(folder.write("a.lsp", "(list 1)\n"));
    EXPECT_THAT(listed(), ElementsAre(first, second, lisp));
    EXPECT_EQ(said(), "");
}

TEST_F(Unloading, DropsFromTheListWhatIsUnloadedOutside)
{
    const std::wstring first = loadOutside(zmb);
    const std::wstring second = loadOutside(omp);
    ASSERT_THAT(listed(), ElementsAre(first, second));
    ASSERT_TRUE(type(L"UNLOAD \"" + first + L"\""));
    EXPECT_THAT(listed(), ElementsAre(second));
}

TEST_F(Unloading, ListsNothingTwice)
{
    const std::wstring path = wide(zmb);
    dialog([&] { ModrigUnderTest::load(path, false, false); });
    EXPECT_THAT(listed(), ElementsAre(path));
    EXPECT_THAT(listed(), ElementsAre(path));
}

TEST_F(Unloading, OfOneModuleNamesIt)
{
    const std::wstring path = loadOutside(zmb);
    listed();
    EXPECT_EQ(unload({path}), Places{0});
    EXPECT_EQ(said(), "Good.zmb: message 2\nGood.zmb was unloaded.\n");
    EXPECT_THAT(ModrigUnderTest::messageLine(), ElementsAre(L"Good.zmb was unloaded."));
    EXPECT_THAT(ModrigUnderTest::loaded(), IsEmpty());
    ASSERT_TRUE(type(L"APPS"));
    EXPECT_EQ(said().find("Good.zmb"), std::string::npos);
}

TEST_F(Unloading, OfTwoModulesTellsTheirNumber)
{
    const std::wstring first = loadOutside(zmb);
    const std::wstring second = loadOutside(omp);
    listed();
    EXPECT_EQ(unload({first, second}), (Places{0, 1}));
    EXPECT_EQ(said(), "Good.zmb: message 2\nGood.omp: message 2\n2 applications were unloaded.\n");
    EXPECT_THAT(ModrigUnderTest::loaded(), IsEmpty());
}

TEST_F(Unloading, LeavesAModuleThatWasLockedWhenItWasListed)
{
    const std::wstring path = loadOutside(locked);
    listed();
    EXPECT_EQ(unload({path}), Places{});
    EXPECT_EQ(said(), "");
    EXPECT_THAT(listed(), ElementsAre(path));
}

TEST_F(Unloading, NamesAModuleThatHasBecomeLocked)
{
    const std::wstring path = loadOutside(locked);
    listed();
    dialog([&] { EXPECT_EQ(ModrigUnderTest::unloadAsListedUnloadable({path}), Places{}); });
    EXPECT_EQ(said(), "LocksItself.zmb is locked and cannot be unloaded.\n");
    EXPECT_THAT(ModrigUnderTest::messageLine(),
                ElementsAre(L"LocksItself.zmb is locked and cannot be unloaded."));
    EXPECT_THAT(listed(), ElementsAre(path));
}

TEST_F(Unloading, EndsWithTheNameOfTheLastOneTried)
{
    const std::wstring free = loadOutside(zmb);
    const std::wstring notFree = loadOutside(locked);
    listed();
    dialog([&] { EXPECT_EQ(ModrigUnderTest::unloadAsListedUnloadable({free, notFree}), Places{0}); });
    EXPECT_EQ(said(), "Good.zmb: message 2\nLocksItself.zmb is locked and cannot be unloaded.\n"
                      "LocksItself.zmb was unloaded.\n");
    EXPECT_THAT(listed(), ElementsAre(notFree));
}

TEST_F(Unloading, IsDoneWhenTheLockIsGone)
{
    const std::wstring path = loadOutside(locked);
    listed();
    ASSERT_TRUE(type(L"UNLOCK"));
    EXPECT_EQ(unload({path}), Places{0});
    EXPECT_EQ(said(), "LocksItself.zmb: message 2\nLocksItself.zmb was unloaded.\n");
}

TEST_F(Unloading, LeavesAModuleThatRefusesToLeave)
{
    const std::wstring path = loadOutside(module("RefusesToUnload.omp"));
    listed();
    EXPECT_EQ(unload({path}), Places{});
    EXPECT_EQ(said(), "RefusesToUnload.omp: message 2\nThe application \"" +
                          module("RefusesToUnload.omp").string() +
                          "\" is not unloaded: its entry point answered 3.\n");
    EXPECT_THAT(listed(), ElementsAre(path));
}

TEST_F(Unloading, NeverTouchesALispFile)
{
    const std::wstring file = loadOutside(folder.write("a.lsp", "(list 1)\n"));
    listed();
    dialog([&] { EXPECT_FALSE(ModrigUnderTest::mayBeUnloaded(file)); });
    EXPECT_EQ(unload({file}), Places{});
    EXPECT_EQ(said(), "");
    EXPECT_THAT(ModrigUnderTest::loaded(), ElementsAre(file));
}

TEST_F(Unloading, LetsAModuleBeLoadedAgain)
{
    const std::wstring path = wide(zmb);
    for (int round = 0; round < 3; ++round)
    {
        dialog([&] { EXPECT_EQ(ModrigUnderTest::load(path, false, false), 1); });
        EXPECT_EQ(said(), "Good.zmb: message 1\n");
        EXPECT_EQ(unload({path}), Places{0});
        EXPECT_EQ(said(), "Good.zmb: message 2\nGood.zmb was unloaded.\n");
    }
}

TEST_F(Unloading, KnowsWhatTheHostHasLoadedByItsName)
{
    loadOutside(zmb);
    dialog(
        []
        {
            EXPECT_TRUE(ModrigUnderTest::isLoaded(L"/elsewhere/GOOD.ZMB"));
            EXPECT_FALSE(ModrigUnderTest::isLoaded(L"/elsewhere/Good.omp"));
            EXPECT_TRUE(ModrigUnderTest::isLoaded(L"/elsewhere/never loaded.lsp"));
        });
    EXPECT_EQ(said(), "");
}
