#include <tessel/tsedcommands.h>

#include "tests/contract/ContractTest.h"

namespace
{
int timesRun = 0;

void count()
{
    ++timesRun;
}

class CommandsContract : public ContractTest
{
protected:
    CommandsContract() { timesRun = 0; }

    int add(const wchar_t* group, const wchar_t* globalName, const wchar_t* localName) const
    {
        return commands->addCommand(group, globalName, localName, 0, count);
    }

    int runsOf(const std::wstring& typed) const
    {
        const int before = timesRun;
        const bool known = host->type(typed);
        EXPECT_EQ(known, timesRun > before);
        return timesRun - before;
    }

    TsEdCommandStack* commands = TsEdCommandStack::cast(tsrxSysRegistry()->at(TSED_REGISTERED_COMMANDS));
};

TEST_F(CommandsContract, RunsACommandByItsLocalName)
{
    EXPECT_EQ(add(L"CONTRACT", L"CONTRACTONE", L"CONTRACTEINS"), TSED_COMMAND_OK);
    EXPECT_EQ(runsOf(L"CONTRACTEINS"), 1);
    EXPECT_EQ(runsOf(L"contracteins"), 1);
}

TEST_F(CommandsContract, RunsACommandByItsGlobalNameAfterAnUnderscore)
{
    EXPECT_EQ(add(L"CONTRACT", L"CONTRACTONE", L"CONTRACTEINS"), TSED_COMMAND_OK);
    EXPECT_EQ(runsOf(L"_CONTRACTONE"), 1);
    EXPECT_EQ(runsOf(L"_contractone"), 1);
    EXPECT_EQ(runsOf(L"CONTRACTONE"), 0);
    EXPECT_EQ(runsOf(L"_CONTRACTEINS"), 0);
}

TEST_F(CommandsContract, KnowsNoCommandThatNobodyAdded)
{
    EXPECT_EQ(runsOf(L"CONTRACTNONE"), 0);
}

TEST_F(CommandsContract, RefusesASecondCommandOfAGroupAndGlobalName)
{
    EXPECT_EQ(add(L"CONTRACT", L"CONTRACTONE", L"CONTRACTONE"), TSED_COMMAND_OK);
    EXPECT_EQ(add(L"CONTRACT", L"CONTRACTONE", L"CONTRACTTWO"), TSED_COMMAND_DUPLICATE);
    EXPECT_EQ(add(L"Contract", L"ContractOne", L"CONTRACTTWO"), TSED_COMMAND_DUPLICATE);
    EXPECT_EQ(runsOf(L"CONTRACTTWO"), 0);
    EXPECT_EQ(add(L"OTHER", L"CONTRACTONE", L"CONTRACTTWO"), TSED_COMMAND_OK);
}

TEST_F(CommandsContract, RefusesNamesThatCannotBeTyped)
{
    EXPECT_EQ(add(L"", L"CONTRACTONE", L"CONTRACTONE"), TSED_COMMAND_INVALID);
    EXPECT_EQ(add(L"CONTRACT", L"", L"CONTRACTONE"), TSED_COMMAND_INVALID);
    EXPECT_EQ(add(L"CONTRACT", L"CONTRACTONE", L""), TSED_COMMAND_INVALID);
    EXPECT_EQ(add(L"CONTRACT", L"CONTRACT ONE", L"CONTRACTONE"), TSED_COMMAND_INVALID);
    EXPECT_EQ(add(L"CONTRACT", L"CONTRACTONE", L"CONTRACT\tONE"), TSED_COMMAND_INVALID);
    EXPECT_EQ(runsOf(L"CONTRACTONE"), 0);
}

TEST_F(CommandsContract, RefusesACommandWithoutAHandler)
{
    EXPECT_EQ(commands->addCommand(L"CONTRACT", L"CONTRACTONE", L"CONTRACTONE", 0, nullptr),
              TSED_COMMAND_INVALID);
    EXPECT_FALSE(host->type(L"CONTRACTONE"));
}

TEST_F(CommandsContract, HandsOutTheNewCommand)
{
    TsEdCommand* made = nullptr;
    EXPECT_EQ(commands->addCommand(L"CONTRACT", L"CONTRACTONE", L"CONTRACTONE", 0, count, nullptr, -1,
                                   nullptr, &made),
              TSED_COMMAND_OK);
    EXPECT_NE(made, nullptr);
}

TEST_F(CommandsContract, CopiesTheNames)
{
    std::wstring name = L"CONTRACTONE";
    EXPECT_EQ(add(L"CONTRACT", name.c_str(), name.c_str()), TSED_COMMAND_OK);
    name = L"CONTRACTTWO";
    EXPECT_EQ(runsOf(L"CONTRACTONE"), 1);
}

TEST_F(CommandsContract, RemovesACommandOnce)
{
    add(L"CONTRACT", L"CONTRACTONE", L"CONTRACTONE");
    add(L"CONTRACT", L"CONTRACTTWO", L"CONTRACTTWO");
    EXPECT_EQ(commands->removeCommand(L"OTHER", L"CONTRACTONE"), TSED_COMMAND_UNKNOWN);
    EXPECT_EQ(commands->removeCommand(L"contract", L"contractone"), TSED_COMMAND_OK);
    EXPECT_EQ(commands->removeCommand(L"CONTRACT", L"CONTRACTONE"), TSED_COMMAND_UNKNOWN);
    EXPECT_EQ(runsOf(L"CONTRACTONE"), 0);
    EXPECT_EQ(runsOf(L"CONTRACTTWO"), 1);
}

TEST_F(CommandsContract, RemovesAGroupWhole)
{
    add(L"CONTRACT", L"CONTRACTONE", L"CONTRACTONE");
    add(L"CONTRACT", L"CONTRACTTWO", L"CONTRACTTWO");
    add(L"OTHER", L"CONTRACTTHREE", L"CONTRACTTHREE");
    EXPECT_EQ(commands->removeGroup(L"contract"), TSED_COMMAND_OK);
    EXPECT_EQ(commands->removeGroup(L"CONTRACT"), TSED_COMMAND_UNKNOWN);
    EXPECT_EQ(runsOf(L"CONTRACTONE"), 0);
    EXPECT_EQ(runsOf(L"CONTRACTTWO"), 0);
    EXPECT_EQ(runsOf(L"CONTRACTTHREE"), 1);
}

TEST_F(CommandsContract, DescribesACommandInOneLine)
{
    add(L"CONTRACT", L"CONTRACTONE", L"CONTRACTEINS");
    EXPECT_EQ(tsedDescribeCommand(L"contract", L"contractone", L"Does one thing"), TSED_COMMAND_OK);
    EXPECT_EQ(tsedDescribeCommand(L"CONTRACT", L"CONTRACTONE", L"Does another"), TSED_COMMAND_OK);
    EXPECT_EQ(tsedDescribeCommand(L"CONTRACT", L"CONTRACTTWO", L"Does one thing"), TSED_COMMAND_UNKNOWN);
    EXPECT_EQ(tsedDescribeCommand(L"OTHER", L"CONTRACTONE", L"Does one thing"), TSED_COMMAND_UNKNOWN);
    EXPECT_EQ(tsedDescribeCommand(nullptr, L"CONTRACTONE", L"Does one thing"), TSED_COMMAND_UNKNOWN);
    EXPECT_EQ(tsedDescribeCommand(L"CONTRACT", nullptr, L"Does one thing"), TSED_COMMAND_UNKNOWN);
    for (const wchar_t* noLine : {L"", L"two\nlines", L"a\ttab", static_cast<const wchar_t*>(nullptr)})
        EXPECT_EQ(tsedDescribeCommand(L"CONTRACT", L"CONTRACTONE", noLine), TSED_COMMAND_INVALID);
    EXPECT_EQ(runsOf(L"CONTRACTEINS"), 1);
}

std::vector<std::wstring> argumentsSeen;

void takeArguments()
{
    count();
    argumentsSeen.clear();
    TsResultBuffer* list = tsedCommandArguments();
    for (const TsResultBuffer* value = list; value; value = value->next)
        argumentsSeen.emplace_back(value->type == TS_STRING ? value->value.string : L"(no text)");
    tsutRelRb(list);
}

TEST_F(CommandsContract, GivesArgumentsToACommandThatTakesThem)
{
    commands->addCommand(L"CONTRACT", L"CONTRACTONE", L"CONTRACTEINS", 0, takeArguments);
    EXPECT_FALSE(host->type(L"CONTRACTEINS one"));
    EXPECT_EQ(timesRun, 0) << "nobody said that it takes any";
    EXPECT_EQ(tsedTakeArguments(L"contract", L"contractone", L"[word...]"), TSED_COMMAND_OK);
    EXPECT_EQ(runsOf(L"CONTRACTEINS one  two"), 1);
    EXPECT_EQ(argumentsSeen, (std::vector<std::wstring>{L"one", L"two"}));
    EXPECT_EQ(runsOf(L"_CONTRACTONE"), 1);
    EXPECT_EQ(argumentsSeen, std::vector<std::wstring>());
    EXPECT_EQ(tsedCommandArguments(), nullptr) << "no command runs";
}

TEST_F(CommandsContract, TakesArgumentsOfAKnownCommandInOneLineOfUsage)
{
    add(L"CONTRACT", L"CONTRACTONE", L"CONTRACTEINS");
    EXPECT_EQ(tsedTakeArguments(L"CONTRACT", L"CONTRACTTWO", L"[word]"), TSED_COMMAND_UNKNOWN);
    EXPECT_EQ(tsedTakeArguments(nullptr, L"CONTRACTONE", L"[word]"), TSED_COMMAND_UNKNOWN);
    for (const wchar_t* noLine : {L"", L"two\nlines", static_cast<const wchar_t*>(nullptr)})
        EXPECT_EQ(tsedTakeArguments(L"CONTRACT", L"CONTRACTONE", noLine), TSED_COMMAND_INVALID);
    EXPECT_FALSE(host->type(L"CONTRACTEINS one"));
}

TEST_F(CommandsContract, TakesEntriesOfAKnownCommandOnly)
{
    add(L"CONTRACT", L"CONTRACTONE", L"CONTRACTEINS");
    const TsEdEntries none = []() -> TsResultBuffer*
    {
        return nullptr;
    };
    EXPECT_EQ(tsedOfferEntries(L"contract", L"contractone", none), TSED_COMMAND_OK);
    EXPECT_EQ(tsedOfferEntries(L"CONTRACT", L"CONTRACTTWO", none), TSED_COMMAND_UNKNOWN);
    EXPECT_EQ(tsedOfferEntries(nullptr, L"CONTRACTONE", none), TSED_COMMAND_UNKNOWN);
    EXPECT_EQ(tsedOfferEntries(L"CONTRACT", L"CONTRACTONE", nullptr), TSED_COMMAND_INVALID);
}

TEST_F(CommandsContract, CountsACommandAsFailedThatSaysSo)
{
    commands->addCommand(L"CONTRACT", L"CONTRACTONE", L"CONTRACTEINS", 0,
                         []
                         {
                             count();
                             if (timesRun == 1)
                                 tsedFailCommand(L"There is nothing to do.");
                             if (timesRun == 2)
                                 tsedFailCommand(nullptr);
                         });
    EXPECT_FALSE(host->type(L"CONTRACTEINS"));
    EXPECT_FALSE(host->type(L"CONTRACTEINS"));
    EXPECT_TRUE(host->type(L"CONTRACTEINS")) << "the next one does not pay for it";
    tsedFailCommand(L"Nothing runs.");
    EXPECT_TRUE(host->type(L"CONTRACTEINS"));
    EXPECT_EQ(timesRun, 4);
}

TEST_F(CommandsContract, LetsACommandRemoveItself)
{
    commands->addCommand(L"CONTRACT", L"CONTRACTONE", L"CONTRACTONE", 0,
                         []
                         {
                             count();
                             TsEdCommandStack::cast(tsrxSysRegistry()->at(TSED_REGISTERED_COMMANDS))
                                 ->removeCommand(L"CONTRACT", L"CONTRACTONE");
                         });
    EXPECT_EQ(runsOf(L"CONTRACTONE"), 1);
    EXPECT_EQ(runsOf(L"CONTRACTONE"), 0);
}
} // namespace
