#include "modrig/types/FileFilters.h"

#include "modrig/messages/MessageIds.h"
#include "tests/support/ModuleTest.h"

using namespace ModrigUtils;
using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
constexpr const wchar_t* kFirst = L"R21 Tessel|*.bundle;*.LSP|";
constexpr const wchar_t* kBundles = L"Bundles|*.bundle|";

class FileFilters : public ModuleTest
{
protected:
    static std::wstring Readjusted()
    {
        CStdStr filter(L"what the caller had");
        ReAdjustFilterString(filter);
        return filter.Text();
    }
    static void SetText(unsigned id, const wchar_t* text)
    {
        host().resources.setText(kResourceModuleName, id, text);
    }
    static void Choose(const wchar_t* filter)
    {
        host().registry.setValue(host().moduleKey(), L"FileFilter", filter);
    }
};
} // namespace

TEST_F(FileFilters, ArePanelsFiltersForAllKindsAndForFiveOfThem)
{
    const std::vector<const char*> names = FileFilterKeys();
    EXPECT_THAT(std::vector<std::string>(names.begin(), names.end()),
                ElementsAre("IDS_MODRIG_TESSEL_APPS", "IDS_MODRIG_QMB_APPS", "IDS_MODRIG_ZMB_APPS",
                            "IDS_MODRIG_LSP_APPS", "IDS_MODRIG_OMP_APPS", "IDS_MODRIG_QBC_APPS"));
}

TEST_F(FileFilters, RememberExactlyTheTextThatWasChosen)
{
    for (const wchar_t* choice : {L"Lisp source (*.lsp)", L" 100%s \\ \"ä\" ", L"x"})
    {
        EXPECT_TRUE(SetRegFileFilterListIndex(choice));
        EXPECT_EQ(choice, GetRegFileFilterListIndex().Text());
    }
    EXPECT_EQ(L"x", host().registry.value(host().moduleKey(), L"FileFilter"));
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(FileFilters, RememberNothingAtFirst)
{
    EXPECT_TRUE(GetRegFileFilterListIndex().IsEmpty());
    EXPECT_THAT(boxes(), IsEmpty());
}

TEST_F(FileFilters, ForgetAChoiceThatIsTooLongToBeRead)
{
    Choose(std::wstring(1024, L'x').c_str());
    EXPECT_TRUE(GetRegFileFilterListIndex().IsEmpty());
}

TEST_F(FileFilters, ReportAChoiceThatCannotBeStored)
{
    host().registry.failAfter(RecordingRegistry::Operation::kWrite, 0);
    EXPECT_FALSE(SetRegFileFilterListIndex(L"Bundles"));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kFilterNotStored, L"%s")))
        << "the text as it stands, without an argument";
}

TEST_F(FileFilters, ReportAChoiceWhoseKeyCannotBeOpened)
{
    host().registry.failAfter(RecordingRegistry::Operation::kCreate, 0);
    EXPECT_FALSE(SetRegFileFilterListIndex(L"Bundles"));
    EXPECT_THAT(boxes(), ElementsAre(Message(ModrigMessages::kFilterNotStored, L"%s")));
}

TEST_F(FileFilters, PutTheReleaseAndTheHostsNameIntoTheFirstDescription)
{
    host().applicationServices.productName = L"Tessel 100%s";
    EXPECT_EQ(std::wstring(L"R21 Tessel 100%s|*.bundle;*.LSP|") + kBundles, Readjusted());
}

TEST_F(FileFilters, KeepOnlyPatternsOfApplications)
{
    SetText(ModrigMessages::kBundleFilter, L"Some|*.exe;*.zmb;*.*;*.OMP;*.dll");
    EXPECT_EQ(std::wstring(kFirst) + L"Some|*.zmb;*.OMP|", Readjusted());
}

TEST_F(FileFilters, KeepThePlaceAndTheDescriptionOfAnEntryWithoutAnyPatternLeft)
{
    SetText(ModrigMessages::kBundleFilter, L"Programs|*.exe;*.dll");
    SetText(ModrigMessages::kCoreModuleFilter, L"No patterns|");
    SetText(ModrigMessages::kLispSourceFilter, L"No bar");
    SetText(ModrigMessages::kObjectModuleFilter, L"Objects|*.omp");
    EXPECT_EQ(std::wstring(kFirst) + L"Programs||No patterns||No bar||Objects|*.omp|", Readjusted());
}

TEST_F(FileFilters, PutAChosenEntryFirstAlsoWithoutAnyPatternLeft)
{
    SetText(ModrigMessages::kBundleFilter, L"Programs|*.exe");
    Choose(L"Programs");
    EXPECT_EQ(std::wstring(L"Programs||") + kFirst, Readjusted());
}

TEST_F(FileFilters, DropEmptyEntriesOnly)
{
    SetText(ModrigMessages::kBundleFilter, L"");
    SetText(ModrigMessages::kCoreModuleFilter, L"|");
    SetText(ModrigMessages::kLispSourceFilter, L"|*.lsp");
    EXPECT_EQ(std::wstring(kFirst) + L"|||*.lsp|", Readjusted());
}

TEST_F(FileFilters, AreInTheOrderOfTheTableWhenNothingWasChosenAlsoWithAnEntryThatDescribesNothing)
{
    SetText(ModrigMessages::kBundleFilter, L"|*.bundle");
    for (const bool chosen : {false, true})
    {
        if (chosen)
            Choose(L"");
        EXPECT_EQ(std::wstring(kFirst) + L"|*.bundle|", Readjusted());
    }
}

TEST_F(FileFilters, EndTheDescriptionAtTheFirstBar)
{
    SetText(ModrigMessages::kBundleFilter, L"Bundles|*.bundle;*.zmb|*.lsp");
    EXPECT_EQ(std::wstring(kFirst) + kBundles, Readjusted()) << "no kind is called \"zmb|*.lsp\"";
    Choose(L"Bundles");
    EXPECT_EQ(std::wstring(kBundles) + kFirst, Readjusted());
}

TEST_F(FileFilters, FollowTheOrderOfTheTableAndNotOfTheNumbers)
{
    for (const unsigned id : {26u, 27u, 28u, 29u, 46u, 47u, 51u})
        SetText(id, (std::to_wstring(id) + L"|*.lsp").c_str());
    EXPECT_EQ(std::wstring(kFirst) + L"26|*.lsp|51|*.lsp|27|*.lsp|28|*.lsp|29|*.lsp|46|*.lsp|47|*.lsp|",
              Readjusted());
}

TEST_F(FileFilters, PutTheRememberedChoiceFirstAndKeepTheOrderOfTheOthers)
{
    SetText(ModrigMessages::kCoreModuleFilter, L"Core|*.zmb");
    SetText(ModrigMessages::kLispSourceFilter, L"Lisp|*.lsp");
    Choose(L"CORE");
    EXPECT_EQ(std::wstring(L"Core|*.zmb|") + kFirst + kBundles + L"Lisp|*.lsp|", Readjusted());
}

TEST_F(FileFilters, CompareTheChoiceWithTheWholeDescription)
{
    Choose(L"Bundle");
    EXPECT_EQ(std::wstring(kFirst) + kBundles, Readjusted());
    Choose(L"Bundles|*.bundle");
    EXPECT_EQ(std::wstring(kFirst) + kBundles, Readjusted());
    Choose(L"bundles");
    EXPECT_EQ(std::wstring(kBundles) + kFirst, Readjusted());
}

TEST_F(FileFilters, LookUpNoPatternTwice)
{
    SetText(ModrigMessages::kBundleFilter, L"Some|;;*.lsp;;zmb;");
    EXPECT_EQ(std::wstring(kFirst) + L"Some|*.lsp;zmb|", Readjusted());
}

TEST_F(FileFilters, AreEmptyWithoutTexts)
{
    host().resources.addModule(kResourceModuleName, {});
    EXPECT_EQ(L"", Readjusted());
}

TEST_F(FileFilters, DoWithoutTheHostsServices)
{
    host().applicationServices.exist = false;
    EXPECT_EQ(std::wstring(L"R21 |*.bundle;*.LSP|") + kBundles, Readjusted());
}
