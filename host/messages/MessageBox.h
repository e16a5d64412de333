// The host's message box: text on the command line, until something graphical takes over.
#pragma once

#include <functional>
#include <string>

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

    explicit MessageBox(CommandLine& commandLine);

    // From now on boxes are shown by the presenter, and as text where it cannot; an empty one brings the
    // text back.
    void setPresenter(Presenter presenter);

    // Why something went wrong with the file: the detail of the next box, if that names the file.
    void explain(const std::wstring& path, const std::wstring& why);

    // As text, without the detail, which has been said on the command line by then: "Message: ..." on lines
    // of its own, and the first button counts as chosen.
    int show(const wchar_t* text, unsigned style, void* parent) override;

private:
    std::wstring takeDetailFor(const std::wstring& text);

    CommandLine& mCommandLine;
    Presenter mPresenter;
    std::wstring mExplainedPath;
    std::wstring mWhy;
};
} // namespace tessel
