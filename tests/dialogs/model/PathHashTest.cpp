#include "modrig/dialogs/model/PathHash.h"

#include <gtest/gtest.h>

using ModrigUtils::HashOfPath;

TEST(PathHash, IsTheSameInAnyCase)
{
    EXPECT_EQ(HashOfPath(u"/a/b-c_d.lsp"), HashOfPath(u"/A/B-C_D.LSP"));
    EXPECT_EQ(HashOfPath(u"/zmb"), HashOfPath(u"/ZMB"));
}

TEST(PathHash, TellsPathsApartByLettersThatNothingElseIsEqualTo)
{
    EXPECT_NE(HashOfPath(u"/a/one"), HashOfPath(u"/a/two"));
    EXPECT_NE(HashOfPath(u"/b"), HashOfPath(u"/c"));
    EXPECT_NE(HashOfPath(u"/b"), HashOfPath(u"/bb"));
    EXPECT_NE(HashOfPath(u""), HashOfPath(u"9"));
    EXPECT_NE(HashOfPath(u"/"), HashOfPath(u"/."));
}
