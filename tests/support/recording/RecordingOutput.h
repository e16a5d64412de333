// What the person at the host would have seen: the command line, message boxes, help.
#pragma once

#include <optional>
#include <set>
#include <string>
#include <vector>

#include <tessel/tsmessagebox.h>

class RecordingOutput : public VqHostMessageBox
{
public:
    struct Box
    {
        std::wstring text;
        unsigned style = 0;
        void* parent = nullptr;

        bool operator==(const Box&) const = default;
    };

    struct HelpCall
    {
        std::optional<std::wstring> file; // nothing for null
        std::wstring topic;
        int command = 0;

        bool operator==(const HelpCall&) const = default;
    };

    // Everything that was printed on the command line, by `tsutPrintf` and by the host itself.
    std::wstring printed;
    // The same as lines without their line breaks; a last line that is not ended counts.
    std::vector<std::wstring> lines() const;
    // A sentence of the host itself.
    void say(const std::wstring& sentence) { printed += sentence + L"\n"; }

    std::vector<Box> boxes;
    int boxAnswer = IDOK;
    // The texts of the boxes alone.
    std::vector<std::wstring> boxTexts() const;

    std::vector<HelpCall> helpCalls;
    std::optional<std::set<std::wstring>>
        helpTopics; // the topics that exist; without a set, every topic does

    int show(const wchar_t* text, unsigned style, void* parent) override;
};
