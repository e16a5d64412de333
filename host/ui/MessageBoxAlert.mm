#include "host/ui/MessageBoxAlert.h"

#import <AppKit/AppKit.h>

#include <tessel/tsmessagebox.h>
#include <tesselui/tsuidisplay.h>
#include <wincompat/winstring.h>

#include <unistd.h>

#include "host/text/Unicode.h"
#include "host/ui/SessionEnd.h"
#include "host/ui/Waiting.h"
#include "host/ui/platform/Windowing.h"

namespace
{
constexpr int kNotShown = 0;
bool gExpectsSomebody = false;

bool somebodyIsThere()
{
    return gExpectsSomebody || [NSApp modalWindow] != nil || isatty(STDIN_FILENO);
}

NSString* readable(const wchar_t* text)
{
    return text ? wcharToNSString(tessel::withReadableBytes(text).c_str()) : nil;
}
} // namespace

int tsuiShowMessageBox(const wchar_t* text, const wchar_t* detail, unsigned style, void* parent)
{
    // The box is modal for the whole program, over whatever window is modal already: the parent does not
    // matter.
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    int answer = kNotShown;
    if (somebodyIsThere() && tsuiHasDisplay() && tsuiPrepareWindows() && !tessel::sessionIsToEnd())
    {
        const tessel::Question question;
        tessel::windowing::runMessage(readable(text), readable(detail), style & MB_ICONEXCLAMATION);
        answer = IDOK;
        if (![NSApp modalWindow])
            tsuiFinishWindows();
    }
    [pool drain];
    return answer;
}

void tsuiExpectSomebody()
{
    gExpectsSomebody = true;
}

bool tsuiCanShowWindows()
{
    return tsuiHasDisplay();
}
