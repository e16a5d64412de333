#include "host/messagebox/MessageBox.h"

#include <utility>

#include "host/Services.h"
#include "host/console/CommandLine.h"

namespace tessel
{
void MessageBox::setPresenter(Presenter presenter)
{
    mPresenter = std::move(presenter);
}

int MessageBox::show(const wchar_t* text, unsigned style, void* parent)
{
    const std::wstring message = text ? text : L"";
    if (const int answer = mPresenter ? mPresenter(message, style, parent) : 0)
        return answer;
    if (auto* commandLine = services().commandLine)
        commandLine->say(L"Message: " + message);
    return IDOK; // every style begins with the button OK
}
} // namespace tessel

VqHostMessageBox* VqHostMessageBox::simple()
{
    static tessel::MessageBox withoutHost; // never null, not even while the host starts or ends
    auto* running = tessel::services().messageBox;
    return running ? running : &withoutHost;
}
