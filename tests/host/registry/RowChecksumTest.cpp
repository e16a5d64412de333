#include "host/registry/RowChecksum.h"

#include <gtest/gtest.h>

#include <string>

using tessel::checksumOfValue;

// Reckoned by an independent program: the sums stand in files, and every later session has to find the same.
TEST(RowChecksum, IsTheOneThatStandsInFiles)
{
    EXPECT_EQ(checksumOfValue(5, "", "", "Default"), 3677908317);
    EXPECT_EQ(
        checksumOfValue(10, "3998History", "3998history", "/home/user/Applications/library39/tool3998.lsp"),
        1863118675);
}

TEST(RowChecksum, IsTheSameHoweverManyPiecesAreSummedAtOnce)
{
    const auto ofLength = [](std::size_t length)
    {
        return checksumOfValue(7, "Path", "path", std::string(length, 'x'));
    };
    EXPECT_EQ(ofLength(400), 3586622373);
    EXPECT_EQ(ofLength(512), 3230700551);
    EXPECT_EQ(ofLength(513), 2873104708);
    EXPECT_EQ(ofLength(600), 4125604513);
    EXPECT_EQ(ofLength(5000), 1586061916);
}
