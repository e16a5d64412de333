#include "modrig/messages/ResourceOverride.h"

#include <type_traits>

#include "tests/support/ModuleTest.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class ResourceOverride : public ModuleTest
{
protected:
    void SetUp() override
    {
        ModuleTest::SetUp();
        host().resources.addModule(L"other.dll", {});
        mModule = host().resources.load(kResourceModuleName);
        mOther = host().resources.load(L"other.dll");
        host().resources.current = mOther;
    }

    HMODULE mModule = nullptr;
    HMODULE mOther = nullptr;
};

bool SetDefaultResource(long language)
{
    return CTemporaryResourceOverride::SetDefaultResource(language, kResourceModuleName);
}
} // namespace

TEST_F(ResourceOverride, InstallsTheModuleAndRestoresThePreviousOne)
{
    {
        const CTemporaryResourceOverride texts(mModule);
        EXPECT_EQ(mModule, host().resources.current);
    }
    EXPECT_EQ(mOther, host().resources.current);
    EXPECT_THAT(host().resources.madeCurrent, ElementsAre(mModule, mOther));
}

TEST_F(ResourceOverride, RestoresThatThereWasNone)
{
    host().resources.current = nullptr;
    {
        const CTemporaryResourceOverride texts(mModule);
    }
    EXPECT_EQ(nullptr, host().resources.current);
}

TEST_F(ResourceOverride, LeavesEverythingAsItIsForANullHandle)
{
    {
        const CTemporaryResourceOverride texts(nullptr);
    }
    EXPECT_EQ(mOther, host().resources.current);
    EXPECT_THAT(host().journal.entries(), IsEmpty());
}

TEST_F(ResourceOverride, LeavesAloneWhatSomebodyElseChangesWhileItHoldsANullHandle)
{
    {
        const CTemporaryResourceOverride texts(nullptr);
        host().resources.current = mModule;
    }
    EXPECT_EQ(mModule, host().resources.current);
    EXPECT_THAT(host().journal.entries(), IsEmpty());
}

TEST_F(ResourceOverride, HasOneFieldTheHandleBefore)
{
    struct WithOneHandle
    {
        virtual ~WithOneHandle() = default;
        HINSTANCE before;
    };
    EXPECT_EQ(sizeof(WithOneHandle), sizeof(CTemporaryResourceOverride));
}

TEST_F(ResourceOverride, SetsNothingWhenTheModuleIsCurrentAlready)
{
    {
        const CTemporaryResourceOverride texts(mOther);
    }
    EXPECT_THAT(host().resources.madeCurrent, IsEmpty());
}

TEST_F(ResourceOverride, RestoresAlsoWhatSomebodyElseChangedMeanwhile)
{
    {
        const CTemporaryResourceOverride texts(mOther);
        host().resources.current = mModule;
    }
    EXPECT_EQ(mOther, host().resources.current);
}

TEST_F(ResourceOverride, Nests)
{
    {
        const CTemporaryResourceOverride outer(mModule);
        {
            const CTemporaryResourceOverride inner(mOther);
            EXPECT_EQ(mOther, host().resources.current);
        }
        EXPECT_EQ(mModule, host().resources.current);
    }
    EXPECT_EQ(mOther, host().resources.current);
}

TEST_F(ResourceOverride, HasAVirtualDestructorAndIsNotCopied)
{
    EXPECT_TRUE(std::has_virtual_destructor_v<CTemporaryResourceOverride>);
    EXPECT_FALSE(std::is_copy_constructible_v<CTemporaryResourceOverride>);
}

TEST_F(ResourceOverride, LoadsTheModuleUnderItsNameAloneWithoutALanguage)
{
    EXPECT_TRUE(SetDefaultResource(0));
    EXPECT_THAT(host().resources.requested, ElementsAre(kResourceModuleName));
    EXPECT_EQ(kResourceModuleName, host().resources.nameOf(CTemporaryResourceOverride::m_hInstanceDefault));
    EXPECT_THAT(host().resources.madeCurrent, IsEmpty()) << "loading makes nothing current";
}

TEST_F(ResourceOverride, LooksIntoTheEnglishFolderFirstWhateverTheLanguage)
{
    const std::wstring english = std::wstring(L"en-us\\") + kResourceModuleName;
    host().resources.addModule(english, {});
    for (const long language : {1033L, 1031L, -1L})
    {
        host().resources.requested.clear();
        EXPECT_TRUE(SetDefaultResource(language));
        EXPECT_THAT(host().resources.requested, ElementsAre(english));
        CTemporaryResourceOverride::ReleaseDefaultResource();
    }
}

TEST_F(ResourceOverride, FallsBackToTheNameAloneWhenTheEnglishFolderHasNoModule)
{
    EXPECT_TRUE(SetDefaultResource(1033));
    EXPECT_THAT(host().resources.requested,
                ElementsAre(std::wstring(L"en-us\\") + kResourceModuleName, kResourceModuleName));
}

TEST_F(ResourceOverride, AnswersFalseWhenThereIsNoModule)
{
    host().resources.removeModule(kResourceModuleName);
    EXPECT_FALSE(SetDefaultResource(0));
    EXPECT_FALSE(SetDefaultResource(1033));
    EXPECT_EQ(nullptr, CTemporaryResourceOverride::m_hInstanceDefault);
}

TEST_F(ResourceOverride, LoadsTheModuleExactlyOnce)
{
    EXPECT_TRUE(SetDefaultResource(0));
    const HINSTANCE loaded = CTemporaryResourceOverride::m_hInstanceDefault;
    host().journal.clear();
    EXPECT_FALSE(SetDefaultResource(0));
    EXPECT_FALSE(SetDefaultResource(1033));
    EXPECT_THAT(host().journal.entries(), IsEmpty());
    EXPECT_EQ(loaded, CTemporaryResourceOverride::m_hInstanceDefault);
}

TEST_F(ResourceOverride, GivesTheModuleBackOnce)
{
    SetDefaultResource(0);
    const HINSTANCE loaded = CTemporaryResourceOverride::m_hInstanceDefault;
    CTemporaryResourceOverride::ReleaseDefaultResource();
    CTemporaryResourceOverride::ReleaseDefaultResource();
    EXPECT_THAT(host().resources.freed, ElementsAre(loaded));
    EXPECT_EQ(nullptr, CTemporaryResourceOverride::m_hInstanceDefault);
}
