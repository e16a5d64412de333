#include "host/console/LineEditor.h"

#include <cerrno>
#include <cstdio>
#include <optional>

#include <histedit.h>

#include "host/console/TerminalInput.h"
#include "host/console/TerminalSignals.h"
#include "host/console/TerminalSize.h"
#include "host/console/TypedHistory.h"
#include "host/text/Credentials.h"
#include "host/text/DisplayWidth.h"
#include "host/text/Joined.h"
#include "host/text/TerminalText.h"
#include "host/text/Unicode.h"

namespace tessel
{
namespace
{
constexpr wchar_t kCompletionFunction[] = L"tessel-complete";

void showCandidates(const std::vector<std::wstring>& candidates)
{
    const std::wstring all = forTerminal(joined(candidates, L"  "));
    const auto screen = terminalSize(STDOUT_FILENO);
    std::fputc('\n', stdout);
    for (const auto& line : wrapped(all, screen ? screen->columns : all.size()))
        std::fprintf(stdout, "%s\n", toUtf8(line).c_str());
    std::fflush(stdout);
}
} // namespace

struct LineEditor::Terminal
{
    Terminal(const std::vector<std::wstring>& earlier, CompletionSources given, InputSource source);
    ~Terminal();
    Terminal(const Terminal&) = delete;
    Terminal& operator=(const Terminal&) = delete;

    static Terminal& of(EditLine* editor)
    {
        void* terminal = nullptr;
        el_wget(editor, EL_CLIENTDATA, &terminal);
        return *static_cast<Terminal*>(terminal);
    }
    static wchar_t* prompt(EditLine* editor) { return of(editor).promptText.data(); }
    static unsigned char complete(EditLine* editor, int);
    static int readCharacter(EditLine* editor, wchar_t* character);
    void obeySignals();

    void remember(const wchar_t* line);
    Outcome read(const std::wstring& prompt, std::wstring& line);

    bool readsCommand = true;
    CompletionSources sources;
    std::wstring lispBefore;
    TerminalInput input;
    std::optional<TerminalSignals> signals; // while a line is read
    std::wstring promptText;
    EditLine* editLine;
    HistoryW* history;
    HistEventW event{};
};

LineEditor::Terminal::Terminal(const std::vector<std::wstring>& earlier, CompletionSources given,
                               InputSource source)
    : sources(std::move(given)), input(source), editLine(el_init("Tessel", stdin, stdout, stderr)),
      history(history_winit())
{
    history_w(history, &event, H_SETSIZE, static_cast<int>(kMostHistoryLines));
    history_w(history, &event, H_SETUNIQUE, 1);
    for (const std::wstring& line : earlier)
        remember(line.c_str());
    el_wset(editLine, EL_CLIENTDATA, this);
    el_wset(editLine, EL_PROMPT, &Terminal::prompt);
    el_wset(editLine, EL_HIST, history_w, history);
    el_wset(editLine, EL_GETCFN, &Terminal::readCharacter);
    el_wset(editLine, EL_EDITOR, L"emacs");
    el_wset(editLine, EL_ADDFN, kCompletionFunction, L"completion", &Terminal::complete);
    el_wset(editLine, EL_BIND, L"^I", kCompletionFunction, nullptr);
}

LineEditor::Terminal::~Terminal()
{
    el_end(editLine);
    history_wend(history);
}

unsigned char LineEditor::Terminal::complete(EditLine* editor, int)
{
    if (!of(editor).readsCommand)
        return CC_REFRESH_BEEP;
    const LineInfoW* line = el_wline(editor);
    const std::wstring typed(line->buffer, line->cursor);
    const auto completion = tessel::complete(typed, of(editor).sources, of(editor).lispBefore);
    if (!completion)
        return CC_REFRESH_BEEP;
    if (!completion->candidates.empty() && completion->text.size() == completion->replaced)
    {
        showCandidates(completion->candidates);
        return CC_REDISPLAY;
    }
    el_wdeletestr(editor, static_cast<int>(completion->replaced));
    el_winsertstr(editor, completion->text.c_str());
    return CC_REFRESH;
}

// Whoever uses the terminal meanwhile finds it as usual, and leaves it as they like; the prompt comes back
// with what was typed.
void LineEditor::Terminal::obeySignals()
{
    const auto came = signals->take();
    if (came.stop)
    {
        el_wset(editLine, EL_PREP_TERM, 0);
        std::fputc('\n', stdout);
        std::fflush(stdout);
        signals->stop();
        static_cast<void>(signals->take()); // that it goes on
    }
    if (came.resize)
        el_resize(editLine);
    if (came.stop || came.resume)
        el_wset(editLine, EL_PREP_TERM, 1);
    std::fputc('\r', stdout); // over what may still stand there
    std::fflush(stdout);
    el_wset(editLine, EL_REFRESH);
}

// The editor's own reading would miss a Ctrl-C that comes between the prompt and the waiting.
int LineEditor::Terminal::readCharacter(EditLine* editor, wchar_t* character)
{
    TerminalInput::Outcome outcome{};
    while ((outcome = of(editor).input.read(*character)) == TerminalInput::Outcome::kWoken)
        of(editor).obeySignals();
    switch (outcome)
    {
    case TerminalInput::Outcome::kCharacter:
        return 1;
    case TerminalInput::Outcome::kWoken:
    case TerminalInput::Outcome::kInterrupted:
        errno = EINTR;
        return -1;
    case TerminalInput::Outcome::kEnd:
        break;
    }
    return 0;
}

void LineEditor::Terminal::remember(const wchar_t* line)
{
    const std::wstring kept = withoutCredentials(line); // what is not stored is not to be shown again either
    if (kept.find_first_not_of(L'\n') != kept.npos)
        history_w(history, &event, H_ENTER, kept.c_str());
}

LineEditor::LineEditor(const std::vector<std::wstring>& earlier, CompletionSources sources,
                       InputSource source)
    : mTerminal(std::make_unique<Terminal>(earlier, std::move(sources), source))
{
}

LineEditor::~LineEditor() = default;

LineEditor::Outcome LineEditor::read(const std::wstring& prompt, std::wstring& line,
                                     const std::wstring& lispBefore)
{
    mTerminal->readsCommand = true;
    mTerminal->lispBefore = lispBefore;
    const Outcome outcome = mTerminal->read(prompt, line);
    if (outcome == Outcome::kLine)
        mTerminal->remember((line + L"\n").c_str());
    return outcome;
}

LineEditor::Outcome LineEditor::readAnswer(const std::wstring& prompt, std::wstring& line)
{
    mTerminal->readsCommand = false;
    return mTerminal->read(prompt, line);
}

LineEditor::Outcome LineEditor::Terminal::read(const std::wstring& prompt, std::wstring& line)
{
    promptText = prompt;
    el_resize(editLine); // the window may have changed its size while a command ran
    // Before the prompt invites to type: a Ctrl-D that the terminal still takes for the end of a line is
    // lost.
    el_wset(editLine, EL_PREP_TERM, 1);
    int length = 0;
    signals.emplace();
    input.wakeBy(signals->wakeUp());
    errno = 0;
    const wchar_t* typed = el_wgets(editLine, &length);
    const int error = errno;
    input.wakeBy(-1);
    signals.reset();
    if (!typed || length <= 0)
        return error == EINTR ? Outcome::kInterrupted : Outcome::kEnd;
    line.assign(typed, static_cast<std::size_t>(length));
    while (!line.empty() && (line.back() == L'\n' || line.back() == L'\r'))
        line.pop_back();
    return Outcome::kLine;
}

void LineEditor::forgetInterrupts() const
{
    mTerminal->input.forgetInterrupts();
}
} // namespace tessel
