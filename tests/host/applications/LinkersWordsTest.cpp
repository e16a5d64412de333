#include "host/applications/LinkersWords.h"

#include <gtest/gtest.h>

using tessel::withReadableSymbols;

TEST(LinkersWords, ShowSymbolsAsTheyStandInTheSource)
{
    EXPECT_EQ(withReadableSymbols("undefined symbol: _ZN4moon7phaseOfEPKwi"),
              "undefined symbol: moon::phaseOf(wchar_t const*, int)");
    EXPECT_EQ(withReadableSymbols("undefined symbol: _Z4turni, version TURNS_1"),
              "undefined symbol: turn(int), version TURNS_1");
    EXPECT_EQ(withReadableSymbols("symbol _Z4turni version TURNS_1 not defined in file liba.so"),
              "symbol turn(int) version TURNS_1 not defined in file liba.so");
    EXPECT_EQ(withReadableSymbols("_ZTV4Moon"), "vtable for Moon");
    EXPECT_EQ(withReadableSymbols("Symbol not found: __Z4turni\n  Expected in: _Z4turni"),
              "Symbol not found: turn(int)\n  Expected in: turn(int)");
}

TEST(LinkersWords, LeaveEverythingElseAsItIs)
{
    for (const char* words :
         {"", " ", "undefined symbol: turn", "undefined symbol: x_Z4turni", "undefined symbol: _Zebra",
          "undefined symbol: _Z", "/a/_Z4turni/b.so: file too short", "_Z4turni.so: cannot open",
          "_Z4turni: cannot open shared object file", "a  b ,, c "})
        EXPECT_EQ(withReadableSymbols(words), words);
}

TEST(LinkersWords, LeaveASymbolThatIsLongerThanAnyRealOne)
{
    std::string words = "undefined symbol: _Z4turn";
    for (int i = 0; i < 1000000; ++i)
        words += "P";
    EXPECT_EQ(withReadableSymbols(words + "i"), words + "i");
}
