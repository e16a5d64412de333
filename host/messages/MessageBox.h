// The host's message box: a window where there is something to show it with, text on the command line
// otherwise.
#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

#include <tessel/tsmessagebox.h>

namespace tessel
{
class CommandLine;

class MessageBox : public VqHostMessageBox
{
public:
    struct Box
    {
        std::wstring text;
        std::wstring detail; // why, in the words of the part that knows; often empty
        unsigned style = 0;
        void* parent = nullptr;
    };

    // Shows a box and answers the button's code, or 0 when it cannot. Must not throw.
    using Presenter = std::function<int(const Box& box)>;

    // Boxes are shown by the presenter, and as text where it cannot or where there is none.
    explicit MessageBox(CommandLine& commandLine, Presenter presenter = {});

    // An application learns from a bool that a file was not loaded, and shows a box of its own text. Nothing
    // in the SDK takes the reason from the one to the other, so it waits here for the box.
    //
    // Why something went wrong with the file: the detail of the next box, if that names the file.
    void explain(const std::wstring& path, const std::wstring& why);
    // What happened to the file was meant to: the next box, if it names the file, is not shown at all, and
    // the first button counts as chosen.
    void passOver(const std::wstring& path);

    // From now on boxes without a parent are kept, and the first button counts as chosen. Whoever shows one
    // over a window of its own talks to a person, who gets to see it.
    void collect();
    // The boxes that were kept; from now on they are shown again.
    std::vector<Box> takeCollected();

    // A box of the host's own; where the presenter cannot show it, or if they are wanted anyway, the lines.
    void show(const Box& box, const std::wstring& lines, bool linesToo);

    // As text, without the detail, which has been said on the command line by then: "Message: ..." on lines
    // of its own, and the first button counts as chosen.
    int show(const wchar_t* text, unsigned style, void* parent) override;

private:
    // What is known of a file before a box about it comes.
    struct FileNote
    {
        std::wstring path;
        std::wstring why;
        bool needsNoBox = false;
    };

    int present(const Box& box) const;
    void sayMessage(const std::wstring& text);
    FileNote takeNoteFor(const std::wstring& text);

    CommandLine& mCommandLine;
    Presenter mPresenter;
    std::optional<std::vector<Box>> mCollected; // while they are kept
    FileNote mNote;
};
} // namespace tessel
