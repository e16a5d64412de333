#include "host/resources/ResourceModules.h"

#include <iterator>

#include <wincompat/winres.h>

#include "tests/host/support/HostWithModules.h"

using tessel::CallingApplication;
using tessel::toWide;

class ResourceModulesOfAHost : public HostWithModules
{
protected:
    std::filesystem::path texts(const std::filesystem::path& copy)
    {
        std::filesystem::create_directories((mFolder / copy).parent_path());
        std::filesystem::copy(TEXTS_DLL, mFolder / copy);
        return mFolder / copy;
    }
    HMODULE open(const std::filesystem::path& path) { return LoadLibrary(toWide(path.native()).c_str()); }
    static std::wstring text(HMODULE module, unsigned id)
    {
        wchar_t buffer[1024];
        const int length = loadStringFromWin32ResourceDLL(module, id, buffer, std::size(buffer));
        EXPECT_EQ(std::wstring(buffer).size(), static_cast<std::size_t>(length));
        return buffer;
    }
    static std::string notOpened(const std::string& name, const std::string& whyNot)
    {
        return "The resource module \"" + name + "\" cannot be opened: " + whyNot + ".\n";
    }
};

TEST_F(ResourceModulesOfAHost, OpenAFileByItsFullPathWithEitherSeparator)
{
    const auto path = texts("folder/Texts.dll");
    const HMODULE module = open(path);
    EXPECT_EQ(text(module, 15), L"Größe, çà, Ελλάδα");
    EXPECT_EQ(LoadLibrary((toWide((mFolder / "folder").native()) + L"\\Texts.dll").c_str()), module);
    EXPECT_EQ(output(), "");
}

TEST_F(ResourceModulesOfAHost, LookInTheCallingBundleFirstAndThenInTheHost)
{
    texts("App.bundle/Resources/Own.dll");
    texts("App.bundle/Resources/en-us/Own.dll");
    texts("HostResources/Common.dll");
    const CallingApplication::Scope calling(mCalls, toWide((mFolder / "App.bundle").native()));
    EXPECT_NE(LoadLibrary(L"Own.dll"), nullptr);
    EXPECT_NE(LoadLibrary(L"en-us\\Own.dll"), LoadLibrary(L"Own.dll"));
    EXPECT_NE(LoadLibrary(L"Common.dll"), nullptr);
    EXPECT_EQ(output(), "");
}

TEST_F(ResourceModulesOfAHost, LookInTheFolderOfAPlainLibrary)
{
    texts("apps/Own.dll");
    const CallingApplication::Scope calling(mCalls, toWide((mFolder / "apps" / "App.zmb").native()));
    EXPECT_NE(LoadLibrary(L"Own.dll"), nullptr);
    EXPECT_EQ(output(), "");
}

TEST_F(ResourceModulesOfAHost, LookInTheHostAloneOutsideOfACall)
{
    texts("HostResources/Common.dll");
    EXPECT_NE(LoadLibrary(L"Common.dll"), nullptr);
    EXPECT_EQ(LoadLibrary(L"Own.dll"), nullptr);
    EXPECT_EQ(output(), notOpened("Own.dll", "there is no \"" +
                                                 (mFolder / "HostResources" / "Own.dll").native() + "\""));
}

TEST_F(ResourceModulesOfAHost, SayOnceWhereTheyHaveLooked)
{
    std::filesystem::create_directories(mFolder / "App.bundle" / "Resources");
    const CallingApplication::Scope calling(mCalls, toWide((mFolder / "App.bundle").native()));
    EXPECT_EQ(LoadLibrary(L"en-us\\X.dll"), nullptr);
    EXPECT_EQ(output(),
              notOpened("en-us/X.dll", "there is no \"" + mFolder.path().native() +
                                           "/App.bundle/Resources/en-us/X.dll\" and no \"" +
                                           mFolder.path().native() + "/HostResources/en-us/X.dll\""));
}

TEST_F(ResourceModulesOfAHost, SayWhyAFileIsNotSound)
{
    std::filesystem::create_directory(mFolder / "folder.dll");
    const auto cut = texts("cut.dll");
    std::filesystem::resize_file(cut, 900);
    const std::pair<std::filesystem::path, const char*> cases[] = {
        {mFolder / "folder.dll", "it is a folder, not a file"},
        {mFolder.write("empty.dll", ""), "the file is empty"},
        {mFolder.write("text.dll", std::string(200, 'x')), "it is not a Windows library"},
        {cut, "the file is cut short"}};
    for (const auto& [path, whyNot] : cases)
    {
        EXPECT_EQ(open(path), nullptr);
        EXPECT_EQ(output(), notOpened(path.native(), whyNot));
    }
    EXPECT_EQ(LoadLibrary(nullptr), nullptr);
    EXPECT_EQ(output(), notOpened("", "it has no name"));
}

TEST_F(ResourceModulesOfAHost, NeverTakeTheHostsFileInPlaceOfABrokenOneOfTheApplication)
{
    texts("HostResources/Texts.dll");
    const auto broken = mFolder.write("App.bundle/Resources/Texts.dll", "broken");
    const CallingApplication::Scope calling(mCalls, toWide((mFolder / "App.bundle").native()));
    EXPECT_EQ(LoadLibrary(L"Texts.dll"), nullptr);
    EXPECT_EQ(output(), notOpened(broken.native(), "it is not a Windows library"));
}

TEST_F(ResourceModulesOfAHost, StayOpenUntilEveryOpeningIsUndone)
{
    const auto path = texts("Texts.dll");
    const HMODULE module = open(path);
    EXPECT_EQ(open(path), module);
    EXPECT_NE(FreeLibrary(module), 0);
    EXPECT_EQ(text(module, 65535), L"the last");
    EXPECT_NE(FreeLibrary(module), 0);
    EXPECT_EQ(text(module, 65535), L"");
    EXPECT_EQ(FreeLibrary(module), 0);
    EXPECT_NE(open(path), module);
}

TEST_F(ResourceModulesOfAHost, KnowNothingOfAHandleThatTheyDidNotGiveOut)
{
    int something = 0;
    const auto wild = reinterpret_cast<HMODULE>(&something);
    EXPECT_EQ(FreeLibrary(wild), 0);
    EXPECT_EQ(FreeLibrary(nullptr), 0);
    EXPECT_EQ(text(wild, 1), L"");
}

TEST_F(ResourceModulesOfAHost, TakeTheCurrentModuleWhenNoneIsNamed)
{
    EXPECT_EQ(AfxGetResourceHandle(), nullptr);
    EXPECT_EQ(text(nullptr, 1), L"");
    const HMODULE module = open(texts("Texts.dll"));
    AfxSetResourceHandle(module);
    EXPECT_EQ(AfxGetResourceHandle(), module);
    EXPECT_EQ(text(nullptr, 16), L"漢字とかな");
    FreeLibrary(module);
    EXPECT_EQ(text(nullptr, 16), L"");
}

TEST_F(ResourceModulesOfAHost, CutATextToTheBufferAndCountOneCharacterForAnEmoji)
{
    const HMODULE module = open(texts("Texts.dll"));
    wchar_t buffer[8] = L"???????";
    EXPECT_EQ(loadStringFromWin32ResourceDLL(module, 51, buffer, 3), 2);
    EXPECT_STREQ(buffer, L"\U0001F600 ");
    EXPECT_EQ(loadStringFromWin32ResourceDLL(module, 51, buffer, 1), 0);
    EXPECT_STREQ(buffer, L"");
    EXPECT_EQ(loadStringFromWin32ResourceDLL(module, 51, buffer, 0), 0);
    EXPECT_EQ(loadStringFromWin32ResourceDLL(module, 51, nullptr, 8), 0);
    buffer[0] = L'?';
    EXPECT_EQ(loadStringFromWin32ResourceDLL(module, 3, buffer, 8), 0);
    EXPECT_STREQ(buffer, L"");
}

// The person's are those of Austria and German of any country; the module has that of Germany.
TEST_F(ResourceModulesOfAHost, AnswerInThePersonsLanguageAndElseInTheFirstOfTheModule)
{
    const HMODULE module = open(texts("Texts.dll"));
    EXPECT_EQ(text(module, 1), L"Anwendungen laden/entladen");
    EXPECT_EQ(text(module, 2), L"%s \"quoted\" 100%% \\ tab\there"); // beside German ones
    EXPECT_EQ(text(module, 16), L"漢字とかな");
    EXPECT_EQ(text(module, 4), L"Bereit.");
    EXPECT_EQ(text(module, 5), L"Délier"); // nobody wants French, but there is nothing else
    EXPECT_EQ(text(module, 6), L"");
}

TEST_F(ResourceModulesOfAHost, AnswerInTheFirstLanguageOfTheModuleWhereThePersonNamesNone)
{
    const auto path = texts("Texts.dll");
    tessel::ResourceModules resources(L"", mCalls, {});
    const auto module = resources.open(toWide(path.native()).c_str());
    ASSERT_TRUE(module);
    EXPECT_EQ(resources.string(*module, 1), L"Load/Unload Applications");
    EXPECT_EQ(resources.string(*module, 4), L"Bereit."); // German stands before French in the file
    EXPECT_EQ(resources.string(*module, 40), L"Nur auf Deutsch");
}
