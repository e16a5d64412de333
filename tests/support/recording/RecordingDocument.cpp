#include "tests/support/recording/RecordingDocument.h"

#include "tests/support/RecordingHost.h"

int RecordingDocument::loadedApplicationCount() const
{
    recordingHost().journal.add(L"loadedApplicationCount");
    return static_cast<int>(applications.size());
}

const wchar_t* RecordingDocument::loadedApplicationName(int index) const
{
    recordingHost().journal.add(L"loadedApplicationName", {index});
    if (index < 0 || static_cast<std::size_t>(index) >= applications.size())
        return nullptr;
    return applications[static_cast<std::size_t>(index)].c_str();
}

TsApDocument* curDoc()
{
    recordingHost().journal.add(L"curDoc");
    if (recordingHost().document.whenAskedFor)
        recordingHost().document.whenAskedFor();
    return recordingHost().document.exists ? &recordingHost().document : nullptr;
}
