// What a person sees and can do while files are loaded: an hourglass at once, after a second how far it is,
// and Escape to stop.
#pragma once

#import <AppKit/AppKit.h>

#include "modrig/dialogs/model/LoadProgress.h"

@class ModrigController;

namespace ModrigUtils
{
class LongLoad
{
public:
    // `files`: how many are to be loaded. The controller has to outlive the object.
    LongLoad(ModrigController* controller, std::size_t files);
    ~LongLoad();
    LongLoad(const LongLoad&) = delete;
    LongLoad& operator=(const LongLoad&) = delete;

    // Whether somebody has stopped the load, asked between two files with how many are done. The message line
    // says then how far it has come.
    [[nodiscard]] bool IsStopped(std::size_t done);

private:
    void Say(NSString* key, std::size_t done) const;

    ModrigController* mController;
    NSWindow* mWindow;
    std::size_t mFiles;
    LoadProgress mProgress;
};
} // namespace ModrigUtils
