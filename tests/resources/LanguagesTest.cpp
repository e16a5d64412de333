// Whether every language has every text of the windows.
#include <gmock/gmock.h>

#include <regex>
#include <set>

#include "tests/resources/SourceText.h"
#include "tests/resources/StringsFile.h"
#include "tests/support/TemporaryFolder.h"

namespace
{
namespace fs = std::filesystem;
using Keys = std::set<std::string>;

const std::set<std::string> kOtherLanguages = {"de"};

// Folders of a language below a folder of resources, by what stands before ".lproj".
std::set<std::string> languagesIn(const fs::path& resources)
{
    std::set<std::string> languages;
    for (const auto& entry : fs::directory_iterator(resources))
        if (entry.path().extension() == ".lproj")
            languages.insert(entry.path().stem());
    return languages;
}

std::string attribute(const std::string& element, const std::string& name)
{
    std::smatch match;
    const bool found = std::regex_search(element, match, std::regex(" " + name + "=\"([^\"]*)\""));
    return found ? match[1].str() : std::string();
}

// What a person never sees: what stands in cells until there are rows, and signs that are no words.
bool isRead(const std::string& text)
{
    return text != "Text Cell" && std::regex_search(text, std::regex("[A-Za-z]"));
}

// The keys of all that a person reads in a layout: an object's id, and which of its texts.
Keys keysOfLayout(const std::string& layout)
{
    Keys keys;
    std::string column, last;
    const std::regex anyElement("<([A-Za-z]+) [^<>]*>");
    for (std::sregex_iterator match(layout.begin(), layout.end(), anyElement), end; match != end; ++match)
    {
        const std::string element = match->str(), kind = (*match)[1];
        const std::string id = attribute(element, "id");
        if (kind == "tableColumn")
            column = id;
        const std::string owner = kind == "tableHeaderCell" ? column + ".headerCell" : id;
        for (const char* text : {"title", "label", "placeholderString"})
            if (kind != "segment" && isRead(attribute(element, text)))
                keys.insert(owner + "." + text);
        if (isRead(attribute(element, "toolTip")))
            keys.insert(id + ".ibShadowedToolTip");
        if (kind == "accessibility" && isRead(attribute(element, "description")))
            keys.insert(last + ".ibExternalAccessibilityDescription");
        last = id.empty() ? last : id;
    }
    return keys;
}

std::map<std::string, std::string> stringsIn(const fs::path& file)
{
    return readStringsFile(file).value_or(std::map<std::string, std::string>());
}

Keys keysOf(const fs::path& file)
{
    Keys keys;
    for (const auto& [key, text] : stringsIn(file))
        if (!text.empty())
            keys.insert(key);
    return keys;
}

Keys signsIn(const std::string& text)
{
    const std::regex placeholder("%[@a-z]");
    Keys found;
    for (std::sregex_iterator match(text.begin(), text.end(), placeholder), end; match != end; ++match)
        found.insert(match->str());
    return found;
}

// What stands in one set and not in the other, as a text that is empty when they are alike.
std::string difference(const Keys& expected, const Keys& found)
{
    std::string text;
    for (const std::string& key : expected)
        if (!found.contains(key))
            text += "lacks " + key + "\n";
    for (const std::string& key : found)
        if (!expected.contains(key))
            text += "has " + key + " in vain\n";
    return text;
}

// What the languages lack of the tables and layouts of a folder of resources.
std::string whatLanguagesLack(const fs::path& resources)
{
    std::string text;
    for (const std::string& language : kOtherLanguages)
    {
        const fs::path folder = resources / (language + ".lproj");
        for (const auto& entry : fs::directory_iterator(resources / "en.lproj"))
            text += difference(keysOf(entry.path()), keysOf(folder / entry.path().filename()));
        for (const auto& entry : fs::directory_iterator(resources))
            if (entry.path().extension() == ".xib")
                text += difference(keysOfLayout(readFile(entry.path())),
                                   keysOf(folder / entry.path().stem().concat(".strings")));
    }
    return text;
}
} // namespace

TEST(Languages, AreEnglishAndTheOthers)
{
    std::set<std::string> languages = kOtherLanguages;
    languages.insert("en");
    EXPECT_EQ(languagesIn(sourceRoot() / "modrig/resources"), languages);
    EXPECT_EQ(languagesIn(sourceRoot() / "host/ui/resources"), languages);
}

TEST(Languages, HaveEveryTextOfTheModulesWindows)
{
    EXPECT_EQ(whatLanguagesLack(sourceRoot() / "modrig/resources"), "");
    EXPECT_GE(keysOfLayout(readFile(sourceRoot() / "modrig/resources/Modrig.xib")).size(), 30U);
    EXPECT_GE(keysOfLayout(readFile(sourceRoot() / "modrig/resources/ModrigStartupSuit.xib")).size(), 9U);
}

TEST(Languages, HaveEveryTextOfTheHostsWindows)
{
    EXPECT_EQ(whatLanguagesLack(sourceRoot() / "host/ui/resources"), "");
    EXPECT_GE(keysOf(sourceRoot() / "host/ui/resources/en.lproj/Windows.strings").size(), 20U);
}

TEST(Languages, HaveThePlaceholdersOfTheEnglishTexts)
{
    for (const char* resources : {"modrig/resources", "host/ui/resources"})
        for (const auto& entry : fs::directory_iterator(sourceRoot() / resources / "en.lproj"))
            for (const std::string& language : kOtherLanguages)
            {
                const auto english = stringsIn(entry.path());
                for (const auto& [key, text] :
                     stringsIn(sourceRoot() / resources / (language + ".lproj") / entry.path().filename()))
                    EXPECT_EQ(signsIn(text), signsIn(english.at(key))) << language << ": " << key;
            }
}

TEST(Languages, AreMissedWhereTheyLackAText)
{
    const TemporaryFolder resources;
    resources.write("en.lproj/Words.strings", "\"ONE\" = \"one\";\n\"TWO\" = \"two\";\n");
    resources.write("de.lproj/Words.strings", "\"ONE\" = \"eins\";\n\"DREI\" = \"drei\";\n");
    resources.write("Window.xib", "<button id=\"b\" toolTip=\"A tip\"><accessibility description=\"A name\" "
                                  "/><buttonCell title=\"A title\" id=\"c\" />\n"
                                  "<tableColumn id=\"t\">\n<tableHeaderCell key=\"x\" title=\"File\">\n"
                                  "<segment label=\"+\" /><textFieldCell title=\"Text Cell\" id=\"d\">");
    resources.write("de.lproj/Window.strings", "\"c.title\" = \"Ein Titel\";\n");
    EXPECT_EQ(whatLanguagesLack(resources.path()),
              "lacks TWO\nhas DREI in vain\nlacks b.ibExternalAccessibilityDescription\nlacks "
              "b.ibShadowedToolTip\nlacks t.headerCell.title\n");
}
