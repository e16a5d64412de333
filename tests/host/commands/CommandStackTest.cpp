#include <gmock/gmock.h>

#include <stdexcept>

#include "host/commands/CallingApplication.h"
#include "host/commands/CommandRunner.h"
#include "host/commands/CommandStack.h"
#include "host/commands/TypedLine.h"
#include "tests/host/support/HostParts.h"

using tessel::asPart;
using tessel::CallingApplication;
using tessel::running;
using tessel::splitLine;
using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Pair;

namespace
{
const std::wstring kFirst = L"/apps/first.bundle";
const std::wstring kSecond = L"/apps/second.zmb";

int calls = 0;
std::wstring caller;

void count()
{
    ++calls;
    caller = running<CallingApplication>()->path();
}

class Commands : public testing::Test
{
protected:
    Commands()
    {
        calls = 0;
        caller.clear();
    }

    int add(const std::wstring& owner, const wchar_t* group, const wchar_t* global, const wchar_t* local,
            TsEdCommandHandler handler = count)
    {
        const CallingApplication::Scope scope(calling, owner);
        TsEdCommandStack& asApplicationsSeeIt = stack;
        return asApplicationsSeeIt.addCommand(group, global, local, 0, handler);
    }

    CapturedOutput output;
    CallingApplication calling;
    tessel::CommandStack stack{calling};
    tessel::CommandRunner runner{stack, output.commandLine(), calling};
    tessel::Published<CallingApplication> publishedCalling{calling};
    tessel::Published<tessel::CommandStack> publishedStack{stack};
};
} // namespace

TEST_F(Commands, RunByLocalNameInAnyCaseAndByMarkedGlobalName)
{
    ASSERT_EQ(add(kFirst, L"DRAW", L"CIRCLE", L"KREIS"), TSED_COMMAND_OK);
    EXPECT_TRUE(runner.run(L"  kreis  "));
    EXPECT_TRUE(runner.run(L"_circle"));
    EXPECT_EQ(calls, 2);
    EXPECT_FALSE(runner.run(L"CIRCLE"));
    EXPECT_EQ(calls, 2);
}

TEST_F(Commands, RunAsTheApplicationThatRegisteredThem)
{
    add(kFirst, L"DRAW", L"CIRCLE", L"CIRCLE");
    runner.run(L"CIRCLE");
    EXPECT_EQ(caller, kFirst);
    EXPECT_EQ(calling.path(), L"");
}

TEST_F(Commands, AreUnknownInOneSentence)
{
    EXPECT_FALSE(runner.run(L"FOO bar"));
    EXPECT_EQ(output.text(), "Unknown command \"FOO\". Type HELP for the list of commands.\n");
}

TEST_F(Commands, ABlankLineIsNoCommand)
{
    int lines = 0;
    tessel::CommandRunner counting(stack, output.commandLine(), calling, {}, [&] { return ++lines > 0; });
    EXPECT_TRUE(counting.run(L" \t "));
    EXPECT_EQ(output.text(), "");
    EXPECT_EQ(lines, 0);
}

TEST_F(Commands, RefuseTheSameGlobalNameTwiceInAGroup)
{
    EXPECT_EQ(add(kFirst, L"DRAW", L"CIRCLE", L"KREIS"), TSED_COMMAND_OK);
    EXPECT_EQ(add(kSecond, L"draw", L"Circle", L"RUND"), TSED_COMMAND_DUPLICATE);
    EXPECT_EQ(add(kSecond, L"EDIT", L"CIRCLE", L"KREIS"), TSED_COMMAND_OK);
}

TEST_F(Commands, RefuseNamesThatCannotBeTyped)
{
    EXPECT_EQ(add(kFirst, L"", L"A", L"A"), TSED_COMMAND_INVALID);
    EXPECT_EQ(add(kFirst, L"DRAW", L"", L"A"), TSED_COMMAND_INVALID);
    EXPECT_EQ(add(kFirst, L"DRAW", L"A", nullptr), TSED_COMMAND_INVALID);
    EXPECT_EQ(add(kFirst, L"DRAW", L"A B", L"A"), TSED_COMMAND_INVALID);
    EXPECT_EQ(add(kFirst, L"DRAW", L"A", L"A\tB"), TSED_COMMAND_INVALID);
    EXPECT_EQ(add(kFirst, L"DRAW", L"A", L"A", nullptr), TSED_COMMAND_INVALID);
    EXPECT_THAT(stack.names(), IsEmpty());
}

TEST_F(Commands, GiveBackTheCommandThatWasAdded)
{
    TsEdCommand* command = nullptr;
    EXPECT_EQ(stack.addCommand(L"DRAW", L"A", L"A", 0, count, nullptr, -1, nullptr, &command),
              TSED_COMMAND_OK);
    EXPECT_NE(command, nullptr);
}

TEST_F(Commands, GoOneByOneAndByGroup)
{
    add(kFirst, L"DRAW", L"A", L"A");
    add(kFirst, L"DRAW", L"B", L"B");
    add(kFirst, L"EDIT", L"C", L"C");
    EXPECT_EQ(stack.removeCommand(L"draw", L"a"), TSED_COMMAND_OK);
    EXPECT_EQ(stack.removeCommand(L"DRAW", L"A"), TSED_COMMAND_UNKNOWN);
    EXPECT_EQ(stack.removeCommand(nullptr, nullptr), TSED_COMMAND_UNKNOWN);
    EXPECT_EQ(stack.removeGroup(L"DRAW"), TSED_COMMAND_OK);
    EXPECT_EQ(stack.removeGroup(L"DRAW"), TSED_COMMAND_UNKNOWN);
    EXPECT_THAT(stack.names(), ElementsAre(L"C"));
}

TEST_F(Commands, GoWithTheirApplication)
{
    add(kFirst, L"DRAW", L"A", L"EINS");
    add(kSecond, L"DRAW", L"B", L"ZWEI");
    add(kFirst, L"EDIT", L"C", L"DREI");
    EXPECT_THAT(stack.commandsOf(kFirst), ElementsAre(Pair(L"A", L"EINS"), Pair(L"C", L"DREI")));
    stack.removeCommandsOf(kFirst);
    EXPECT_THAT(stack.commandsOf(kFirst), IsEmpty());
    EXPECT_THAT(stack.names(), ElementsAre(L"ZWEI"));
}

TEST_F(Commands, MayRemoveThemselvesWhileTheyRun)
{
    add(kFirst, L"DRAW", L"GO", L"GO",
        []
        {
            running<tessel::CommandStack>()->removeCommandsOf(kFirst);
            ++calls;
        });
    EXPECT_TRUE(runner.run(L"GO"));
    EXPECT_EQ(calls, 1);
    EXPECT_FALSE(runner.run(L"GO"));
}

TEST_F(Commands, EndWithWhatTheyThrow)
{
    add(kFirst, L"DRAW", L"A", L"BROKEN", [] { throw std::runtime_error("no größe"); });
    add(kFirst, L"DRAW", L"B", L"ODD", [] { throw 42; });
    int lines = 0;
    tessel::CommandRunner counting(stack, output.commandLine(), calling, {}, [&] { return ++lines > 0; });
    EXPECT_FALSE(counting.run(L"broken"));
    EXPECT_EQ(output.text(), "The command \"BROKEN\" failed: no größe\n");
    output.clear();
    EXPECT_FALSE(counting.run(L"odd"));
    EXPECT_THAT(output.text(), HasSubstr("The command \"ODD\" failed: "));
    EXPECT_EQ(lines, 2);
    EXPECT_EQ(calling.path(), L"");
}

TEST_F(Commands, FailWhenWhatFollowsTheLineFails)
{
    add(kFirst, L"DRAW", L"A", L"A");
    tessel::CommandRunner failing(stack, output.commandLine(), calling, {}, [] { return false; });
    EXPECT_FALSE(failing.run(L"A"));
    EXPECT_EQ(calls, 1);
}

TEST_F(Commands, OfApplicationsTakeNoArguments)
{
    add(kFirst, L"DRAW", L"A", L"A");
    EXPECT_FALSE(runner.run(L"A 1"));
    EXPECT_EQ(calls, 0);
    EXPECT_EQ(output.text(), "The command \"A\" failed: it takes no arguments.\n");
}

TEST_F(Commands, OfApplicationsTakeArgumentsWhenTheySaySo)
{
    add(kFirst, L"DRAW", L"A", L"A");
    EXPECT_EQ(tsedTakeArguments(L"draw", L"a", L"[word]"), TSED_COMMAND_OK);
    EXPECT_TRUE(runner.run(LR"(A 1 "2 3")"));
    EXPECT_EQ(calls, 1);
    EXPECT_EQ(stack.descriptions().back().usage, L"[word]");
}

TEST_F(Commands, OfApplicationsSayThatTheyHaveFailed)
{
    stack.addCommand(
        L"DRAW", L"A", L"EINS", 0, [] { tsedFailCommand(L"Nothing to do."); }, nullptr, -1, nullptr, nullptr);
    EXPECT_FALSE(runner.run(L"EINS"));
    EXPECT_EQ(output.text(), "Nothing to do.\n");
    stack.addCommand(
        L"DRAW", L"B", L"ZWEI", 0, [] { tsedFailCommand(nullptr); }, nullptr, -1, nullptr, nullptr);
    EXPECT_EQ(tsedTakeArguments(L"DRAW", L"B", L"[word]"), TSED_COMMAND_OK);
    EXPECT_FALSE(runner.run(L"ZWEI x"));
    EXPECT_EQ(output.text(), "Nothing to do.\nUsage: ZWEI [word]\n");
}

TEST_F(Commands, ThatAreAnnouncedAreListedUntilTheyAreThere)
{
    const auto listed = [this]
    {
        std::vector<std::wstring> all;
        for (const auto& description : stack.descriptions())
            all.push_back(description.group + L":" + description.name + L":" + description.summary);
        return all;
    };
    add(kFirst, L"DRAW", L"A", L"A");
    add(kSecond, L"OTHER", L"B", L"B");
    stack.announce({L"draw", L"LATER", L"[word]", L"Announced"});
    EXPECT_THAT(listed(), ElementsAre(L"DRAW:A:", L"draw:LATER:Announced", L"OTHER:B:"));
    EXPECT_THAT(stack.names(), ElementsAre(L"A", L"B", L"LATER"));
    EXPECT_FALSE(runner.run(L"LATER")) << "nobody has loaded it";
    add(kFirst, L"DRAW", L"LATER", L"LATER");
    EXPECT_THAT(listed(), ElementsAre(L"DRAW:A:", L"DRAW:LATER:", L"OTHER:B:"));
    EXPECT_THAT(stack.names(), ElementsAre(L"A", L"B", L"LATER"));
    stack.removeCommandsOf(kFirst);
    EXPECT_THAT(listed(), ElementsAre(L"OTHER:B:", L"draw:LATER:Announced"));
}

TEST_F(Commands, OfTheHostAnswerProgramsByAnotherHandler)
{
    std::vector<std::wstring> asked;
    const auto into = [&asked](const wchar_t* whom)
    {
        return [&asked, whom](const auto& arguments)
        {
            asked.emplace_back(whom + std::to_wstring(arguments.size()));
            return tessel::Result<>();
        };
    };
    stack.addBuiltIn({L"Session", L"SHOW", L"", L""}, into(L"person"));
    stack.addBuiltIn({L"Session", L"OTHER", L"", L""}, into(L"other"));
    stack.addListing(L"SHOW", into(L"program"));
    for (const wchar_t* line : {L"SHOW", L"SHOW --json", L"SHOW a --json", L"SHOW --json a", L"OTHER --json"})
        EXPECT_TRUE(runner.run(line));
    EXPECT_THAT(asked, ElementsAre(L"person0", L"program0", L"program1", L"person2", L"other1"));
    EXPECT_TRUE(tessel::isForPrograms(L"SHOW  a --json "));
    EXPECT_FALSE(tessel::isForPrograms(L"--json"));
    EXPECT_FALSE(tessel::isForPrograms(L"SHOW --json a"));
}

TEST_F(Commands, OfTheHostTakeArgumentsAndStay)
{
    std::vector<std::wstring> seen;
    stack.addBuiltIn({L"Session", L"ECHO", L"text...", L"Echoes"},
                     [&](const auto& arguments)
                     {
                         seen = arguments;
                         return arguments.size() != 1 ? tessel::Result<>() : tessel::Failure{L"Too few."};
                     });
    EXPECT_TRUE(runner.run(LR"(echo "a b" c)"));
    EXPECT_THAT(seen, ElementsAre(L"a b", L"c"));
    EXPECT_FALSE(runner.run(L"ECHO x"));
    EXPECT_EQ(output.text(), "Too few.\n");
    EXPECT_EQ(stack.removeGroup(L"Session"), TSED_COMMAND_UNKNOWN);
    EXPECT_EQ(stack.removeCommand(L"Session", L"ECHO"), TSED_COMMAND_UNKNOWN);
    stack.removeCommandsOf(L"");
    add(kFirst, L"DRAW", L"ECHO", L"ECHO");
    EXPECT_TRUE(runner.run(L"ECHO"));
    EXPECT_EQ(calls, 0);
    EXPECT_THAT(stack.commandsOf(L""), IsEmpty());
}

TEST_F(Commands, AreLoadedWhenNobodyHasRegisteredThem)
{
    std::vector<std::wstring> asked;
    const auto load = [&](const std::wstring& name)
    {
        asked.push_back(name);
        return name == L"later" && add(kSecond, L"DRAW", L"LATER", L"LATER") == TSED_COMMAND_OK;
    };
    tessel::CommandRunner loading(stack, output.commandLine(), calling, load);
    EXPECT_TRUE(loading.run(L"later"));
    EXPECT_TRUE(loading.run(L"LATER"));
    EXPECT_FALSE(loading.run(L"NEVER"));
    EXPECT_EQ(calls, 2);
    EXPECT_THAT(asked, ElementsAre(L"later", L"NEVER"));
}

TEST_F(Commands, AreDescribedGroupByGroup)
{
    const auto nothing = [](const auto&)
    {
        return tessel::Result<>();
    };
    stack.addBuiltIn({L"Session", L"HELP", L"[name]", L"Helps"}, nothing);
    add(kFirst, L"DRAW", L"A", L"EINS");
    stack.addBuiltIn({L"Session", L"QUIT", L"", L"Ends"}, nothing);
    std::vector<std::wstring> order;
    for (const auto& description : stack.descriptions())
        order.push_back(description.group + L":" + description.name);
    EXPECT_THAT(order, ElementsAre(L"Session:HELP", L"Session:QUIT", L"DRAW:EINS"));
}

TEST_F(Commands, AreDescribedInOneLineThatGoesWithThem)
{
    add(kFirst, L"G", L"ONE", L"EINS");
    EXPECT_EQ(tsedDescribeCommand(L"g", L"one", L"Does one thing"), TSED_COMMAND_OK);
    EXPECT_EQ(stack.descriptions().back().summary, L"Does one thing");
    stack.removeGroup(L"G");
    add(kFirst, L"G", L"ONE", L"EINS");
    EXPECT_EQ(stack.descriptions().back().summary, L"");
}

TEST_F(Commands, OfTheHostAreNotDescribedByOthers)
{
    stack.addBuiltIn({L"Session", L"OWN", L"", L"the host's"},
                     [](const auto&) { return tessel::Result<>(); });
    EXPECT_EQ(tsedDescribeCommand(L"Session", L"OWN", L"Does one thing"), TSED_COMMAND_UNKNOWN);
    EXPECT_EQ(stack.descriptions().back().summary, L"the host's");
}

TEST_F(Commands, ThatComeWithTheHostAreDescribedByIt)
{
    add(kFirst, L"G", L"MODRIG", L"MODRIG");
    EXPECT_EQ(stack.descriptions().back().summary, L"Loads and unloads applications, in a dialog");
}

TEST_F(Commands, AreFoundByTheNameOfTheirClass)
{
    EXPECT_EQ(TsEdCommandStack::cast(&stack), &stack);
    EXPECT_FALSE(stack.isKindOf(L"TsRxDynamicLinker"));
    EXPECT_FALSE(stack.isKindOf(nullptr));
}

TEST(SplitLine, SplitsAtBlanks)
{
    EXPECT_THAT(splitLine(L"  LOAD\ta.lsp  b.lsp\r"), ElementsAre(L"LOAD", L"a.lsp", L"b.lsp"));
    EXPECT_THAT(splitLine(L""), IsEmpty());
}

TEST(SplitLine, KeepsQuotedBlanksTogether)
{
    EXPECT_THAT(splitLine(LR"(LOAD "/a b/c d.lsp" x)"), ElementsAre(L"LOAD", L"/a b/c d.lsp", L"x"));
    EXPECT_THAT(splitLine(LR"(SET key "" tail)"), ElementsAre(L"SET", L"key", L"", L"tail"));
    EXPECT_THAT(splitLine(LR"(a" "b)"), ElementsAre(L"a b"));
    EXPECT_THAT(splitLine(LR"(LOAD "no end)"), ElementsAre(L"LOAD", L"no end"));
}

TEST(SplitLine, FindsATextThatWasMadeAPartAsItWas)
{
    for (const std::wstring text : {L"a.lsp", L"", L"a b\t\n.lsp", L"\"", L"in \"quotes\".lsp", L"\"\""})
        EXPECT_THAT(splitLine(L"LOAD " + asPart(text) + L" x"), ElementsAre(L"LOAD", text, L"x"));
}

TEST(SplitLine, TakesADoubledQuoteWithinQuotesForAQuote)
{
    EXPECT_THAT(splitLine(LR"(LOAD "/a ""b"" c.lsp")"), ElementsAre(L"LOAD", LR"(/a "b" c.lsp)"));
    EXPECT_THAT(splitLine(LR"("""" a""b)"), ElementsAre(L"\"", L"ab"));
}
