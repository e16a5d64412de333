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

TEST(PathHash, PassesOverLettersThatOthersAreEqualTo)
{
    EXPECT_EQ(HashOfPath(u"/bk"), HashOfPath(u"/b\u212A"));      // the sign for kelvin
    EXPECT_EQ(HashOfPath(u"/s"), HashOfPath(u"/\u017F"));        // the long s
    EXPECT_EQ(HashOfPath(u"/bfi/x"), HashOfPath(u"/b\uFB01/x")); // the ligature fi
}

TEST(PathHash, PassesOverALetterThatAnAccentMayFollow)
{
    EXPECT_EQ(HashOfPath(u"/caf\u00E9.x"), HashOfPath(u"/cafe\u0301.x"));
    EXPECT_EQ(HashOfPath(u"/\u00E9"), HashOfPath(u"/e\u0301"));
}

TEST(PathHash, IsTheSameForAPathInEitherEncoding)
{
    EXPECT_EQ(HashOfPath(u"/Caf\u00E9/cafe\u0301\U0001F600.lsp"),
              HashOfPath(L"/Caf\u00E9/cafe\u0301\U0001F600.lsp"));
    EXPECT_NE(HashOfPath(L"/a/one"), HashOfPath(L"/a/two"));
}
