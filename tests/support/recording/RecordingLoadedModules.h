// What the host reports as loaded: the answers of `tsedQmbLoaded`, `tsedGetModuleFileName` and
// `tsedGetAppName`. The linker keeps the list up to date; a test may add to it what no linker knows.
#pragma once

#include <set>
#include <string>
#include <vector>

#include <tessel/tsdefs.h>

#include "tests/support/recording/RecordingValue.h"

class RecordingLoadedModules
{
public:
    // Reported as loaded, under the path's file name or under another one.
    void add(const std::wstring& path);
    void add(const std::wstring& name, const std::wstring& path);
    // An entry of the list that is no name.
    void addOther(const RecordingValue& value);
    void remove(const std::wstring& path);

    bool reportsNothing = false;             // the list is null, whatever is loaded
    std::set<std::wstring> namesWithoutPath; // `tsedGetModuleFileName` fails for these names (exact)
    int failure = TS_ERROR;                  // and answers this

    // What `tsedGetAppName` answers. The recording linker and command stack set it for the length of the
    // calls that they make; a test that calls an entry point itself sets it first.
    std::wstring applicationName;

    // What the SDK's functions do.
    TsResultBuffer* list() const;
    // Null when there is none.
    const std::wstring* pathOf(const std::wstring& name) const;

private:
    struct Entry
    {
        RecordingValue value;
        std::wstring path;
    };
    std::vector<Entry> mEntries;
};
