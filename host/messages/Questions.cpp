#include "host/messages/Questions.h"

#include <algorithm>

#include <tessel/tssession.h>

#include "host/commands/Interruption.h"
#include "host/messages/Answers.h"
#include "host/text/CommandLine.h"
#include "host/text/TerminalText.h"

namespace tessel
{
namespace
{
// On one line, and nothing that a terminal would take for an order.
std::wstring shown(const std::wstring& text)
{
    std::wstring line = forTerminal(text);
    std::ranges::replace_if(
        line, [](wchar_t c) { return c == L'\n' || c == L'\t'; }, L' ');
    return line;
}

std::wstring promptOf(const Questions::Question& question)
{
    std::wstring prompt = shown(question.text);
    if (!question.choices.empty())
        prompt += L" [" + question.choices + L"]";
    if (question.byDefault)
        prompt += L" <" + shown(*question.byDefault) + L">";
    return prompt + L": ";
}
} // namespace

bool Questions::ask(const Question& question, const Taker& take)
{
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
