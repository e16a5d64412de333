#include "host/messages/Questions.h"

#include <algorithm>
#include <utility>

#include <tessel/tsed.h>
#include <tessel/tssession.h>

#include "host/messages/Answers.h"
#include "host/text/CommandLine.h"
#include "host/text/Joined.h"
#include "host/text/TerminalText.h"

namespace tessel
{
namespace
{
constexpr wchar_t kHostName[] = L"Tessel";

// On one line, and nothing that a terminal would take for an order.
std::wstring shown(const std::wstring& text)
{
    std::wstring line = forTerminal(text);
    std::ranges::replace_if(
        line, [](wchar_t c) { return c == L'\n' || c == L'\t'; }, L' ');
    return line;
}

// What an application is called where there is no room for its folder.
std::wstring nameOfAsking()
{
    const std::wstring path = tsedGetAppName();
    return path.empty() ? kHostName : shown(path.substr(path.rfind(L'/') + 1));
}

std::wstring promptOf(const Questions::Question& question)
{
    std::wstring prompt = shown(question.text);
    if (!question.choices.empty())
        prompt += L" [" + joined(question.choices, L"/") + L"]";
    if (question.byDefault)
        prompt += L" <" + shown(*question.byDefault) + L">";
    return prompt + L": ";
}
} // namespace

bool Questions::ask(const Question& question, const Taker& take)
{
    if (mWindows && mWindows->areOpen())
        return askInWindow(question, take);
    if (mAnswerers.empty())
        return askNobody(question, take);
    Answerer& asked = *mAnswerers.back();
    tsrxBeforeWaiting(false);
    while (const auto answer = answerOf(asked, question))
    {
        const auto taken = take(*answer);
        if (mCommandLine.tell(taken))
            return true;
        if (!asked.isPerson())
            return false;
    }
    return false;
}

// The key is meant for the question in front: one around it begins to wait for another press.
bool Questions::askInWindow(const Question& question, const Taker& take)
{
    Question inWindow = question;
    inWindow.text = shown(question.text);
    mInterruption.settle();
    mWish.emplace(mInterruption);
    const bool answered = mWindows->ask({nameOfAsking(), std::move(inWindow), take,
                                         [this]
                                         {
                                             return mWish->isThere();
                                         }});
    mWish.emplace(mInterruption);
    mInterruption.settle();
    return answered;
}

std::optional<std::wstring> Questions::answerOf(Answerer& asked, const Question& question)
{
    mInterruption.settle();
    auto answer = asked.answer(promptOf(question));
    mInterruption.settle();
    if (answer && question.byDefault && trimmed(*answer).empty())
        return question.byDefault;
    return answer;
}

bool Questions::askNobody(const Question& question, const Taker& take)
{
    mCommandLine.say(promptOf(question) + (question.byDefault ? shown(*question.byDefault) : L""));
    return question.byDefault && mCommandLine.tell(take(*question.byDefault));
}
} // namespace tessel
