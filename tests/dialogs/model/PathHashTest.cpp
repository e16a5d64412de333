#include "modrig/dialogs/model/PathHash.h"

#include <gtest/gtest.h>

using ModrigUtils::HashOfPath;

TEST(PathHash, IsTheSameInAnyCase)
{
    EXPECT_EQ(HashOfPath(L"/a/b-c_d.lsp"), HashOfPath(L"/A/B-C_D.LSP"));
    EXPECT_EQ(HashOfPath(L"/zmb"), HashOfPath(L"/ZMB"));
}

TEST(PathHash, TellsPathsApartByLettersThatNothingElseIsEqualTo)
{
    EXPECT_NE(HashOfPath(L"/a/one"), HashOfPath(L"/a/two"));
    EXPECT_NE(HashOfPath(L"/b"), HashOfPath(L"/c"));
    EXPECT_NE(HashOfPath(L"/b"), HashOfPath(L"/bb"));
    EXPECT_NE(HashOfPath(L""), HashOfPath(L"9"));
    EXPECT_NE(HashOfPath(L"/"), HashOfPath(L"/."));
}

TEST(PathHash, PassesOverLettersThatOthersAreEqualTo)
{
    EXPECT_EQ(HashOfPath(L"/bk"), HashOfPath(L"/b\u212A"));      // the sign for kelvin
    EXPECT_EQ(HashOfPath(L"/s"), HashOfPath(L"/\u017F"));        // the long s
    EXPECT_EQ(HashOfPath(L"/bfi/x"), HashOfPath(L"/b\uFB01/x")); // the ligature fi
}

TEST(PathHash, PassesOverALetterThatAnAccentMayFollow)
{
    EXPECT_EQ(HashOfPath(L"/caf\u00E9.x"), HashOfPath(L"/cafe\u0301.x"));
    EXPECT_EQ(HashOfPath(L"/\u00E9"), HashOfPath(L"/e\u0301"));
}
