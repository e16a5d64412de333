// The real Tessel at a terminal: what a person types, and what appears.
#pragma once

#include <chrono>
#include <string>
#include <string_view>
#include <vector>

#include <gtest/gtest.h>
#include <sys/types.h>

#include "tests/e2e/HostProcess.h"

class HostTerminal
{
public:
    struct Size
    {
        unsigned short columns;
        unsigned short rows;
    };

    // Starts the host of the session with these arguments on a terminal of its own. It is wide, unless told
    // otherwise: nothing a test looks for is broken over two lines.
    explicit HostTerminal(const HostSession& session, const std::vector<std::string>& arguments = {},
                          Size size = {200, 24});
    ~HostTerminal(); // kills a host that still runs
    HostTerminal(const HostTerminal&) = delete;
    HostTerminal& operator=(const HostTerminal&) = delete;

    // Keys as the terminal sends them: "\t" completes, "\r" is Return, kControlC and kControlD.
    void type(std::string_view keys) const;

    // As if the window were drawn larger or smaller.
    void resize(Size size) const;

    // Waits until the text appears after what was waited for before. False when the time is over.
    bool shows(std::string_view text) { return showsWithin(text, kHostTimeLimit); }
    bool showsWithin(std::string_view text, std::chrono::milliseconds time);

    // The same for the prompt; what appeared instead is told.
    testing::AssertionResult awaitPrompt()
    {
        return shows("Command: ") ? testing::AssertionSuccess() : testing::AssertionFailure() << screen();
    }

    // Waits for the end; the exit status as in HostResult. A host that does not end is killed.
    int waitForEnd();
    // The same after QUIT.
    int quit();

    // Everything that appeared, terminal sequences included.
    const std::string& screen() const { return mOutput; }

    pid_t process() const { return mProcess; }

private:
    bool readMore(std::chrono::steady_clock::time_point deadline);

    pid_t mProcess = 0;
    int mTerminal = -1;
    std::string mOutput;
    std::size_t mSeen = 0;
};

inline constexpr std::string_view kControlC = "\x03";
inline constexpr std::string_view kControlD = "\x04";

// Lisp that never ends. It tells by "begun" that it runs, which stands nowhere in the line that is typed.
inline const std::string kRunaway = "(progn (princ \"be\") (princ \"gun\") (loop))";

// At a prompt: Ctrl-C stops Lisp that runs away, or clears a line that was begun. A prompt follows.
testing::AssertionResult controlCStopsLisp(HostTerminal& terminal);
testing::AssertionResult controlCClearsTheLine(HostTerminal& terminal);
