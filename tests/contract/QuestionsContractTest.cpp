#include <tessel/tsask.h>
#include <tessel/tsedcommands.h>

#include "tests/contract/ContractTest.h"

namespace
{
// A command takes nothing: what it asks, and what came of it.
std::function<int()> theQuestion;
int theStatus = 0;

void ask()
{
    theStatus = theQuestion();
}

class QuestionsContract : public ContractTest
{
protected:
    QuestionsContract()
    {
        TsEdCommandStack::cast(tsrxSysRegistry()->at(TSED_REGISTERED_COMMANDS))
            ->addCommand(L"CONTRACT", L"CONTRACTASK", L"CONTRACTASK", 0, ask);
    }

    // The status, when the lines follow the command in a script.
    int asked(const std::function<int()>& asks, const std::vector<std::wstring>& lines) const
    {
        theQuestion = asks;
        theStatus = -1;
        std::vector<std::wstring> script = {L"CONTRACTASK"};
        script.insert(script.end(), lines.begin(), lines.end());
        host->typeScript(script);
        return theStatus;
    }

    int askedText(const wchar_t* byDefault, const std::vector<std::wstring>& lines, std::size_t capacity = 20)
    {
        return asked([&] { return tsaskText(L"Text", byDefault, text, capacity); }, lines);
    }

    int askedNumber(const double* byDefault, const std::vector<std::wstring>& lines)
    {
        return asked([&] { return tsaskNumber(L"Number", byDefault, &number); }, lines);
    }

    int askedYesOrNo(const bool* byDefault, const std::vector<std::wstring>& lines)
    {
        return asked([&] { return tsaskYesOrNo(L"Really?", byDefault, &yes); }, lines);
    }

    int askedFile(const wchar_t* byDefault, bool mustExist, const std::vector<std::wstring>& lines)
    {
        return asked([&] { return tsaskFile(L"File", byDefault, mustExist, path, kPathSize); }, lines);
    }

    wchar_t text[20] = L"before";
    wchar_t path[kPathSize] = L"before";
    double number = 7;
    bool yes = false;
};

TEST_F(QuestionsContract, TakesATextAsItIsTyped)
{
    EXPECT_EQ(askedText(nullptr, {L"  two words "}), TSASK_ANSWERED);
    EXPECT_STREQ(text, L"  two words ");
    EXPECT_EQ(askedText(nullptr, {L""}), TSASK_ANSWERED);
    EXPECT_STREQ(text, L"");
}

TEST_F(QuestionsContract, TakesTheDefaultForAnEmptyLine)
{
    EXPECT_EQ(askedText(L"usual", {L" "}), TSASK_ANSWERED);
    EXPECT_STREQ(text, L"usual");
    const double usual = 0.25;
    EXPECT_EQ(askedNumber(&usual, {L""}), TSASK_ANSWERED);
    EXPECT_EQ(number, usual);
    const bool usually = true;
    EXPECT_EQ(askedYesOrNo(&usually, {L""}), TSASK_ANSWERED);
    EXPECT_TRUE(yes);
    EXPECT_EQ(askedText(L"usual", {L"other"}), TSASK_ANSWERED);
    EXPECT_STREQ(text, L"other");
}

TEST_F(QuestionsContract, IsCancelledByTheEndOfTheInput)
{
    EXPECT_EQ(askedText(L"usual", {}), TSASK_CANCELLED);
    EXPECT_STREQ(text, L"before");
    EXPECT_EQ(askedNumber(nullptr, {}), TSASK_CANCELLED);
    EXPECT_EQ(number, 7);
}

TEST_F(QuestionsContract, TakesTheDefaultWhereNobodyIsThere)
{
    const auto alone = [&](const wchar_t* byDefault)
    {
        theQuestion = [this, byDefault]
        {
            return tsaskText(L"Text", byDefault, text, 20);
        };
        host->type(L"CONTRACTASK");
        return theStatus;
    };
    EXPECT_EQ(alone(nullptr), TSASK_CANCELLED);
    EXPECT_STREQ(text, L"before");
    EXPECT_EQ(alone(L"usual"), TSASK_ANSWERED);
    EXPECT_STREQ(text, L"usual");
}

TEST_F(QuestionsContract, TakesNumbers)
{
    for (const auto& [line, expected] : {std::pair(L"12", 12.0), std::pair(L" -0.5 ", -0.5),
                                         std::pair(L"+1e3", 1000.0), std::pair(L".5", 0.5)})
    {
        EXPECT_EQ(askedNumber(nullptr, {line}), TSASK_ANSWERED);
        EXPECT_EQ(number, expected);
    }
    for (const wchar_t* noNumber :
         {L"", L"twelve", L"1,5", L"1 2", L"0x10", L"inf", L"nan", L"1e999", L"+-1"})
        EXPECT_EQ(askedNumber(nullptr, {noNumber}), TSASK_CANCELLED) << noNumber;
    EXPECT_EQ(number, 0.5) << "as it was";
}

TEST_F(QuestionsContract, TakesYesAndNo)
{
    for (const wchar_t* line : {L"Yes", L"y", L"YE", L" yes "})
    {
        yes = false;
        EXPECT_EQ(askedYesOrNo(nullptr, {line}), TSASK_ANSWERED);
        EXPECT_TRUE(yes) << line;
    }
    EXPECT_EQ(askedYesOrNo(nullptr, {L"N"}), TSASK_ANSWERED);
    EXPECT_FALSE(yes);
    for (const wchar_t* neither : {L"", L"yess", L"1", L"maybe"})
        EXPECT_EQ(askedYesOrNo(nullptr, {neither}), TSASK_CANCELLED) << neither;
}

TEST_F(QuestionsContract, TakesAFileByItsFullPath)
{
    const std::wstring there = host->makeFile(L"there.txt");
    const std::wstring folder = there.substr(0, there.rfind(L'/'));
    host->enterFolder(folder);
    EXPECT_EQ(askedFile(nullptr, true, {L"there.txt"}), TSASK_ANSWERED);
    EXPECT_EQ(path, there);
    EXPECT_EQ(askedFile(nullptr, true, {L"\"" + there + L"\""}), TSASK_ANSWERED);
    EXPECT_EQ(path, there);
    EXPECT_EQ(askedFile(there.c_str(), true, {L""}), TSASK_ANSWERED);
    EXPECT_EQ(askedFile(nullptr, false, {L"new.txt"}), TSASK_ANSWERED);
    EXPECT_EQ(path, folder + L"/new.txt");
    for (const std::wstring& none : {std::wstring(L"new.txt"), folder, std::wstring(L"")})
        EXPECT_EQ(askedFile(nullptr, true, {none}), TSASK_CANCELLED) << none;
    EXPECT_EQ(askedFile(nullptr, false, {L""}), TSASK_CANCELLED);
}

TEST_F(QuestionsContract, TakesNoMoreThanThereIsRoomFor)
{
    EXPECT_EQ(askedText(nullptr, {L"four"}, 5), TSASK_ANSWERED);
    EXPECT_STREQ(text, L"four");
    EXPECT_EQ(askedText(nullptr, {L"fives"}, 5), TSASK_CANCELLED);
    EXPECT_STREQ(text, L"four");
}

TEST_F(QuestionsContract, AsksNobodyWithoutAQuestionOrRoomForTheAnswer)
{
    EXPECT_EQ(tsaskText(nullptr, L"usual", text, 20), TSASK_INVALID);
    EXPECT_EQ(tsaskText(L"Text", L"usual", nullptr, 20), TSASK_INVALID);
    EXPECT_EQ(tsaskText(L"Text", L"usual", text, 0), TSASK_INVALID);
    EXPECT_EQ(tsaskNumber(L"Number", nullptr, nullptr), TSASK_INVALID);
    EXPECT_EQ(tsaskNumber(nullptr, nullptr, &number), TSASK_INVALID);
    EXPECT_EQ(tsaskYesOrNo(L"Really?", nullptr, nullptr), TSASK_INVALID);
    EXPECT_EQ(tsaskYesOrNo(nullptr, nullptr, &yes), TSASK_INVALID);
    EXPECT_EQ(tsaskFile(nullptr, nullptr, false, path, kPathSize), TSASK_INVALID);
    EXPECT_EQ(tsaskFile(L"File", nullptr, false, path, 0), TSASK_INVALID);
}

TEST_F(QuestionsContract, AsksNobodyWhereTheDefaultHasNoRoomForItsAnswer)
{
    EXPECT_EQ(askedText(L"fives", {L"four"}, 5), TSASK_INVALID);
    EXPECT_STREQ(text, L"before");
    EXPECT_EQ(askedText(L"four", {L""}, 5), TSASK_ANSWERED);
    EXPECT_STREQ(text, L"four");
    EXPECT_EQ(tsaskFile(L"File", L"/a/b", false, path, 4), TSASK_INVALID);
    EXPECT_EQ(tsaskFile(L"File", L"b", false, path, 2), TSASK_INVALID) << "the full path counts";
    EXPECT_STREQ(path, L"before");
}
} // namespace
