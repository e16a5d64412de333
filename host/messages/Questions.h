// Questions of applications: put to whoever is there to answer, and asked again where the answer does not
// fit. While a window of the host's is open the person is in front of that: it is asked in a window, too.
#pragma once

#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "host/commands/Interruption.h"
#include "host/text/Result.h"

namespace tessel
{
class CommandLine;
class QuestionWindows;

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
    // `interruption` is told when a question is over: Ctrl-C has then not been pressed in vain. `windows`
    // may be null: then no window is ever open.
    Questions(CommandLine& commandLine, Interruption& interruption, QuestionWindows* windows = nullptr)
        : mCommandLine(commandLine), mInterruption(interruption), mWindows(windows)
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

    // Which file the answer names, if any.
    enum class File
    {
        kNone,
        kThere,
        kThereOrNew
    };

    struct Question
    {
        std::wstring text;
        std::vector<std::wstring> choices = {}; // what can be answered; often nothing is named
        std::optional<std::wstring> byDefault = std::nullopt;
        File file = File::kNone;
    };

    // Takes an answer, or tells in a sentence why it does not fit.
    using Taker = std::function<Result<>(const std::wstring& answer)>;

    // Whether there is a person who would be asked.
    bool asksPerson() const { return !mAnswerers.empty() && mAnswerers.back()->isPerson(); }

    // Whether the question was answered.
    bool ask(const Question& question, const Taker& take);

private:
    bool askInWindow(const Question& question, const Taker& take);
    bool askNobody(const Question& question, const Taker& take);
    std::optional<std::wstring> answerOf(Answerer& asked, const Question& question);

    CommandLine& mCommandLine;
    Interruption& mInterruption;
    QuestionWindows* mWindows;
    std::vector<Answerer*> mAnswerers;       // the last one is asked
    std::optional<Interruption::Wish> mWish; // that the question in the window in front is cancelled
};

// Puts questions in windows, over those that are open.
class QuestionWindows
{
public:
    struct Asked
    {
        std::wstring title; // who asks
        Questions::Question question;
        Questions::Taker take;               // until it takes an answer, or the person cancels
        std::function<bool()> isInterrupted; // whether it is to be cancelled for the person
    };

    QuestionWindows() = default;
    QuestionWindows(const QuestionWindows&) = delete;
    QuestionWindows& operator=(const QuestionWindows&) = delete;
    virtual ~QuestionWindows() = default;

    // Whether a window of the host's waits for the person: only then can another be opened over it.
    virtual bool areOpen() const = 0;

    // Whether it was answered.
    virtual bool ask(const Asked& asked) const = 0;
};
} // namespace tessel
