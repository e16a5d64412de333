#include <gtest/gtest.h>

#include <tessel/tsformat.h>

#include "tests/host/support/HostParts.h"

TEST(CommandLine, PutsASentenceOnALineOfItsOwn)
{
    CapturedOutput output;
    output.commandLine().print(L"half a line");
    output.commandLine().say(L"A sentence.");
    output.commandLine().say(L"Another one.");
    EXPECT_EQ(output.text(), "half a line\nA sentence.\nAnother one.\n");
}

TEST(CommandLine, KnowsWhatStandsOnTheOpenLine)
{
    CapturedOutput output;
    EXPECT_TRUE(output.commandLine().atLineStart());
    output.commandLine().print(L"first\nsecond ");
    output.commandLine().print(L"part");
    EXPECT_EQ(output.commandLine().openLine(), L"second part");
    output.commandLine().returnToLineStart();
    EXPECT_TRUE(output.commandLine().atLineStart());
    output.commandLine().print(L"third");
    output.commandLine().print(L"\n");
    EXPECT_TRUE(output.commandLine().atLineStart());
}

TEST(CommandLine, GivesUtf8ToItsSink)
{
    CapturedOutput output;
    output.commandLine().print(L"Größe \U0001F600");
    EXPECT_EQ(output.text(), "Größe \xF0\x9F\x98\x80");
}

TEST(CommandLine, PrintsFormattedTextOfAnyLength)
{
    CapturedOutput output;
    const std::wstring name(100'000, L'x');
    EXPECT_EQ(tsutPrintf(L"<%s>\n", name.c_str()), 100'003);
    EXPECT_TRUE(output.text() == "<" + std::string(100'000, 'x') + ">\n"); // too long to be shown
}

TEST(CommandLine, PrintsAFormatThatIsAFileNameAsItStands)
{
    CapturedOutput output;
    tsutPrintf(L"100%s%n%d.lsp loaded\n");
    EXPECT_EQ(output.text(), "100%s%n%d.lsp loaded\n");
}

TEST(CommandLine, FormattedPrintingWithoutAHostOnlyCounts)
{
    EXPECT_EQ(tsutPrintf(L"%d files", 3), 7);
}

TEST(CommandLine, TellsWhatWentWrongAndWhetherAnythingDid)
{
    CapturedOutput output;
    EXPECT_TRUE(output.commandLine().tell(tessel::Result<int>(1)));
    EXPECT_EQ(output.text(), "");
    output.commandLine().print(L"Command: ");
    EXPECT_FALSE(output.commandLine().tell(tessel::Result<>(tessel::Failure{L"It is locked."})));
    EXPECT_EQ(output.text(), "Command: \nIt is locked.\n");
}

TEST(CommandLine, HasNothingToTellOfFailuresThatWereToldOneByOne)
{
    CapturedOutput output;
    EXPECT_FALSE(output.commandLine().tell(tessel::Result<>(tessel::Failure{})));
    EXPECT_EQ(output.text(), "");
}
