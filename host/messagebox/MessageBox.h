// The host's message box: text on the command line, until something graphical takes over.
#pragma once

#include <functional>
#include <string>

#include <tessel/tsmessagebox.h>

namespace tessel
{
class MessageBox : public VqHostMessageBox
{
public:
    // Shows a box and answers the button's code, or 0 when it cannot. Must not throw.
    using Presenter = std::function<int(const std::wstring& text, unsigned style, void* parent)>;

    // From now on boxes are shown by the presenter, and as text where it cannot; an empty one brings the
    // text back.
    void setPresenter(Presenter presenter);

    // As text: "Message: ..." on lines of its own, and the first button counts as chosen.
    int show(const wchar_t* text, unsigned style, void* parent) override;

private:
    Presenter mPresenter;
};
} // namespace tessel
