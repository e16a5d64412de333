#include <tessel/tsed.h>

#include "tests/contract/ContractTest.h"

using testing::ElementsAre;
using testing::IsEmpty;

namespace
{
class LispContract : public ContractTest
{
protected:
    LispContract()
    {
        for (const wchar_t* word : {L"one", L"two", L"three"})
            host->tellLisp(prompt(word), std::wstring(word) + L";");
        host->tellLisp(L"(error \"told to\")", std::nullopt);
    }

    static std::wstring prompt(const std::wstring& word) { return L"(prompt \"" + word + L";\")"; }
    static void queue(const std::wstring& expression) { qxr_queueexpr(expression.c_str()); }

    // What the user has seen since the last call.
    std::wstring newlySeen()
    {
        const std::wstring all = host->seen();
        const std::wstring now = all.substr(mSeen);
        mSeen = all.size();
        return now;
    }

    static std::optional<std::vector<RecordingValue>> invoke(std::initializer_list<TsRbValue> call)
    {
        TsResultBuffer* list = tsutBuildList(call);
        TsResultBuffer* result = nullptr;
        const int status = tsedInvoke(list, &result);
        const std::vector<RecordingValue> values = recordedValues(result);
        tsutRelRb(list);
        tsutRelRb(result);
        if (status == TS_NORMAL)
            return values;
        EXPECT_EQ(status, TS_ERROR);
        return std::nullopt;
    }

private:
    std::size_t mSeen = 0;
};

TEST_F(LispContract, EvaluatesQueuedExpressionsWhenIdleAndInOrder)
{
    newlySeen();
    for (const wchar_t* word : {L"one", L"two", L"three"})
        queue(prompt(word));
    EXPECT_EQ(newlySeen(), L"");
    host->becomeIdle();
    EXPECT_TRUE(contains(newlySeen(), L"one;two;three;"));
    host->becomeIdle();
    EXPECT_FALSE(contains(newlySeen(), L"one;"));
}

TEST_F(LispContract, GoesOnAfterAnExpressionThatFails)
{
    newlySeen();
    queue(prompt(L"one"));
    queue(L"(error \"told to\")");
    queue(prompt(L"two"));
    host->becomeIdle();
    const std::wstring seen = newlySeen();
    const std::size_t one = seen.find(L"one;");
    const std::size_t two = seen.find(L"two;");
    ASSERT_NE(one, std::wstring::npos);
    ASSERT_NE(two, std::wstring::npos);
    // One line of text stands between the two.
    const std::wstring between = seen.substr(one + 4, two - one - 4);
    EXPECT_GT(between.size(), 2u);
    EXPECT_TRUE(between.ends_with(L"\n"));
}

TEST_F(LispContract, AnswersTheValueOfACalledFunctionAsAList)
{
    host->defineLisp(L"contract-list", L"(defun contract-list (a b c) (list a b c))",
                     [](const HostUnderTest::Values& arguments) { return std::optional(arguments); });
    const auto values = invoke({TsRbValue::String(L"contract-list"), TsRbValue::String(L"a \"\u00FC\" \\b"),
                                TsRbValue::Short(-3), TsRbValue::Real(0.5)});
    ASSERT_TRUE(values);
    ASSERT_EQ(values->size(), 3u);
    EXPECT_EQ(values->at(0), RecordingValue::String(L"a \"\u00FC\" \\b"));
    EXPECT_EQ(values->at(1).number, -3);
    EXPECT_EQ(values->at(2), RecordingValue::Real(0.5));
}

TEST_F(LispContract, AnswersNoListForNil)
{
    host->defineLisp(L"contract-nil", L"(defun contract-nil () nil)",
                     [](const HostUnderTest::Values&) { return HostUnderTest::Values(); });
    const auto values = invoke({TsRbValue::String(L"contract-nil")});
    ASSERT_TRUE(values);
    EXPECT_THAT(*values, IsEmpty());
}

TEST_F(LispContract, SaysThatACalledFunctionFailed)
{
    host->defineLisp(L"contract-fail", L"(defun contract-fail () (error \"told to\"))",
                     [](const HostUnderTest::Values&) { return std::nullopt; });
    newlySeen();
    EXPECT_FALSE(invoke({TsRbValue::String(L"contract-fail")}));
    EXPECT_TRUE(newlySeen().ends_with(L"\n"));
}

TEST_F(LispContract, CallsAFunctionAtOnceAndBeforeWhatIsQueued)
{
    host->defineLisp(L"contract-nil", L"(defun contract-nil () nil)",
                     [](const HostUnderTest::Values&) { return HostUnderTest::Values(); });
    newlySeen();
    queue(prompt(L"one"));
    EXPECT_TRUE(invoke({TsRbValue::String(L"contract-nil")}));
    EXPECT_FALSE(contains(newlySeen(), L"one;"));
    host->becomeIdle();
    EXPECT_TRUE(contains(newlySeen(), L"one;"));
}

TEST_F(LispContract, DoesNotCallAFunctionWithoutAName)
{
    EXPECT_FALSE(invoke({TsRbValue::Short(1)}));
}

TEST_F(LispContract, DoesNotChangeItsMindAboutRemovingLisp)
{
    const bool answer = RemovingTsLISP();
    queue(prompt(L"one"));
    host->becomeIdle();
    EXPECT_EQ(RemovingTsLISP(), answer);
}
} // namespace
