// Where the host's text goes: the terminal, a pipe, or a test's buffer.
#pragma once

#include <cstddef>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "host/text/Result.h"

namespace tessel
{
class Table;

// In cells, of which a wide character takes two, and in lines.
struct ScreenSize
{
    std::size_t columns;
    std::size_t rows;
};

// How much a person wants to read.
enum class Loudness
{
    kQuiet, // what was asked for, and what went wrong
    kUsual,
    kTalkative // also what is done meanwhile
};

// What may be known about where the text goes.
struct OutputSurroundings
{
    using Sink = std::function<void(std::string_view)>;

    std::function<std::optional<ScreenSize>()> screen = {}; // asked each time; nothing: no screen
    Loudness loudness = Loudness::kUsual;
    Sink errors = {};     // receives what nobody has asked for, whole lines; none: as the rest
    bool colours = false; // errors in red
    Sink record = {};     // receives everything once more without colours, and what is typed
    // Shows a list of whole lines that does not fit on the screen; false when it cannot. None: there is
    // nobody to turn pages.
    std::function<bool(const std::string& list)> pager = {};
};

class CommandLine
{
public:
    // Receives UTF-8 and must not throw; it is called with whole pieces, in order.
    using Sink = OutputSurroundings::Sink;

    explicit CommandLine(Sink write, OutputSurroundings surroundings = {});

    // Prints the text as it stands, but for what a terminal would take for orders (see `forTerminal`).
    void print(std::wstring_view text);

    // Goes back to where the open line begins: what is printed next stands in its place.
    void returnToLineStart();

    // Prints one sentence on a line of its own: after a line break if something stands on the line already,
    // and with a line break after it.
    void say(std::wstring_view sentence);

    // Says that something was done as it was wished: nothing where it is to be quiet.
    void confirm(std::wstring_view sentence);

    // Says what nobody has asked for, but should know: about the profile, about what is not loaded.
    void warn(std::wstring_view sentence);

    // Says what is being done, where a person wants to know: only there are the words looked for.
    void explain(const std::function<std::wstring()>& sentence);
    bool isQuiet() const { return mSurroundings.loudness == Loudness::kQuiet; }

    // Says a table that was asked for, as wide as the screen; without a screen a row is a line. What does not
    // fit on the screen goes through the pager.
    void show(const Table& table);
    // The same with lines of any length.
    void show(const std::vector<std::wstring>& lines);

    // Says what went wrong, if anything did, and where. Answers whether all went well.
    bool tell(const Outcome& outcome);

    // What goes wrong while this lasts does so there: "names.scr:3". These nest; the innermost is told.
    class Place
    {
    public:
        Place(CommandLine& commandLine, std::wstring place) : mCommandLine(commandLine)
        {
            mCommandLine.mPlaces.push_back(std::move(place));
        }
        ~Place() { mCommandLine.mPlaces.pop_back(); }
        Place(const Place&) = delete;
        Place& operator=(const Place&) = delete;

    private:
        CommandLine& mCommandLine;
    };

    // A person has typed this, and sees it already.
    void noteTyped(std::wstring_view text);

    // Whether the next character starts a line.
    bool atLineStart() const { return mOpenLine.empty(); }

    // What stands on the line that is not ended yet: a console must not print its prompt beside it.
    const std::wstring& openLine() const { return mOpenLine; }

private:
    void write(std::string_view text);
    enum class Aside
    {
        kPlain,
        kError
    };
    void sayAside(std::wstring_view sentence, Aside kind);

    Sink mWrite;
    OutputSurroundings mSurroundings;
    std::wstring mOpenLine;
    std::vector<std::wstring> mPlaces;
};
} // namespace tessel
