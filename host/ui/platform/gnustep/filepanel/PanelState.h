// What the file panel knows, without its window.
#pragma once

#import <Foundation/Foundation.h>
#include <wincompat/winstring.h>

#include <optional>
#include <string>
#include <vector>

#include "host/text/Unicode.h"
#include "host/ui/platform/gnustep/filepanel/FolderWatch.h"
#include "host/ui/platform/gnustep/filepanel/Listing.h"

namespace tessel::filepanel
{
struct PanelState
{
    std::string wanted;              // the folder to show
    std::string folder;              // the one that shows
    std::optional<std::string> seen; // its state when it was read
    FolderWatch watch;
    FolderChanges changes;    // that have been heard of and not dealt with
    bool isGathering = false; // they soon will be
    std::vector<Entry> entries;
    Order order;
    std::vector<std::string> chosen; // paths
    bool isAsked = false;            // the delegate has been asked again while this event is handled
    bool isTyped = false;            // the name field was used last, not the table
    std::string typed;               // what a person typed there, without its completion

    std::string pathOf(const Entry& entry) const { return (folder == "/" ? "" : folder) + "/" + entry.name; }
};

// The file system's names, which need not be text, and the toolkit's.
inline std::string bytes(NSString* text)
{
    return toUtf8(NSStringToWstring(text));
}

inline NSString* string(const std::string& bytes)
{
    return wcharToNSString(toWide(bytes).c_str());
}
} // namespace tessel::filepanel
