// Questions of applications: put to whoever is there to answer, and asked again where the answer does not
// fit.
#pragma once

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "host/text/Result.h"

namespace tessel
{
class CommandLine;
class Interruption;

// Who answers: a person at a terminal, or the lines of a script.
class Answerer
{
public:
    Answerer() = default;
    Answerer(const Answerer&) = delete;
    Answerer& operator=(const Answerer&) = delete;
    virtual ~Answerer() = default;

    // Shows the prompt and waits for a line; nothing when it is cancelled.
    virtual std::optional<std::wstring> answer(const std::wstring& prompt) = 0;

    // Whether it may be asked again.
    virtual bool isPerson() const = 0;
};

class Questions
{
public:
    // `interruption` is told when a question is over: Ctrl-C has then not been pressed in vain.
    Questions(CommandLine& commandLine, Interruption& interruption)
        : mCommandLine(commandLine), mInterruption(interruption)
    {
    }
    Questions(const Questions&) = delete;
    Questions& operator=(const Questions&) = delete;

    // From its making to its end, this one is asked.
    class Asked
    {
    public:
        Asked(Questions& questions, Answerer& answerer) : mQuestions(questions)
        {
            mQuestions.mAnswerers.push_back(&answerer);
        }
        ~Asked() { mQuestions.mAnswerers.pop_back(); }
        Asked(const Asked&) = delete;
        Asked& operator=(const Asked&) = delete;

    private:
        Questions& mQuestions;
    };

    struct Question
    {
        std::wstring text;
        std::wstring choices; // what can be answered; often empty
        std::optional<std::wstring> byDefault;
    };

    // Takes an answer, or tells in a sentence why it does not fit.
    using Taker = std::function<Result<>(const std::wstring& answer)>;

    // Whether there is a person who would be asked.
    bool asksPerson() const { return !mAnswerers.empty() && mAnswerers.back()->isPerson(); }

    // Whether the question was answered.
    bool ask(const Question& question, const Taker& take);

private:
    bool askNobody(const Question& question, const Taker& take);
    std::optional<std::wstring> answerOf(Answerer& asked, const Question& question);

    CommandLine& mCommandLine;
    Interruption& mInterruption;
    std::vector<Answerer*> mAnswerers; // the last one is asked
};
} // namespace tessel
