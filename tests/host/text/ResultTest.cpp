#include "host/text/Result.h"

#include <gtest/gtest.h>

#include <memory>

using tessel::Failure;
using tessel::Result;

namespace
{
Result<std::unique_ptr<int>> half(int number)
{
    if (number % 2 != 0)
        return Failure{L"It is odd.", 7};
    return std::make_unique<int>(number / 2);
}

Result<int> quarter(int number)
{
    const auto whole = half(number);
    if (!whole)
        return whole.failure();
    const auto rest = half(**whole);
    return rest ? Result<int>(**rest) : rest.failure();
}
} // namespace

TEST(Result, HoldsTheValueOfASuccess)
{
    auto result = half(8);
    ASSERT_TRUE(result);
    EXPECT_EQ(result->operator*(), 4);
    const std::unique_ptr<int> taken = *std::move(result);
    EXPECT_EQ(*taken, 4);
}

TEST(Result, SaysNothingOfASuccess)
{
    EXPECT_EQ(half(8).sentence(), L"");
    EXPECT_EQ(half(8).code(), 0);
    EXPECT_TRUE(Result<>());
    EXPECT_EQ(Result<>().sentence(), L"");
    EXPECT_EQ(Result<>().code(), 0);
}

TEST(Result, SaysWhatWentWrong)
{
    EXPECT_FALSE(half(3));
    EXPECT_EQ(half(3).sentence(), L"It is odd.");
    EXPECT_EQ(half(3).code(), 7);
}

TEST(Result, HandsAFailureOnAsAResultOfAnotherKind)
{
    EXPECT_EQ(*quarter(8), 2);
    EXPECT_EQ(quarter(6).sentence(), L"It is odd.");
    EXPECT_EQ(quarter(3).code(), 7);
    const Result<> handedOn = quarter(3).failure();
    EXPECT_FALSE(handedOn);
    EXPECT_EQ(handedOn.code(), 7);
}

TEST(Result, IsAFailureWithoutASentenceOrACodeOfItsOwn)
{
    const Result<> result = Failure{};
    EXPECT_FALSE(result);
    EXPECT_EQ(result.code(), Failure::kUnspecified);
    EXPECT_FALSE(Result<std::wstring>(Failure{}));
    EXPECT_TRUE(Result<std::wstring>(std::wstring()));
}
