#include <gmock/gmock.h>

#include <regex>
#include <set>
#include <sstream>

#include "modrig/lists/Globals.h"
#include "modrig/types/ApplicationTypes.h"
#include "tests/resources/SourceText.h"
#include "tests/resources/StringsFile.h"
#include "tests/support/TemporaryFolder.h"

namespace
{
using Table = std::map<std::string, std::string>;

// Every key, in the order of the file types in the panel, and the extensions that each shows.
const Table kShownExtensions = {
    {"IDS_MODRIG_TESSEL_APPS", "bundle;zmb;lsp;omp;qbc;rpk;mcp"},
    {"IDS_MODRIG_QMB_APPS", "bundle"},
    {"IDS_MODRIG_ZMB_APPS", "zmb"},
    {"IDS_MODRIG_LSP_APPS", "lsp"},
    {"IDS_MODRIG_OMP_APPS", "omp"},
    {"IDS_MODRIG_QBC_APPS", "qbc"},
};
constexpr char kExtensionSuffix[] = "_EXT";

// The texts that are no file types, with the placeholders that each has.
const std::map<std::string, std::vector<std::string>> kTexts = {
    {"IDS_MODRIG_CLOSE_BUTTON", {}},
    {"IDS_MODRIG_NOTHING_CHOSEN", {}},
    {"IDS_MODRIG_MENU_LOAD", {}},
    {"IDS_MODRIG_MENU_UNLOAD", {}},
    {"IDS_MODRIG_MENU_ADD", {}},
    {"IDS_MODRIG_MENU_ADD_TO_STARTUP_SUITE", {}},
    {"IDS_MODRIG_MENU_REMOVE", {}},
    {"IDS_MODRIG_MENU_MOVE_UP", {}},
    {"IDS_MODRIG_MENU_MOVE_DOWN", {}},
    {"IDS_MODRIG_MENU_KEEP_OUT", {}},
    {"IDS_MODRIG_MENU_LET_IN", {}},
    {"IDS_MODRIG_MENU_COPY_PATH", {}},
    {"IDS_MODRIG_MENU_SHOW_IN_FOLDER", {}},
    {"IDS_MODRIG_ROW_MISSING", {}},
    {"IDS_MODRIG_ROW_LOCKED", {}},
    {"IDS_MODRIG_ROW_NEVER_UNLOADED", {}},
    {"IDS_MODRIG_ROW_FAILED", {}},
    {"IDS_MODRIG_UNLOAD_LOCKED", {}},
    {"IDS_MODRIG_UNLOAD_NEVER", {}},
    {"IDS_MODRIG_UNLOAD_NONE", {}},
    {"IDS_MODRIG_UNLOAD_NOTHING_LOADED", {}},
    {"IDS_MODRIG_UNLOAD_NOTHING_SELECTED", {}},
    {"IDS_MODRIG_UNLOAD_SELECTED", {}},
    {"IDS_MODRIG_LOADING", {"%u", "%u"}},
    {"IDS_MODRIG_LOADING_STOPPED", {"%u", "%u"}},
};

std::set<std::string> everyKey()
{
    std::set<std::string> keys;
    for (const auto& [key, placeholders] : kTexts)
        keys.insert(key);
    for (const auto& [key, extensions] : kShownExtensions)
        keys.insert({key, key + kExtensionSuffix});
    return keys;
}

std::set<std::string> keysOf(const Table& table)
{
    std::set<std::string> keys;
    for (const auto& [key, text] : table)
        keys.insert(key);
    return keys;
}

std::set<std::string> keysIn(const std::string& sources)
{
    const std::regex key("IDS_MODRIG_[A-Z_]*[A-Z]");
    std::set<std::string> keys;
    for (std::sregex_iterator match(sources.begin(), sources.end(), key), end; match != end; ++match)
        keys.insert(match->str());
    return keys;
}

std::vector<std::string> placeholdersIn(const std::string& text)
{
    const std::regex placeholder("%.");
    std::vector<std::string> found;
    for (std::sregex_iterator match(text.begin(), text.end(), placeholder), end; match != end; ++match)
        found.push_back(match->str());
    return found;
}

std::vector<std::string> parts(const std::string& extensions)
{
    std::vector<std::string> result;
    std::istringstream stream(extensions);
    for (std::string extension; std::getline(stream, extension, ';');)
        result.push_back(extension);
    return result;
}

// In each of the languages.
class LocalizedStrings : public testing::TestWithParam<const char*>
{
protected:
    void SetUp() override
    {
        const std::string file =
            std::string(MODRIG_BUNDLE_RESOURCES "/") + GetParam() + ".lproj/Localizable.strings";
        const auto read = readStringsFile(file);
        ASSERT_TRUE(read.has_value()) << "not a string table: " << file;
        mTexts = *read;
    }

    Table mTexts;
};

INSTANTIATE_TEST_SUITE_P(Of, LocalizedStrings, testing::Values("en", "de"));

TEST_P(LocalizedStrings, HoldTheirKeysAndNoOther)
{
    EXPECT_EQ(keysOf(mTexts), everyKey());
}

TEST_P(LocalizedStrings, HoldEveryKeyThatTheSourcesName)
{
    for (const std::string& key : keysIn(moduleSources()))
        EXPECT_TRUE(mTexts.contains(key)) << key;
    EXPECT_THAT(keysIn("[TsOCModrigUtil modrigLoadString:@\"IDS_MODRIG_NEW_EXT\"];"),
                testing::ElementsAre("IDS_MODRIG_NEW_EXT"))
        << "keys are overlooked";
}

TEST_P(LocalizedStrings, AreNeverEmptyAndHoldThePlaceholdersThatAreFilled)
{
    for (const auto& [key, text] : mTexts)
    {
        const auto expected = kTexts.find(key);
        EXPECT_FALSE(text.empty()) << key;
        EXPECT_EQ(placeholdersIn(text),
                  expected == kTexts.end() ? std::vector<std::string>() : expected->second)
            << key;
    }
}

TEST_P(LocalizedStrings, NameTheExtensionsThatAFilterShowsWithoutDotsOrStars)
{
    for (const auto& [key, extensions] : kShownExtensions)
        EXPECT_EQ(mTexts.at(key + kExtensionSuffix), extensions) << key;
}

TEST_P(LocalizedStrings, ShowEveryKindOfApplicationInTheFirstFilterAndNothingElse)
{
    std::set<std::string> kinds;
    for (const CExtInfo& kind : sExtInfo)
    {
        const std::wstring extension = kind.mExtension;
        kinds.insert(std::string(extension.begin(), extension.end()));
    }
    const std::vector<std::string> shown = parts(mTexts.at("IDS_MODRIG_TESSEL_APPS_EXT"));
    EXPECT_EQ(std::set<std::string>(shown.begin(), shown.end()), kinds);
    EXPECT_EQ(shown.size(), kinds.size());
}

TEST_P(LocalizedStrings, DescribeEveryFilterDifferently)
{
    std::set<std::string> descriptions;
    for (const auto& [key, extensions] : kShownExtensions)
        descriptions.insert(mTexts.at(key));
    EXPECT_EQ(descriptions.size(), kShownExtensions.size());
}

TEST(StringsFile, ThatIsBrokenIsNotRead)
{
    const TemporaryFolder folder;
    const auto file = folder.write("Broken.strings", "\"KEY\" = \"a text without an end;\n");
    EXPECT_FALSE(readStringsFile(file).has_value());
    EXPECT_FALSE(readStringsFile(folder.path() / "Missing.strings").has_value());
}
} // namespace
