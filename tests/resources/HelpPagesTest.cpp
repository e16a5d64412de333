// The pages of the help book, in every language.
#include <gmock/gmock.h>

#include <regex>
#include <set>

#include "tests/resources/SourceText.h"

namespace
{
namespace fs = std::filesystem;

fs::path helpBook()
{
    return sourceRoot() / "modrig/resources/help";
}

std::set<std::string> pagesIn(const fs::path& folder)
{
    std::set<std::string> pages;
    for (const auto& entry : fs::directory_iterator(folder))
        if (entry.path().extension() == ".html")
            pages.insert(entry.path().filename());
    return pages;
}

// What the page leads to, and its look.
std::vector<std::string> linksIn(const std::string& page)
{
    const std::regex link("href=\"([^\"]*)\"");
    std::vector<std::string> links;
    for (std::sregex_iterator match(page.begin(), page.end(), link), end; match != end; ++match)
        links.push_back((*match)[1]);
    return links;
}

// What a page has, whatever its words: the tags, in their order.
std::string shapeOf(const std::string& page)
{
    const std::regex tag("<[^>]*>");
    std::string shape;
    for (std::sregex_iterator match(page.begin(), page.end(), tag), end; match != end; ++match)
        shape += match->str() + '\n';
    return shape;
}

class HelpPages : public testing::TestWithParam<const char*>
{
protected:
    const fs::path mFolder = helpBook() / GetParam();
};
} // namespace

INSTANTIATE_TEST_SUITE_P(Of, HelpPages, testing::Values("", "de"));

TEST_P(HelpPages, AreTheSameInEveryLanguage)
{
    EXPECT_EQ(pagesIn(mFolder), pagesIn(helpBook()));
    EXPECT_THAT(pagesIn(mFolder), testing::IsSupersetOf({"index.html", "startup_suite_dialog.html",
                                                         "StandardFileSelectionDialogs.html",
                                                         "load_unload_applications_dialog.html"}));
}

TEST_P(HelpPages, LeadToPagesThatAreThere)
{
    for (const std::string& page : pagesIn(mFolder))
    {
        const auto links = linksIn(readFile(mFolder / page));
        EXPECT_GE(links.size(), 2U) << page;
        for (const std::string& link : links)
            EXPECT_TRUE(fs::is_regular_file(mFolder / link)) << page << ": " << link;
    }
}

TEST_P(HelpPages, CanAllBeReachedFromTheFirst)
{
    std::set<std::string> reached = {"index.html"};
    for (const std::string& link : linksIn(readFile(mFolder / "index.html")))
        reached.insert(link);
    for (const std::string& page : pagesIn(mFolder))
        EXPECT_TRUE(reached.contains(page)) << page;
}

TEST_P(HelpPages, SayInWhichLanguageTheyAre)
{
    const std::string language = *GetParam() ? GetParam() : "en";
    for (const std::string& page : pagesIn(mFolder))
        EXPECT_NE(readFile(mFolder / page).find("<html lang=\"" + language + "\">"), std::string::npos)
            << page;
}

// Who changes a page changes it in every language: rows, headings and keys are the same.
TEST_P(HelpPages, HaveTheSameParts)
{
    const std::regex words("(lang|href|content|name)=\"[^\"]*\"|<em>|</em>");
    for (const std::string& page : pagesIn(helpBook()))
        EXPECT_EQ(std::regex_replace(shapeOf(readFile(mFolder / page)), words, ""),
                  std::regex_replace(shapeOf(readFile(helpBook() / page)), words, ""))
            << page;
}
