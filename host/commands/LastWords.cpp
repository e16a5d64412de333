#include "host/commands/LastWords.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <initializer_list>
#include <string>
#include <string_view>

#include <unistd.h>

#include "host/commands/RunningMarker.h"
#include "host/text/ControlCharacters.h"
#include "host/text/Running.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr int kEndedInFailure = 1;

// A full stack has no room for a handler.
alignas(16) std::array<char, std::size_t{64} << 10> theStack;

// A signal handler can be given nothing. Written before the handlers are in place.
std::array<struct sigaction, NSIG> theFormer;

// A line in pieces, made without memory of the system.
class Line
{
public:
    // What a file is called must not steer the terminal, and need not be text.
    void add(std::string_view text)
    {
        text = text.substr(0, mBytes.size() - 1 - mLength);
        for (std::size_t at = 0; at < text.size();)
        {
            const std::size_t start = at;
            const auto code = takeUtf8(text, at);
            const bool isShown = code && !isControl(*code);
            for (const char byte : text.substr(start, at - start))
                mBytes[mLength++] = isShown ? byte : '?';
        }
    }
    // The sentence with what belongs in its numbered places.
    void fill(std::string_view sentence, std::initializer_list<std::string_view> things)
    {
        while (!sentence.empty())
        {
            std::size_t before = 0;
            while (before < sentence.size() && Place::at(sentence.substr(before)).length == 0)
                ++before;
            add(sentence.substr(0, before));
            sentence.remove_prefix(before);
            const Place place = Place::at(sentence);
            add(place.length > 0 ? things.begin()[place.number - 1] : std::string_view());
            sentence.remove_prefix(place.length);
        }
    }
    std::string_view text() const { return {mBytes.data(), mLength}; }
    void print()
    {
        mBytes[mLength++] = '\n';
        [[maybe_unused]] const auto written = write(STDERR_FILENO, mBytes.data(), mLength);
    }

private:
    std::array<char, 6000> mBytes; // a path may have 4096
    std::size_t mLength = 0;
};

constexpr std::size_t kDeeds = static_cast<std::size_t>(RunningMarker::Deed::kLispFile) + 1;

// What can be said, in UTF-8, made while there is still time: a handler translates nothing.
struct PreparedWords
{
    std::string sentence;                  // with numbered places for these
    std::array<std::string, kDeeds> deeds; // with a place for the name of a command
    std::array<std::string, NSIG> endings; // by signal
    std::string calledExit;
};
PreparedWords theWords;

PreparedWords wordsInPersonsLanguage()
{
    PreparedWords words;
    words.sentence =
        toUtf8(translated(L"The application \"{}\" has ended Tessel {}: {}.", L"{1}", L"{2}", L"{3}"));
    for (std::size_t deed = 0; deed < words.deeds.size(); ++deed)
        words.deeds[deed] = toUtf8(wordsFor(static_cast<RunningMarker::Deed>(deed), L"{1}"));
    for (std::size_t signal = 0; signal < words.endings.size(); ++signal)
        words.endings[signal] = toUtf8(wordsForEnding(static_cast<int>(signal)));
    words.calledExit = toUtf8(wordsForEnding(RunningMarker::kCalledExit));
    return words;
}

std::string_view preparedWordsFor(int ending)
{
    return ending == RunningMarker::kCalledExit ? theWords.calledExit
                                                : theWords.endings[static_cast<std::size_t>(ending)];
}

// Nothing of what waits for a person is running, as far as anybody knows.
bool isAnothersDoing(int ending, const RunningMarker::AtWork& work)
{
    return work.waitsForPerson && (ending == RunningMarker::kCalledExit || ending == SIGINT);
}

// False when no application is at work.
bool speak(int ending)
{
    RunningMarker* marker = running<RunningMarker>();
    RunningMarker::AtWork work{};
    if (!marker || !marker->innermost(work) || isAnothersDoing(ending, work))
        return false;
    marker->noteEnding(ending);
    static Line line;
    static Line deed;
    deed.fill(theWords.deeds[static_cast<std::size_t>(work.deed)], {work.detail});
    line.fill(theWords.sentence, {work.path, deed.text(), preparedWordsFor(ending)});
    line.print();
    return true;
}

void onSignal(int signal, siginfo_t* information, void*)
{
    const int error = errno;
    speak(signal);
    sigaction(signal, &theFormer[static_cast<std::size_t>(signal)], nullptr);
    // A fault comes again by itself when the instruction does; what somebody has sent does not.
    if (information->si_code <= 0)
        raise(signal);
    errno = error;
}

void onExit()
{
    if (!speak(RunningMarker::kCalledExit))
        return;
    std::fflush(nullptr);
    _exit(kEndedInFailure);
}
} // namespace

bool sayLastWords(int signal)
{
    return speak(signal);
}

LastWords::LastWords()
{
    theWords = wordsInPersonsLanguage();
    stack_t stack = {};
    stack.ss_sp = theStack.data();
    stack.ss_size = theStack.size();
    sigaltstack(&stack, &mPreviousStack);
    struct sigaction action = {};
    action.sa_sigaction = onSignal;
    action.sa_flags = SA_SIGINFO | SA_ONSTACK;
    sigemptyset(&action.sa_mask);
    for (std::size_t index = 0; index < kSignals.size(); ++index)
    {
        sigaction(kSignals[index], nullptr, &mPrevious[index]);
        theFormer[static_cast<std::size_t>(kSignals[index])] = mPrevious[index];
        if (mPrevious[index].sa_handler != SIG_IGN)
            sigaction(kSignals[index], &action, nullptr);
    }
    // Nobody can take it back; without an application at work it does nothing.
    static const int once = std::atexit(onExit);
    static_cast<void>(once);
}

LastWords::~LastWords()
{
    for (std::size_t index = 0; index < kSignals.size(); ++index)
        sigaction(kSignals[index], &mPrevious[index], nullptr);
    sigaltstack(&mPreviousStack, nullptr);
}
} // namespace tessel
