// The main dialog in its panel, set up as for a run, without the run.
#pragma once

#include <functional>
#include <string>

#import <AppKit/AppKit.h>

#import "modrig/dialogs/ModrigController.h"

namespace bench
{
class OpenDialog
{
public:
    OpenDialog();
    ~OpenDialog();
    OpenDialog(const OpenDialog&) = delete;
    OpenDialog& operator=(const OpenDialog&) = delete;

    ModrigController* controller() const { return mController; }
    NSOpenPanel* panel() const { return mPanel; }
    NSUInteger filesShown() const;
    NSUInteger rows(NSString* table) const;

private:
    ModrigController* mController;
    NSOpenPanel* mPanel;
};

// Registers a benchmark that usually runs `once` so many times; it answers the seconds of what it measures,
// negative when that went wrong.
void measure(const std::string& name, int usual, std::function<double()> once);

// Processor time, in a pool of its own: giving back what the work has left behind is part of its cost.
double secondsInPool(const std::function<void()>& work);
} // namespace bench
