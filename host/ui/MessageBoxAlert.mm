#include "host/ui/MessageBoxAlert.h"

#import <AppKit/AppKit.h>

#include <tessel/tsmessagebox.h>
#include <tesselui/tsuidisplay.h>
#include <wincompat/winstring.h>

#include <unistd.h>

#include "host/ui/SessionEnd.h"

namespace
{
constexpr int kNotShown = 0;

bool somebodyIsThere()
{
    return [NSApp modalWindow] != nil || isatty(STDIN_FILENO);
}

void runAlert(const wchar_t* text, unsigned style)
{
    NSAlert* alert = [[[NSAlert alloc] init] autorelease];
    [alert setMessageText:@"Tessel"];
    [alert setInformativeText:wcharToNSString(text)];
    [alert setAlertStyle:style & MB_ICONEXCLAMATION ? NSWarningAlertStyle : NSInformationalAlertStyle];
    [alert setIcon:[NSApp applicationIconImage]];
    [alert addButtonWithTitle:@"OK"];
    [alert runModal];
}
} // namespace

int tsuiShowMessageBox(const wchar_t* text, unsigned style, void* parent)
{
    (void)parent; // the box is modal for the whole program, over whatever window is in front
    NSAutoreleasePool* pool = [[NSAutoreleasePool alloc] init];
    int answer = kNotShown;
    if (somebodyIsThere() && tsuiHasDisplay() && tsuiPrepareWindows() && !tessel::sessionIsToEnd())
    {
        runAlert(text, style);
        answer = IDOK;
        if (![NSApp modalWindow])
            tsuiFinishWindows();
    }
    [pool drain];
    return answer;
}
