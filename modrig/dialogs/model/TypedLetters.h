// Going to a row by typing how it begins.
#pragma once

#include <chrono>
#include <functional>
#include <optional>

#include "modrig/base/CStdStr.h"
#include "modrig/dialogs/model/TableActions.h"

namespace ModrigUtils
{
class TypedLetters
{
public:
    using Time = std::chrono::steady_clock::time_point;

    // What has been typed so far, with the letter: a new word after a second without one.
    const CStdStr& Add(wchar_t letter, Time now);

    // Whether a word has begun that a space may go on with.
    [[nodiscard]] bool IsTyping(Time now) const;

    // Whether the key is a letter of a word, and no key that does something.
    [[nodiscard]] bool Take(TableKey key, Time now) const;

private:
    CStdStr mLetters;
    Time mLast;
};

// The row whose name begins with the letters, whatever their case: `current` itself or the first after it,
// then from the top. With one letter typed it is the next one, so that the same letter again goes on.
[[nodiscard]] std::optional<std::size_t> RowBeginningWith(const CStdStr& letters, std::size_t rows,
                                                          std::optional<std::size_t> current,
                                                          const std::function<CStdStr(std::size_t)>& nameOf);
} // namespace ModrigUtils
