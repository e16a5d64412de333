#include <gmock/gmock.h>

#include <functional>
#include <vector>

#include "host/commands/CallingApplication.h"
#include "host/commands/EndRequest.h"
#include "host/messages/Questions.h"
#include "tests/host/support/HostParts.h"

using testing::ElementsAre;

namespace
{
// Does as a test says with each question.
class ScriptedWindows : public tessel::QuestionWindows
{
public:
    bool areOpen() const override { return open; }
    bool ask(const Asked& asked) const override
    {
        const auto now = answer; // it may say what the next one does
        return now(asked);
    }

    bool open = true;
    std::function<bool(const Asked& asked)> answer;
};

class NobodyElse : public tessel::Answerer
{
public:
    std::optional<std::wstring> answer(const std::wstring& prompt) override
    {
        prompts.push_back(prompt);
        return L"from elsewhere";
    }
    bool isPerson() const override { return true; }

    std::vector<std::wstring> prompts;
};

class QuestionsInWindows : public testing::Test
{
protected:
    bool ask(const tessel::Questions::Question& question)
    {
        return questions.ask(question,
                             [this](const std::wstring& answer) -> tessel::Result<>
                             {
                                 if (answer == L"no")
                                     return tessel::Failure{L"Not that."};
                                 taken.push_back(answer);
                                 return {};
                             });
    }

    CapturedOutput output;
    tessel::EndRequest endRequest;
    tessel::Interruption interruption{endRequest};
    ScriptedWindows windows;
    tessel::Questions questions{output.commandLine(), interruption, &windows};
    NobodyElse other;
    tessel::Questions::Asked asked{questions, other};
    std::vector<std::wstring> taken;
};
} // namespace

TEST_F(QuestionsInWindows, AreAskedThereAloneWhileOneIsOpen)
{
    windows.answer = [](const tessel::QuestionWindows::Asked& question)
    {
        EXPECT_EQ(question.take(L"no").sentence(), L"Not that.");
        return static_cast<bool>(question.take(L"yes"));
    };
    EXPECT_TRUE(ask({L"Why"}));
    EXPECT_THAT(taken, ElementsAre(L"yes"));
    EXPECT_THAT(other.prompts, ElementsAre());
    EXPECT_EQ(output.text(), "") << "the window says why an answer does not fit";
    windows.answer = [](const auto&)
    {
        return false;
    };
    EXPECT_FALSE(ask({L"Why"}));
}

TEST_F(QuestionsInWindows, AreAskedElsewhereWhileNoneIsOpen)
{
    windows.open = false;
    EXPECT_TRUE(ask({L"Why", {L"a", L"b", L"c"}, L"so"}));
    EXPECT_THAT(other.prompts, ElementsAre(L"Why [a/b/c] <so>: "));
    EXPECT_THAT(taken, ElementsAre(L"from elsewhere"));
}

TEST_F(QuestionsInWindows, BringAllThatIsAskedOnOneLine)
{
    windows.answer = [](const tessel::QuestionWindows::Asked& question)
    {
        EXPECT_EQ(question.question.text, L"Why  not");
        EXPECT_THAT(question.question.choices, ElementsAre(L"a", L"b"));
        EXPECT_EQ(question.question.byDefault, L"b");
        EXPECT_EQ(question.question.file, tessel::Questions::File::kThere);
        return true;
    };
    EXPECT_TRUE(ask({L"Why\t\nnot", {L"a", L"b"}, L"b", tessel::Questions::File::kThere}));
}

TEST_F(QuestionsInWindows, AreNamedByWhoAsks)
{
    tessel::Owned<tessel::CallingApplication> callers;
    std::vector<std::wstring> titles;
    windows.answer = [&](const tessel::QuestionWindows::Asked& question)
    {
        titles.push_back(question.title);
        return true;
    };
    EXPECT_TRUE(ask({L"Why"}));
    const tessel::CallingApplication::Scope calling(*callers, L"/a folder/moon.bundle");
    EXPECT_TRUE(ask({L"Why"}));
    EXPECT_THAT(titles, ElementsAre(L"Tessel", L"moon.bundle"));
}

TEST_F(QuestionsInWindows, AreCancelledByCtrlCAndByTheEndOfTheSession)
{
    windows.answer = [&](const tessel::QuestionWindows::Asked& question)
    {
        EXPECT_FALSE(question.isInterrupted());
        interruption.press(0);
        return question.isInterrupted();
    };
    EXPECT_TRUE(ask({L"Why"}));
    EXPECT_TRUE(ask({L"Why"})) << "the key before was not meant for this one";
    windows.answer = [&](const tessel::QuestionWindows::Asked& question)
    {
        endRequest.make();
        return question.isInterrupted();
    };
    EXPECT_TRUE(ask({L"Why"}));
}

TEST_F(QuestionsInWindows, LeaveTheOneAroundThemToTheNextKey)
{
    bool outerIsInterrupted = true;
    windows.answer = [&](const tessel::QuestionWindows::Asked& outer)
    {
        windows.answer = [&](const tessel::QuestionWindows::Asked& inner)
        {
            interruption.press(0);
            return inner.isInterrupted();
        };
        EXPECT_TRUE(ask({L"Why"}));
        outerIsInterrupted = outer.isInterrupted();
        interruption.press(0);
        return outer.isInterrupted();
    };
    EXPECT_TRUE(ask({L"Who"}));
    EXPECT_FALSE(outerIsInterrupted);
}

TEST_F(QuestionsInWindows, TakeNoPressOfTheKeyAsOneInVain)
{
    const tessel::Interruption::Work work(interruption);
    const auto pressTwice = [&]
    {
        return interruption.press(0) || interruption.press(0);
    };
    EXPECT_FALSE(pressTwice());
    windows.answer = [&](const auto&)
    {
        EXPECT_FALSE(pressTwice());
        return true;
    };
    EXPECT_TRUE(ask({L"Why"}));
    EXPECT_FALSE(pressTwice());
    EXPECT_TRUE(interruption.press(0));
}
