#include "host/app/Program.h"

#include <algorithm>
#include <clocale>
#include <csignal>
#include <cstdio>
#include <cstring>
#include <istream>
#include <string_view>

#include <fcntl.h>
#include <langinfo.h>
#include <unistd.h>

#include "host/app/Host.h"
#include "host/app/Options.h"
#include "host/app/PersonalFolders.h"
#include "host/app/TerminalWindow.h"
#include "host/app/WindowBox.h"
#include "host/app/platform/Terminal.h"
#include "host/commands/LastWords.h"
#include "host/commands/TypedLine.h"
#include "host/console/Colours.h"
#include "host/console/Console.h"
#include "host/console/EndSignals.h"
#include "host/console/InterruptKey.h"
#include "host/console/LineEditor.h"
#include "host/console/Pager.h"
#include "host/console/PipedInput.h"
#include "host/console/SessionLog.h"
#include "host/console/StandardOutput.h"
#include "host/console/TerminalSize.h"
#include "host/console/TypedHistory.h"
#include "host/platform/ProductFolders.h"
#include "host/text/TerminalText.h"
#include "host/text/Translation.h"
#include "host/text/Unicode.h"
#include "host/text/Version.h"

namespace tessel
{
namespace
{
constexpr int kAllWell = 0;
constexpr int kSomethingFailed = 1;
constexpr int kEndedBySignal = 128; // and the signal's number, as shells have it

constexpr char kProgram[] = "Tessel";
constexpr char kHistoryFile[] = "history";
constexpr wchar_t kDialogCommand[] = L"_MODRIG"; // by the name that is the same in every language

// Lines are UTF-8 whatever the locale is called; only the character type is the host's to set.
void useUtf8()
{
    std::setlocale(LC_CTYPE, "");
    if (std::strcmp(nl_langinfo(CODESET), "UTF-8") != 0 && !std::setlocale(LC_CTYPE, "C.UTF-8"))
        std::setlocale(LC_CTYPE, "UTF-8");
}

// A reader that goes away and a file that grows too large are errors of one write, not the end of the host.
void surviveFailingWrites()
{
    std::signal(SIGPIPE, SIG_IGN);
    std::signal(SIGXFSZ, SIG_IGN);
}

// Where nobody has opened one of these the next file would take its place, and what is printed land in that.
// Writing to what is opened for reading fails, so that the loss is noticed.
void takeStandardDescriptors()
{
    for (const int descriptor : {STDIN_FILENO, STDOUT_FILENO, STDERR_FILENO})
        if (fcntl(descriptor, F_GETFD) < 0)
            static_cast<void>(open("/dev/null", O_RDONLY)); // the lowest number that is free
}

void greet(CommandLine& commandLine)
{
    commandLine.confirm(
        translated(L"{}. Type HELP for the list of commands, QUIT to leave.", programSentence()));
}

// Nothing but documents is to be printed then.
bool answersPrograms(const Options& options)
{
    return !options.commands.empty() && options.script.empty() &&
           std::ranges::all_of(options.commands,
                               [](const auto& command) { return isForPrograms(toWide(command)); });
}

// Each that fails has been told, and keeps the others from nothing.
bool loadFiles(Host& host, const std::vector<std::string>& files)
{
    bool allWell = true;
    for (const auto& file : files)
        allWell = (host.isEnding() || host.run(L"LOAD " + asPart(toWide(file)))) && allWell;
    return allWell;
}

// Without a display the command says so, which is no failure of a command, but all that was asked for here.
int showDialog(Host& host)
{
    const auto& windows = runningProductFolders().binaries;
    expectSomebodyAtTheDisplay(windows);
    const bool ran = host.run(kDialogCommand);
    host.showWhatWasNotTaken();
    return ran && canShowWindows(windows) ? kAllWell : kSomethingFailed;
}

int runBatch(Host& host, const Options& options)
{
    if (options.modrig)
        return showDialog(host);
    Console console(host.commandLine(), host.questions(), host);
    bool allWell = options.script.empty() || host.commandLine().tell(host.runScript(options.script));
    for (const auto& command : options.commands)
        allWell = (host.isEnding() || console.runLine(command)) && allWell;
    return allWell ? kAllWell : kSomethingFailed;
}

int converse(Host& host, const std::filesystem::path& profileFolder, InputSource source)
{
    TypedHistory history(profileFolder / kHistoryFile);
    const auto earlier = history.read();
    LineEditor editor(host.commandLine().tell(earlier) ? *earlier : std::vector<std::wstring>(),
                      host.completionSources(), source);
    Console(host.commandLine(), host.questions(), host).converse(editor, history);
    return kAllWell;
}

int runPipe(Host& host, InputSource source)
{
    PipedInput bytes(source);
    std::istream lines(&bytes);
    return Console(host.commandLine(), host.questions(), host).runLines(lines) ? kAllWell : kSomethingFailed;
}

int runSession(Host& host, const Options& options, const InterruptKey& interruptKey)
{
    const bool filesLoaded = loadFiles(host, options.files);
    const InputSource source(interruptKey.wakeUp(), host.endRequest());
    if (!options.isBatch() && isatty(STDIN_FILENO)) // the person has read which files were not loaded
        return converse(host, options.profileFolder, source);
    const int status = options.isBatch() ? runBatch(host, options) : runPipe(host, source);
    return filesLoaded ? status : kSomethingFailed;
}

// Nobody turns pages where nobody types.
bool isConversation(const Options& options)
{
    return !options.isBatch() && isatty(STDIN_FILENO) && isatty(STDOUT_FILENO);
}

OutputSurroundings surroundingsFor(const Options& options, StandardOutput& errors, SessionLog* log)
{
    OutputSurroundings surroundings;
    surroundings.screen = []
    {
        return terminalSize(STDOUT_FILENO);
    };
    surroundings.loudness = options.loudness;
    surroundings.errors = [&errors](std::string_view text)
    {
        errors.write(text);
    };
    surroundings.colours = showsColours(STDERR_FILENO);
    if (log)
        surroundings.record = [log](std::string_view text)
        {
            log->record(text);
        };
    if (isConversation(options))
        surroundings.pager = showInPager;
    return surroundings;
}

int runHost(Options options, StandardOutput& output, SessionLog* log)
{
    if (options.profileFolder.empty())
        options.profileFolder = personalFolder();
    const LastWords lastWords; // before Lisp takes a signal of them
    StandardOutput errors(STDERR_FILENO);
    Host host({options.profileFolder, layoutFolders(options.layoutFolder), options.safe,
               [&output](std::string_view text) { output.write(text); },
               surroundingsFor(options, errors, log)});
    const InterruptKey interruptKey(host); // applications that load at start may run away too
    const EndSignals endSignals(host);
    if (!options.modrig && !answersPrograms(options))
        greet(host.commandLine());
    if (!host.start())
        return kSomethingFailed;
    const int status = runSession(host, options, interruptKey);
    host.end();
    return EndSignals::received() == 0 ? status : kEndedBySignal + EndSignals::received();
}

// The sentences may repeat what anybody has made up.
int complain(const std::wstring& sentence, int status)
{
    std::fputs((toUtf8(forTerminal(sentence)) + "\n").c_str(), stderr);
    return status == kAllWell ? kSomethingFailed : status;
}

int runHost(const Options& options, StandardOutput& output)
{
    if (options.log.empty())
        return runHost(options, output, nullptr);
    auto log = SessionLog::open(options.log);
    if (!log)
        return complain(log.sentence(), kSomethingFailed);
    const int status = runHost(options, output, &*log);
    const auto written = log->finish();
    return written ? status : complain(written.sentence(), status);
}
} // namespace

int runProgram(int count, const char* const* arguments)
{
    useUtf8();
    usePersonsLanguage();
    surviveFailingWrites();
    takeStandardDescriptors();
    const auto program = runningProductFolders().binaries / kProgram;
    if (goesOnInTerminal(startOfProgram(count), programInTerminal(program)))
        return kAllWell;
    const auto parsed = parseOptions(count, arguments);
    StandardOutput output(STDOUT_FILENO);
    if (!parsed) // it repeats arguments that anybody may have made up
        std::fputs(toUtf8(forTerminal(parsed.sentence())).c_str(), stderr);
    int status = parsed.code();
    if (parsed && parsed->options)
        status = runHost(*parsed->options, output);
    else if (parsed)
        output.write(parsed->text);
    if (output.written())
        return status;
    return complain(
        translated(L"Tessel: some of the output could not be written: {}.", output.written().sentence()),
        status);
}
} // namespace tessel
