#include <wincompat/winres.h>

#include "tests/contract/ContractTest.h"

namespace
{
constexpr int kBufferSize = 64;

class ResourcesContract : public ContractTest
{
protected:
    ~ResourcesContract() override { AfxSetResourceHandle(nullptr); }

    static std::wstring text(HMODULE module, unsigned id)
    {
        wchar_t buffer[kBufferSize] = L"before";
        const int length = loadStringFromWin32ResourceDLL(module, id, buffer, kBufferSize);
        EXPECT_EQ(static_cast<std::size_t>(length), std::wcslen(buffer));
        return buffer;
    }
};

TEST_F(ResourcesContract, FindsTextsByTheirIds)
{
    const std::wstring path =
        host->makeResourceModule(L"Texts.dll", {{1, L"one"}, {16, L"MODRIG"}, {48, L"%s is loaded."}});
    const HMODULE module = LoadLibrary(path.c_str());
    ASSERT_NE(module, nullptr);
    EXPECT_EQ(text(module, 1), L"one");
    EXPECT_EQ(text(module, 16), L"MODRIG");
    EXPECT_EQ(text(module, 48), L"%s is loaded.");
    EXPECT_NE(FreeLibrary(module), 0);
}

TEST_F(ResourcesContract, GivesAnEmptyTextForAnIdThatIsMissing)
{
    const HMODULE module = LoadLibrary(host->makeResourceModule(L"Texts.dll", {{16, L"sixteen"}}).c_str());
    ASSERT_NE(module, nullptr);
    EXPECT_EQ(text(module, 17), L"");   // beside the other
    EXPECT_EQ(text(module, 1000), L""); // where no text is near
    EXPECT_NE(FreeLibrary(module), 0);
}

TEST_F(ResourcesContract, TakesWhatALanguageLacksFromTheNextOneOfTheModule)
{
    const HMODULE module =
        LoadLibrary(host->makeTranslatedModule(L"Texts.dll",
                                               {{{1, L"one"}}, {{1, L"ein"}, {2, L"twee"}}, {{40, L"amane"}}})
                        .c_str());
    ASSERT_NE(module, nullptr);
    EXPECT_EQ(text(module, 1), L"one");
    EXPECT_EQ(text(module, 2), L"twee");   // beside one in the first language
    EXPECT_EQ(text(module, 40), L"amane"); // where the others have no text
    EXPECT_EQ(text(module, 3), L"");
    EXPECT_NE(FreeLibrary(module), 0);
}

TEST_F(ResourcesContract, GivesOneCharacterForOneOfAnotherPlane)
{
    const HMODULE module =
        LoadLibrary(host->makeResourceModule(L"Texts.dll", {{5, L"\u00FC \u4E2D \U0001F600!"}}).c_str());
    ASSERT_NE(module, nullptr);
    EXPECT_EQ(text(module, 5), L"\u00FC \u4E2D \U0001F600!");
    EXPECT_NE(FreeLibrary(module), 0);
}

TEST_F(ResourcesContract, CutsTextToTheBuffer)
{
    const HMODULE module = LoadLibrary(host->makeResourceModule(L"Texts.dll", {{5, L"abcdef"}}).c_str());
    ASSERT_NE(module, nullptr);
    wchar_t buffer[8] = L"???????";
    EXPECT_EQ(loadStringFromWin32ResourceDLL(module, 5, buffer, 4), 3);
    EXPECT_STREQ(buffer, L"abc");
    EXPECT_EQ(buffer[4], L'?');
    EXPECT_EQ(loadStringFromWin32ResourceDLL(module, 5, buffer, 1), 0);
    EXPECT_STREQ(buffer, L"");
    EXPECT_NE(FreeLibrary(module), 0);
}

TEST_F(ResourcesContract, LooksInTheCurrentModuleWhenNoneIsNamed)
{
    const HMODULE first = LoadLibrary(host->makeResourceModule(L"First.dll", {{1, L"first"}}).c_str());
    const HMODULE second = LoadLibrary(host->makeResourceModule(L"Second.dll", {{1, L"second"}}).c_str());
    EXPECT_EQ(AfxGetResourceHandle(), nullptr);
    EXPECT_EQ(text(nullptr, 1), L"");
    AfxSetResourceHandle(first);
    EXPECT_EQ(AfxGetResourceHandle(), first);
    EXPECT_EQ(text(nullptr, 1), L"first");
    EXPECT_EQ(text(second, 1), L"second");
    AfxSetResourceHandle(second);
    EXPECT_EQ(text(nullptr, 1), L"second");
    EXPECT_NE(FreeLibrary(first), 0);
    EXPECT_NE(FreeLibrary(second), 0);
}

TEST_F(ResourcesContract, TakesBothSeparators)
{
    host->makeFolder(L"folder");
    std::wstring path = host->makeResourceModule(L"folder/Texts.dll", {{1, L"one"}});
    path[path.rfind(L'/')] = L'\\';
    const HMODULE module = LoadLibrary(path.c_str());
    ASSERT_NE(module, nullptr);
    EXPECT_EQ(text(module, 1), L"one");
    EXPECT_NE(FreeLibrary(module), 0);
}

TEST_F(ResourcesContract, SaysWhichModuleIsMissing)
{
    const std::wstring path = host->makeFolder(L"folder") + L"/None.dll";
    EXPECT_EQ(LoadLibrary(path.c_str()), nullptr);
    EXPECT_TRUE(contains(host->seen(), path));
}

TEST_F(ResourcesContract, KeepsAModuleOpenUntilItsLastHandleIsFreed)
{
    const std::wstring path = host->makeResourceModule(L"Texts.dll", {{1, L"one"}});
    const HMODULE first = LoadLibrary(path.c_str());
    const HMODULE second = LoadLibrary(path.c_str());
    EXPECT_NE(FreeLibrary(first), 0);
    EXPECT_EQ(text(second, 1), L"one");
    EXPECT_NE(FreeLibrary(second), 0);
    EXPECT_EQ(FreeLibrary(second), 0);
    EXPECT_EQ(FreeLibrary(first), 0);
}

TEST_F(ResourcesContract, FreesNothingForAHandleThatIsNotOpen)
{
    EXPECT_EQ(FreeLibrary(nullptr), 0);
}
} // namespace
