// The dialogs for unit tests of the module's logic: what the logic asks of them is kept.
//
// Link `recording_dialog` beside `recording_host` and `modrig_core`.
#pragma once

#include <functional>
#include <string>
#include <vector>

struct RecordingDialog
{
    // The texts of the message line, in order.
    std::vector<std::wstring> messages;
    std::function<void()> duringMessage; // what happens while one is shown

    int runs = 0;
    std::function<void()> duringRun; // what the user does while the dialog is open

    std::wstring lastMessage() const { return messages.empty() ? std::wstring() : messages.back(); }
    void reset() { *this = {}; }
};

RecordingDialog& recordingDialog();
