#include <gtest/gtest.h>

#include "host/console/InputAssembler.h"

using tessel::InputAssembler;
using tessel::isLisp;

namespace
{
bool isUnfinishedLisp(std::wstring_view text)
{
    tessel::LispScanner scanner;
    scanner.take(text);
    return scanner.isOpen();
}
} // namespace

TEST(InputAssembler, TakesACommandAsOneLine)
{
    InputAssembler input;
    EXPECT_EQ(input.add(L"LOAD (draft.lsp"), L"LOAD (draft.lsp");
    EXPECT_FALSE(input.isOpen());
}

TEST(InputAssembler, PassesOverBlankLinesAndComments)
{
    InputAssembler input;
    EXPECT_EQ(input.add(L""), std::nullopt);
    EXPECT_EQ(input.add(L" \t "), std::nullopt);
    EXPECT_EQ(input.add(L"  ; prepares the suite (half"), std::nullopt);
    EXPECT_FALSE(input.isOpen());
}

TEST(InputAssembler, GathersLispUntilItsParenthesesBalance)
{
    InputAssembler input;
    EXPECT_EQ(input.add(L"  (defun twice (x)"), std::nullopt);
    EXPECT_TRUE(input.isOpen());
    EXPECT_EQ(input.add(L""), std::nullopt);
    EXPECT_EQ(input.add(L"; a comment with )"), std::nullopt);
    EXPECT_EQ(input.add(L"  (* 2 x))"), L"  (defun twice (x)\n\n; a comment with )\n  (* 2 x))");
    EXPECT_FALSE(input.isOpen());
}

TEST(InputAssembler, ForgetsDiscardedLisp)
{
    InputAssembler input;
    input.add(L"(princ \"loop");
    input.discard();
    EXPECT_EQ(input.add(L"HELP"), L"HELP");
    EXPECT_EQ(input.add(L"(car x)"), L"(car x)");
}

TEST(InputAssembler, KeepsInMindWhatALineLeavesOpen)
{
    const std::pair<const wchar_t*, const wchar_t*> inputs[] = {
        {L"(princ \"a", L")\")"},         // a string
        {L"(princ \"a\\", L"b)\")"},      // its last character is escaped: the line's end
        {L"(list |a", L")b|)"},           // a symbol
        {L"(list #| a #| b |#", L")|#)"}, // comments in one another
        {L"(list #", L"|a)|)"},           // no comment: the line ends between
        {L"(list #\\", L")"}};            // the character is the line's end
    for (const auto& [first, second] : inputs)
    {
        InputAssembler input;
        EXPECT_EQ(input.add(first), std::nullopt) << testing::PrintToString(first);
        EXPECT_EQ(input.add(second), std::wstring(first) + L"\n" + second);
        EXPECT_FALSE(input.isOpen());
    }
}

TEST(InputAssembler, TellsLispByItsParenthesis)
{
    EXPECT_TRUE(isLisp(L" (car x)"));
    EXPECT_FALSE(isLisp(L"car"));
    EXPECT_FALSE(isLisp(L"LOAD \"(x).lsp\""));
    EXPECT_FALSE(isLisp(L""));
}

TEST(InputAssembler, DoesNotCountParenthesesThatAreNoLists)
{
    EXPECT_FALSE(isUnfinishedLisp(LR"((princ ")(" ))"));
    EXPECT_FALSE(isUnfinishedLisp(LR"((princ "a \" ( b"))"));
    EXPECT_FALSE(isUnfinishedLisp(LR"((list #\( #\) #\Space #\;))"));
    EXPECT_FALSE(isUnfinishedLisp(L"(list |a(b|)"));
    EXPECT_FALSE(isUnfinishedLisp(L"(list a\\( )"));
    EXPECT_FALSE(isUnfinishedLisp(L"(list #| ( #| ( |# ( |# 1) ; ((("));
    EXPECT_FALSE(isUnfinishedLisp(L"(list a#|(|)")); // a symbol: # begins a comment only where a token begins
    EXPECT_FALSE(isUnfinishedLisp(L"(list 'a|(|b\"(\")"));
    EXPECT_FALSE(isUnfinishedLisp(L"(list #)")); // an error, which is the interpreter's to tell
    EXPECT_FALSE(isUnfinishedLisp(L"(list) #; ((("));
}

TEST(InputAssembler, SeesWhatIsStillOpen)
{
    EXPECT_TRUE(isUnfinishedLisp(L"(list 1"));
    EXPECT_TRUE(isUnfinishedLisp(L"(list \"text)"));
    EXPECT_TRUE(isUnfinishedLisp(L"(list \"text\\\")"));
    EXPECT_TRUE(isUnfinishedLisp(L"(list |name)"));
    EXPECT_TRUE(isUnfinishedLisp(L"(list #| comment)"));
    EXPECT_TRUE(isUnfinishedLisp(L"(list #| #| |# )"));
    EXPECT_TRUE(isUnfinishedLisp(LR"((list #\))"));
    EXPECT_TRUE(isUnfinishedLisp(L"(list ; comment)"));
}

TEST(InputAssembler, LeavesAParenthesisTooManyToTheInterpreter)
{
    InputAssembler input;
    EXPECT_EQ(input.add(L"(car x))"), L"(car x))");
    EXPECT_EQ(input.add(L"(car x)) (cdr"), std::nullopt);
}
