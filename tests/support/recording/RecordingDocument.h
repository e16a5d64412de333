// The current document: a list of names.
#pragma once

#include <functional>
#include <string>
#include <vector>

#include <tessel/tsdocument.h>

class RecordingDocument : public TsApDocument
{
public:
    bool exists = true; // false: `curDoc` answers null
    std::vector<std::wstring> applications;

    std::function<void()> whenAskedFor; // runs at every `curDoc`

    int loadedApplicationCount() const override;
    const wchar_t* loadedApplicationName(int index) const override;
};
