#include "host/applications/Document.h"

#include <gtest/gtest.h>

#include "host/text/Running.h"

TEST(Document, ListsWhatWasLoadedOnceInOrderOfFirstLoad)
{
    tessel::Document document;
    document.add(L"/x/b.lsp");
    document.add(L"/x/a.lsp");
    document.add(L"/X/B.LSP");
    document.add(L"/x/a.lsp");
    ASSERT_EQ(document.loadedApplicationCount(), 2);
    EXPECT_STREQ(document.loadedApplicationName(0), L"/x/b.lsp");
    EXPECT_STREQ(document.loadedApplicationName(1), L"/x/a.lsp");
}

TEST(Document, ComparesPathsWithoutRegardToCaseInEveryScript)
{
    tessel::Document document;
    document.add(L"/x/größe.lsp");
    document.add(L"/x/GRÖßE.LSP");
    EXPECT_EQ(document.loadedApplicationCount(), 1);
    document.add(L"/x/grosse.lsp");
    EXPECT_EQ(document.loadedApplicationCount(), 2);
}

TEST(Document, AnswersNullOutsideOfTheList)
{
    tessel::Document document;
    EXPECT_EQ(document.loadedApplicationCount(), 0);
    EXPECT_EQ(document.loadedApplicationName(0), nullptr);
    document.add(L"/x/a.lsp");
    EXPECT_EQ(document.loadedApplicationName(-1), nullptr);
    EXPECT_EQ(document.loadedApplicationName(1), nullptr);
}

TEST(Document, IsWhatTheHostGivesApplications)
{
    EXPECT_EQ(curDoc(), nullptr);
    tessel::Document document;
    const tessel::Published<tessel::Document> published(document);
    EXPECT_EQ(curDoc(), &document);
}
