#include "host/registry/SystemVariables.h"

#include <gmock/gmock.h>

#include <optional>

#include <tessel/tsed.h>

#include "tests/host/support/RegistryHost.h"

using tessel::SystemVariables;

namespace
{
constexpr const wchar_t* kStoredUnder = L"Software\\Tessel\\R21\\Variables";

class Variables : public testing::Test
{
protected:
    Variables() { start(); }

    // The host starts, with what the registry holds.
    void start()
    {
        auto* registry = tessel::running<tessel::LayeredRegistry>();
        published.reset();
        variables = std::make_unique<SystemVariables>(registry, L"Software\\Tessel\\R21");
        published.emplace(*variables);
    }

    RegistryHost host;
    std::unique_ptr<SystemVariables> variables;
    std::optional<tessel::Published<SystemVariables>> published;
};
} // namespace

TEST_F(Variables, HaveTheirValuesAtTheFirstStart)
{
    EXPECT_EQ(variables->number(L"LISPENABLED"), 1);
    EXPECT_EQ(variables->number(L"REMOVINGTSLISP"), 1);
    EXPECT_EQ(variables->text(L"SEARCHPATH"), L"");
    EXPECT_EQ(variables->text(L"TESSELVERSION"), L"R21");
    for (const auto& variable : variables->all())
        EXPECT_FALSE(variable.purpose.empty());
}

TEST_F(Variables, AreFoundWithoutRegardToCase)
{
    ASSERT_NE(variables->find(L"LispEnabled"), nullptr);
    EXPECT_EQ(variables->find(L"lispenabled"), variables->find(L"LISPENABLED"));
    EXPECT_EQ(variables->find(L"LISPENABLE"), nullptr);
    EXPECT_EQ(variables->find(L""), nullptr);
    EXPECT_EQ(variables->number(L"NOSUCH"), 0);
    EXPECT_EQ(variables->text(L"NOSUCH"), L"");
}

TEST_F(Variables, TakeOnlyWhatIsInTheirRange)
{
    EXPECT_EQ(variables->set(L"lispenabled", L"0").sentence(), L"");
    EXPECT_EQ(variables->number(L"LISPENABLED"), 0);
    for (const wchar_t* wrong :
         {L"2", L"-1", L"", L"on", L"1x", L" 1", L"1.0", L"32768", L"99999999999999999999"})
        EXPECT_EQ(variables->set(L"LISPENABLED", wrong).sentence(),
                  L"LISPENABLED takes a whole number from 0 to 1.")
            << wrong;
    EXPECT_EQ(variables->number(L"LISPENABLED"), 0);
    EXPECT_EQ(variables->set(L"LISPENABLED", L"1").sentence(), L"");
    EXPECT_EQ(variables->text(L"LISPENABLED"), L"1");
}

TEST_F(Variables, TellUnknownNamesAndThoseThatCanOnlyBeRead)
{
    EXPECT_EQ(variables->set(L"NoSuch", L"1").sentence(), L"There is no variable called \"NoSuch\".");
    EXPECT_EQ(variables->set(L"tesselversion", L"R22").sentence(), L"TESSELVERSION can only be read.");
    EXPECT_EQ(variables->text(L"TESSELVERSION"), L"R21");
}

TEST_F(Variables, KeepStoredOnesFromStartToStart)
{
    EXPECT_EQ(variables->set(L"SEARCHPATH", L"/büro;/a b").sentence(), L"");
    EXPECT_EQ(variables->set(L"REMOVINGTSLISP", L"0").sentence(), L"");
    EXPECT_EQ(variables->set(L"LISPENABLED", L"0").sentence(), L"");
    EXPECT_TRUE(host.registry().endOfCommand());
    host.open();
    start();
    EXPECT_EQ(variables->text(L"SEARCHPATH"), L"/büro;/a b");
    EXPECT_EQ(variables->number(L"REMOVINGTSLISP"), 0);
    EXPECT_EQ(variables->number(L"LISPENABLED"), 1) << "of one session only";
}

TEST_F(Variables, PassOverStoredValuesThatDoNotFit)
{
    for (const wchar_t* wrong : {L"7", L"none", L"", L"99999"})
    {
        EXPECT_TRUE(host.registry().write(kStoredUnder, L"REMOVINGTSLISP", wrong));
        start();
        EXPECT_EQ(variables->number(L"REMOVINGTSLISP"), 1) << wrong;
    }
    EXPECT_TRUE(host.registry().write(kStoredUnder, L"TESSELVERSION", L"R99"));
    EXPECT_TRUE(host.registry().write(kStoredUnder, L"LISPENABLED", L"0"));
    start();
    EXPECT_EQ(variables->text(L"TESSELVERSION"), L"R21");
    EXPECT_EQ(variables->number(L"LISPENABLED"), 1);
}

TEST_F(Variables, SayWhenTheyCannotBeStored)
{
    host.close();
    std::filesystem::permissions(host.file(), std::filesystem::perms::owner_read);
    host.open();
    start();
    EXPECT_EQ(variables->set(L"SEARCHPATH", L"/x").sentence(),
              L"SEARCHPATH is set for this session only: the registry cannot be written.");
    EXPECT_EQ(variables->text(L"SEARCHPATH"), L"/x");
    EXPECT_EQ(variables->set(L"LISPENABLED", L"0").sentence(), L"") << "that one is not stored anyway";
}

TEST_F(Variables, StartWithoutARegistry)
{
    host.close();
    start();
    EXPECT_EQ(variables->number(L"LISPENABLED"), 1);
    EXPECT_EQ(variables->set(L"SEARCHPATH", L"/x").sentence(), L"");
}

TEST_F(Variables, AreGivenToApplicationsWithTheirTypes)
{
    TsResultBuffer result = {};
    EXPECT_EQ(tsedGetVar(L"LispEnabled", &result), TS_NORMAL);
    EXPECT_EQ(result.type, TS_SHORT);
    EXPECT_EQ(result.value.shortNumber, 1);
    EXPECT_EQ(tsedGetVar(L"TESSELVERSION", &result), TS_NORMAL);
    EXPECT_EQ(result.type, TS_STRING);
    EXPECT_STREQ(result.value.string, L"R21");
    delete[] result.value.string;
    EXPECT_EQ(tsedGetVar(L"SEARCHPATH", &result), TS_NORMAL);
    EXPECT_STREQ(result.value.string, L"");
    delete[] result.value.string;
}

TEST_F(Variables, LeaveTheResultAloneWhenThereIsNone)
{
    TsResultBuffer result = {nullptr, TS_NIL, {}};
    EXPECT_EQ(tsedGetVar(L"NOSUCH", &result), TS_ERROR);
    EXPECT_EQ(tsedGetVar(nullptr, &result), TS_ERROR);
    EXPECT_EQ(tsedGetVar(L"LISPENABLED", nullptr), TS_ERROR);
    published.reset();
    EXPECT_EQ(tsedGetVar(L"LISPENABLED", &result), TS_ERROR);
    EXPECT_EQ(result.type, TS_NIL);
}
