// The conversation with the user: lines from a terminal, a pipe, a script or the program's arguments.
#pragma once

#include <filesystem>
#include <functional>
#include <iosfwd>
#include <string>
#include <string_view>

#include "host/console/InputAssembler.h"
#include "host/console/LineRunner.h"
#include "host/text/CommandLine.h"

namespace tessel
{
class FollowingLines;
class LineEditor;
class Questions;
class TypedHistory;

// What the host shows when it waits for a command, and when Lisp goes on on the next line.
inline constexpr wchar_t kPrompt[] = L"Command: ";
inline constexpr wchar_t kContinuationPrompt[] = L"     ... ";

class Console
{
public:
    // All are kept for the console's lifetime. What asks while a line runs is answered from where the line
    // came from.
    Console(CommandLine& commandLine, Questions& questions, LineRunner& runner);

    // Talks with the person at the terminal until the session ends: Ctrl-D, or a command. Ctrl-C gives a
    // fresh prompt, or stops the Lisp that is running. Each line joins the history before it runs.
    void converse(LineEditor& editor, TypedHistory& history);

    // Runs lines as if typed; each is printed after the prompt, so that the output is a transcript. A line
    // that fails does not keep the following ones from running. True when none failed. `file`: whose lines
    // they are, for what is told of them; often empty.
    bool runLines(std::istream& lines, const std::wstring& file = {});
    // The same with a line that nobody goes on after: there is no answer to what it asks.
    bool runLine(std::string_view line);

    // The same with an ordinary file of commands; what goes wrong is told with file and line. Fails when it
    // cannot be read, and without a sentence when one of its lines did: each has been told.
    Result<> runScript(const std::filesystem::path& script);

private:
    bool runEach(FollowingLines& lines, const std::wstring& file);
    bool runAt(const std::wstring& file, std::size_t line, const std::wstring& input);
    const wchar_t* prompt(const InputAssembler& input) const;
    void makeRoomForPrompt(const wchar_t* prompt);
    void echo(const InputAssembler& input, const std::wstring& line);
    bool tellIfUnfinished(const std::wstring& file, std::size_t line, const InputAssembler& input);

    CommandLine& mCommandLine;
    Questions& mQuestions;
    LineRunner& mRunner;
};
} // namespace tessel
