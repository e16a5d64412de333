// A line typed at a terminal: editing, history and completion by libedit.
#pragma once

#include <memory>
#include <string>
#include <vector>

#include "host/console/Completion.h"
#include "host/console/InputSource.h"

namespace tessel
{
class LineEditor
{
public:
    // Reads standard input and writes standard output. `earlier`: lines that the arrow keys bring back, the
    // oldest first. `sources`: of what the Tab key completes.
    LineEditor(const std::vector<std::wstring>& earlier, CompletionSources sources, InputSource source);
    ~LineEditor();
    LineEditor(const LineEditor&) = delete;
    LineEditor& operator=(const LineEditor&) = delete;

    enum class Outcome
    {
        kLine,
        kInterrupted, // Ctrl-C
        kEnd          // Ctrl-D on an empty line, the terminal has gone, or the session is to end
    };

    // Forgets what of Ctrl-C was pressed before now.
    void forgetInterrupts() const;

    // Waits for a line; `line` is set for kLine only, without its line break. `lispBefore`: the lines of a
    // Lisp expression that it goes on.
    Outcome read(const std::wstring& prompt, std::wstring& line, const std::wstring& lispBefore = {});
    // The same for a line that is no command: nothing is completed, and the arrow keys do not bring it back.
    Outcome readAnswer(const std::wstring& prompt, std::wstring& line);

private:
    struct Terminal;
    std::unique_ptr<Terminal> mTerminal;
};
} // namespace tessel
