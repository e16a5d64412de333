#include "host/messages/Answers.h"

#include <gtest/gtest.h>

using tessel::asText;
using tessel::numberIn;

TEST(Answers, ANumberIsTakenWithASignAPointAndAnExponent)
{
    EXPECT_EQ(numberIn(L" 12 "), 12.0);
    EXPECT_EQ(numberIn(L"+3"), 3.0);
    EXPECT_EQ(numberIn(L"-2e3"), -2000.0);
    EXPECT_EQ(numberIn(L".5"), 0.5);
    EXPECT_EQ(numberIn(L"5."), 5.0);
}

TEST(Answers, WhatIsNoNumberByItselfIsNotTakenForOne)
{
    for (const wchar_t* text :
         {L"", L"-", L"1 2", L"1,5", L"--3", L"+-3", L"12x", L"inf", L"nan", L"0x10", L"1e400"})
        EXPECT_EQ(numberIn(text), std::nullopt) << text;
}

TEST(Answers, ANumberIsShownWithTheFewestDigitsThatStandForIt)
{
    EXPECT_EQ(asText(3.0), L"3");
    EXPECT_EQ(asText(0.1), L"0.1");
    EXPECT_EQ(asText(100000.0), L"100000");
    EXPECT_EQ(asText(1234567.0), L"1234567");
    EXPECT_EQ(asText(0.1 + 0.2), L"0.30000000000000004");
}
