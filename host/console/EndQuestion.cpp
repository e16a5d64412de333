#include "host/console/EndQuestion.h"

#include <cerrno>
#include <string>
#include <string_view>

#include <fcntl.h>
#include <termios.h>
#include <unistd.h>

#include "host/platform/Descriptor.h"
#include "host/text/Translation.h"

namespace tessel
{
namespace
{
// In UTF-8. A signal's handler asks, which translates nothing.
struct QuestionWords
{
    std::string question;
    std::string no;
    char yes = 'y';
};
QuestionWords theQuestion;

bool isYes(char answer)
{
    constexpr char kToSmall = 'a' - 'A';
    const char small = answer >= 'A' && answer <= 'Z' ? static_cast<char>(answer + kToSmall) : answer;
    return small == 'y' || small == theQuestion.yes; // scripts know the English word
}

// A terminal that gives whole lines and shows what is typed, for the time of a question.
class LineMode
{
public:
    explicit LineMode(int terminal) : mTerminal(terminal), mKnown(tcgetattr(terminal, &mBefore) == 0)
    {
        termios lines = mBefore;
        lines.c_lflag |= ICANON | ECHO;
        lines.c_iflag |= ICRNL;
        if (mKnown)
            tcsetattr(terminal, TCSAFLUSH, &lines); // what was typed before is no answer
    }
    ~LineMode()
    {
        if (mKnown)
            tcsetattr(mTerminal, TCSANOW, &mBefore);
    }
    LineMode(const LineMode&) = delete;
    LineMode& operator=(const LineMode&) = delete;

private:
    int mTerminal;
    termios mBefore = {};
    bool mKnown;
};

// A terminal that takes no text gives no answer either.
void show(int terminal, std::string_view text)
{
    [[maybe_unused]] const auto written = write(terminal, text.data(), text.size());
}

// The line's first character; 0 when there is none.
char readAnswer(int terminal)
{
    char first = 0;
    char next = 0;
    for (;;)
    {
        const ssize_t count = read(terminal, &next, 1);
        if (count < 0 && errno == EINTR)
            continue;
        if (count != 1 || next == '\n')
            return count == 1 ? first : '\0';
        first = first == 0 ? next : first;
    }
}
} // namespace

void prepareEndQuestion()
{
    theQuestion.question =
        "\n" +
        translatedInUtf8(
            L"What is running does not come back. End Tessel? What is not stored yet is lost. [y/N]") +
        " ";
    theQuestion.no = translatedInUtf8(L"Tessel waits on.") + "\n";
    theQuestion.yes = toUtf8(foldCase(translated(L"Yes"))).front();
}

EndAnswer askWhetherToEnd() noexcept
{
    const Descriptor terminal(open("/dev/tty", O_RDWR | O_CLOEXEC | O_NOCTTY));
    if (!terminal || tcgetpgrp(terminal.number()) != getpgrp())
        return EndAnswer::kNobodyToAsk;
    const LineMode lines(terminal.number());
    show(terminal.number(), theQuestion.question);
    const char answer = readAnswer(terminal.number());
    if (isYes(answer))
        return EndAnswer::kEnd;
    show(terminal.number(), theQuestion.no);
    return EndAnswer::kWaitOn;
}
} // namespace tessel
