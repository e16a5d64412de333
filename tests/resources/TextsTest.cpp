#include <gmock/gmock.h>

#include <algorithm>
#include <regex>
#include <set>

#include <tessel/tsformat.h>

#include "modrig/lists/Globals.h"
#include "modrig/messages/MessageIds.h"
#include "modrig/types/ApplicationTypes.h"
#include "tests/resources/ResourceTexts.h"
#include "tests/resources/SourceText.h"

namespace
{
using namespace ModrigMessages;
using Placeholders = std::vector<std::wstring>;

struct Message
{
    std::string name; // of the constant
    unsigned id;
    Placeholders placeholders;
};

const Placeholders kNoPlaceholders;
const Placeholders kOneText = {L"%s"}; // a path, a file name, or a number in decimal

const std::vector<Message> kMessages = {
    {"kOpenPanelTitle", kOpenPanelTitle, kNoPlaceholders},
    {"kCannotLoadFile", kCannotLoadFile, kOneText},
    {"kModuleLocked", kModuleLocked, kOneText},
    {"kOneLoaded", kOneLoaded, kOneText},
    {"kManyLoaded", kManyLoaded, kOneText},
    {"kOneAddedToStartupSuite", kOneAddedToStartupSuite, kOneText},
    {"kManyAddedToStartupSuite", kManyAddedToStartupSuite, kOneText},
    {"kOneUnloaded", kOneUnloaded, kOneText},
    {"kManyUnloaded", kManyUnloaded, kOneText},
    {"kOneRemovedFromHistory", kOneRemovedFromHistory, kOneText},
    {"kManyRemovedFromHistory", kManyRemovedFromHistory, kOneText},
    {"kStartupSuitePanelTitle", kStartupSuitePanelTitle, kNoPlaceholders},
    {"kLispPrompt", kLispPrompt, kNoPlaceholders},
    {"kCommandGroup", kCommandGroup, kNoPlaceholders},
    {"kCommandGlobalName", kCommandGlobalName, kNoPlaceholders},
    {"kCommandLocalName", kCommandLocalName, kNoPlaceholders},
    {"kListNotStored", kListNotStored, kNoPlaceholders},
    {"kFilterNotStored", kFilterNotStored, kNoPlaceholders},
    {"kAllApplicationsFilter", kAllApplicationsFilter, {L"%d", L"%s"}},
    {"kBundleFilter", kBundleFilter, kNoPlaceholders},
    {"kCoreModuleFilter", kCoreModuleFilter, kNoPlaceholders},
    {"kLispSourceFilter", kLispSourceFilter, kNoPlaceholders},
    {"kObjectModuleFilter", kObjectModuleFilter, kNoPlaceholders},
    {"kCompiledLispFilter", kCompiledLispFilter, kNoPlaceholders},
    {"kPackagedLispFilter", kPackagedLispFilter, kNoPlaceholders},
    {"kMacroProjectFilter", kMacroProjectFilter, kNoPlaceholders},
    {"kTooManyFiles", kTooManyFiles, kOneText},
    {"kLoadFailed", kLoadFailed, kOneText},
    {"kUrlNotFetched", kUrlNotFetched, kNoPlaceholders},
    {"kTemporaryInternetFile", kTemporaryInternetFile, kOneText},
    {"kAlreadyLoaded", ModrigMessages::kAlreadyLoaded, kOneText},
    {"kDialogFailed", kDialogFailed, kOneText},
};

const std::map<unsigned, std::wstring> kFilterPatterns = {
    {kAllApplicationsFilter, L"*.bundle;*.zmb;*.lsp;*.omp;*.qbc;*.rpk;*.mcp"},
    {kBundleFilter, L"*.bundle"},
    {kCoreModuleFilter, L"*.zmb"},
    {kLispSourceFilter, L"*.lsp"},
    {kObjectModuleFilter, L"*.omp"},
    {kCompiledLispFilter, L"*.qbc"},
    {kPackagedLispFilter, L"*.rpk"},
    {kMacroProjectFilter, L"*.mcp"},
};

std::map<std::string, unsigned> constantsOfTheHeader()
{
    const std::string header = readFile(sourceRoot() / "modrig/messages/MessageIds.h");
    const std::regex definition(R"(\bconstexpr\s+unsigned\s+(k\w+)\s*=\s*(\d+)\s*;)");
    std::map<std::string, unsigned> constants;
    for (std::sregex_iterator match(header.begin(), header.end(), definition), end; match != end; ++match)
        constants[(*match)[1]] = static_cast<unsigned>(std::stoul((*match)[2]));
    return constants;
}

// Every per cent sign with what belongs to it; a sign that begins no conversion stands alone.
Placeholders placeholdersOf(const std::wstring& text)
{
    const std::wregex conversion(L"%[-+ #0-9.*hlqjzt]*[a-zA-Z%]?");
    Placeholders found;
    for (std::wsregex_iterator match(text.begin(), text.end(), conversion), end; match != end; ++match)
        found.push_back(match->str());
    return found;
}

constexpr unsigned kModrigInEnglish = 0x0409, kModrigInGerman = 0x0007;

const std::vector<ResourceTexts>& allTexts()
{
    static const auto texts = readResourceTexts(MODRIG_RESOURCE_MODULE);
    return texts;
}

// In each of the languages.
class Texts : public testing::TestWithParam<unsigned>
{
protected:
    static std::map<unsigned, std::wstring> textsIn(unsigned language)
    {
        const auto& all = allTexts();
        const auto found = std::ranges::find(all, language, &ResourceTexts::language);
        return found == all.end() ? std::map<unsigned, std::wstring>() : found->texts;
    }

    const std::map<unsigned, std::wstring> mTexts = textsIn(GetParam());
};

TEST(LanguagesOfTexts, BeginWithTheOneThatIsTakenWhereNoneSuitsThePerson)
{
    std::vector<unsigned> languages;
    for (const ResourceTexts& texts : allTexts())
        languages.push_back(texts.language);
    EXPECT_EQ(languages, std::vector({kModrigInEnglish, kModrigInGerman}));
}

INSTANTIATE_TEST_SUITE_P(InEnglish, Texts, testing::Values(kModrigInEnglish));
INSTANTIATE_TEST_SUITE_P(InGerman, Texts, testing::Values(kModrigInGerman));

TEST_P(Texts, ArePlacedInTheTableOfPlaceholdersForEveryIdOfTheHeader)
{
    std::map<std::string, unsigned> table;
    for (const Message& message : kMessages)
        table[message.name] = message.id;
    EXPECT_EQ(constantsOfTheHeader(), table);
}

TEST_P(Texts, ExistForEveryIdThatTheCodeKnowsAndForNoOther)
{
    std::set<unsigned> known;
    for (const Message& message : kMessages)
        known.insert(message.id);
    std::set<unsigned> present;
    for (const auto& [id, text] : mTexts)
        present.insert(id);
    EXPECT_EQ(present, known);
}

TEST_P(Texts, HoldExactlyThePlaceholdersThatTheirUsersFillIn)
{
    for (const Message& message : kMessages)
        EXPECT_EQ(placeholdersOf(mTexts.at(message.id)), message.placeholders) << message.name;
}

TEST_P(Texts, ShowTheirArgumentsAndNothingUnfilled)
{
    for (const Message& message : kMessages)
    {
        if (message.placeholders != kOneText)
            continue;
        CStdStr text;
        text.Fmt(mTexts.at(message.id).c_str(), L"/a/tool.lsp");
        EXPECT_NE(text.Text().find(L"/a/tool.lsp"), std::wstring::npos) << message.name;
        EXPECT_EQ(text.Text().find(L'%'), std::wstring::npos) << message.name;
    }
}

TEST_P(Texts, NameTheReleaseAndTheProductInTheFirstFilter)
{
    CStdStr text;
    text.Fmt(mTexts.at(kAllApplicationsFilter).c_str(), 21, L"Tessel");
    const std::wstring& shown = text.Text();
    EXPECT_LT(shown.find(L"21"), shown.find(L"Tessel"));
    EXPECT_LT(shown.find(L"Tessel|"), shown.size());
}

TEST_P(Texts, DescribeAFilterBeforeTheBarAndListItsPatternsAfterIt)
{
    for (const auto& [id, patterns] : kFilterPatterns)
    {
        const std::wstring& text = mTexts.at(id);
        const std::size_t bar = text.find(L'|');
        ASSERT_NE(bar, std::wstring::npos) << id;
        EXPECT_GT(bar, 0U) << id;
        EXPECT_EQ(text.substr(bar + 1), patterns) << id;
    }
}

TEST_P(Texts, OfferEveryApplicationKindInTheFirstFilter)
{
    const std::wstring& text = mTexts.at(kAllApplicationsFilter);
    for (const CExtInfo& kind : sExtInfo)
        EXPECT_NE(text.find(std::wstring(L"*.") + kind.mExtension), std::wstring::npos)
            << CStdStr(kind.mExtension).c_str();
}

TEST_P(Texts, GiveTheCommandItsThreeNames)
{
    EXPECT_EQ(mTexts.at(kCommandGroup), L"MODRIG");
    EXPECT_EQ(mTexts.at(kCommandGlobalName), L"MODRIG");
    EXPECT_EQ(mTexts.at(kCommandLocalName), L"MODRIG");
}

// The host prints the text inside a Lisp string, where these two would end it or begin something else.
TEST_P(Texts, KeepTheLispPromptFreeOfWhatLispReadsInAString)
{
    EXPECT_EQ(mTexts.at(kLispPrompt).find_first_of(L"\"\\"), std::wstring::npos);
}

TEST_P(Texts, NeitherBeginNorEndWithBlanksOrLineEnds)
{
    for (const auto& [id, text] : mTexts)
    {
        EXPECT_FALSE(std::iswspace(static_cast<std::wint_t>(text.front()))) << id;
        EXPECT_FALSE(std::iswspace(static_cast<std::wint_t>(text.back()))) << id;
        EXPECT_EQ(text.find(L'\n'), std::wstring::npos) << id;
    }
}
} // namespace
