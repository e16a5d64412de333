// The host's message box.
#pragma once

#include "tsdefs.h"

inline constexpr unsigned MB_OK = 0x0;
inline constexpr unsigned MB_ICONEXCLAMATION = 0x30; // 48: one OK button, exclamation icon
inline constexpr int IDOK = 1;

class TESSEL_API VqHostMessageBox
{
public:
    VqHostMessageBox() = default;
    VqHostMessageBox(const VqHostMessageBox&) = delete;
    VqHostMessageBox& operator=(const VqHostMessageBox&) = delete;
    virtual ~VqHostMessageBox() = default;

    // The plain box of the host. Never null.
    static VqHostMessageBox* simple();

    // Shows the text until the user answers, over `parent` (a window of the platform, or null for the active
    // one), and answers the button's code. Without a display the text is printed on the command line, marked
    // as a message, and the first button counts as chosen. So it does while the host starts, unless there is
    // a `parent`: the text is then shown with all others when the start is over.
    virtual int show(const wchar_t* text, unsigned style, void* parent) = 0;
};
