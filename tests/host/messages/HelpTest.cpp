#include <gtest/gtest.h>

#include <tessel/tsed.h>

#include "host/messages/Help.h"
#include "tests/host/support/HostParts.h"
#include "tests/support/TemporaryFolder.h"

namespace
{
class HelpBook : public testing::Test
{
protected:
    HelpBook()
    {
        folder.write("book/suite.html", "<p>Suite</p>");
        folder.write("book/index.html", "<p>Book</p>");
        folder.write("secret.html", "<p>not of the book</p>");
    }

    CapturedOutput output;
    TemporaryFolder folder;
    bool hasBrowser = false;
    std::filesystem::path shown;
    tessel::Owned<tessel::Help> help{folder / "book",
                                     [this](const auto& page)
                                     {
                                         shown = page;
                                         return hasBrowser;
                                     },
                                     std::vector<std::string>{"de_AT", "de", "en", "fr"}};
};
} // namespace

TEST_F(HelpBook, PrintsThePathOfThePageWithoutABrowser)
{
    EXPECT_TRUE(tsedHelp(nullptr, L"suite", 0));
    EXPECT_EQ(output.text(), "Help: " + (folder / "book/suite.html").string() + "\n");
}

TEST_F(HelpBook, OpensThePageInTheBrowser)
{
    hasBrowser = true;
    EXPECT_TRUE(tsedHelp(nullptr, L"suite", 0));
    EXPECT_EQ(shown, folder / "book/suite.html");
    EXPECT_EQ(output.text(), "The help opens in the browser: " + shown.string() + "\n");
}

TEST_F(HelpBook, BeginsAtItsFirstPageWithoutATopic)
{
    EXPECT_TRUE(tsedHelp(nullptr, nullptr, 0));
    EXPECT_EQ(shown.filename(), "index.html");
}

TEST_F(HelpBook, SaysThatATopicIsUnknown)
{
    EXPECT_FALSE(tsedHelp(nullptr, L"größe%s", 0));
    EXPECT_EQ(output.text(), "There is no help on \"größe%s\".\n");
    EXPECT_TRUE(shown.empty());
}

TEST_F(HelpBook, HoldsNoPagesOfOtherFolders)
{
    EXPECT_FALSE(tsedHelp(nullptr, L"../secret", 0));
    EXPECT_TRUE(shown.empty());
}

TEST_F(HelpBook, CanBeAnApplicationsOwn)
{
    folder.write("other/topic.html", "<p>Other</p>");
    EXPECT_TRUE(tsedHelp((folder / "other").wstring().c_str(), L"topic", 0));
    EXPECT_EQ(shown, folder / "other/topic.html");
}

TEST_F(HelpBook, OpensAPageInTheFirstOfThePersonsLanguagesThatHasIt)
{
    folder.write("book/de/suite.html", "<p>Gruppe</p>");
    folder.write("book/fr/suite.html", "<p>Suite</p>");
    EXPECT_TRUE(tsedHelp(nullptr, L"suite", 0));
    EXPECT_EQ(shown, folder / "book/de/suite.html");
    folder.write("book/de_AT/suite.html", "<p>Gruppe</p>");
    EXPECT_TRUE(tsedHelp(nullptr, L"suite", 0));
    EXPECT_EQ(shown, folder / "book/de_AT/suite.html");
}

// Nobody who would rather read English gets French.
TEST_F(HelpBook, OpensThePageOfNoFolderInTheTurnOfEnglish)
{
    folder.write("book/fr/suite.html", "<p>Suite</p>");
    EXPECT_TRUE(tsedHelp(nullptr, L"suite", 0));
    EXPECT_EQ(shown, folder / "book/suite.html");
}

TEST_F(HelpBook, HasPagesInOneLanguageThatAnotherLacks)
{
    folder.write("book/fr/topic.html", "<p>Sujet</p>");
    folder.write("book/de/suite.html", "<p>Gruppe</p>");
    EXPECT_TRUE(tsedHelp(nullptr, L"index", 0));
    EXPECT_EQ(shown, folder / "book/index.html");
    EXPECT_FALSE(tsedHelp(nullptr, L"topic", 0));
}

TEST(Help, IsNotThereWithoutAHost)
{
    EXPECT_FALSE(tsedHelp(nullptr, L"suite", 0));
}
