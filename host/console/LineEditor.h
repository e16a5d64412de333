// A line typed at a terminal: editing, history and completion by libedit.
#pragma once

#include <filesystem>
#include <functional>
#include <memory>
#include <string>
#include <vector>

namespace tessel
{
class LineEditor
{
public:
    using Names = std::function<std::vector<std::wstring>()>;

    // Reads standard input and writes standard output. The history is read from the file, if there is one,
    // and stored there at the end. `names`: what the Tab key completes. `interruptKey`: a descriptor that can
    // be read from when Ctrl-C was pressed.
    LineEditor(const std::filesystem::path& historyFile, Names names, int interruptKey);
    ~LineEditor();
    LineEditor(const LineEditor&) = delete;
    LineEditor& operator=(const LineEditor&) = delete;

    enum class Outcome
    {
        kLine,
        kInterrupted, // Ctrl-C
        kEnd          // Ctrl-D on an empty line, or the terminal has gone
    };

    // Waits for a line; `line` is set for kLine only, without its line break.
    Outcome read(const std::wstring& prompt, std::wstring& line);

private:
    struct Terminal;
    std::unique_ptr<Terminal> mTerminal;
};
} // namespace tessel
