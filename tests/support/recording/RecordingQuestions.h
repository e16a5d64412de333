// Questions to the person: a test says beforehand what is answered.
#pragma once

#include <deque>
#include <functional>
#include <optional>
#include <string>
#include <vector>

class RecordingQuestions
{
public:
    // The lines that are typed, one for each question; nothing cancels it. When none is left nobody is there:
    // the default is taken.
    std::deque<std::optional<std::wstring>> answers;

    // Every question, and the default that was offered with it (empty for none).
    std::vector<std::wstring> asked;
    std::vector<std::wstring> defaults;

    // A status of tsask...; `take` says whether an answer fits.
    int ask(const std::wstring& question, const std::optional<std::wstring>& byDefault,
            const std::function<bool(const std::wstring&)>& take);

private:
    std::optional<std::wstring> nextAnswer(const std::optional<std::wstring>& byDefault);
};
