#include "modrig/dialogs/model/TypedLetters.h"

#include <string>

#include "modrig/base/CaseFolding.h"

namespace ModrigUtils
{
namespace
{
constexpr std::chrono::seconds kWordEnds(1);

bool BeginsWith(const CStdStr& name, const CStdStr& letters)
{
    const std::wstring& text = name.Text();
    return text.size() >= letters.Text().size() &&
           EqualIgnoringCase(text.substr(0, letters.Text().size()), letters.Text());
}
} // namespace

const CStdStr& TypedLetters::Add(wchar_t letter, Time now)
{
    const std::wstring before = IsTyping(now) ? mLetters.Text() : std::wstring();
    mLetters = CStdStr(before + letter);
    mLast = now;
    return mLetters;
}

bool TypedLetters::IsTyping(Time now) const
{
    return !mLetters.IsEmpty() && now - mLast < kWordEnds;
}

bool TypedLetters::Take(TableKey key, Time now) const
{
    constexpr wchar_t kFirstFunctionKey = 0xF700;
    if (key.command || key.alternate || key.character >= kFirstFunctionKey || key.character == kDeleteKey)
        return false;
    return key.character > L' ' || (key.character == L' ' && IsTyping(now));
}

std::optional<std::size_t> RowBeginningWith(const CStdStr& letters, std::size_t rows,
                                            std::optional<std::size_t> current,
                                            const std::function<CStdStr(std::size_t)>& nameOf)
{
    const std::size_t next = letters.Text().size() == 1 ? 1 : 0;
    const std::size_t start = current ? *current + next : 0;
    for (std::size_t step = 0; step < rows; ++step)
        if (const std::size_t row = (start + step) % rows; BeginsWith(nameOf(row), letters))
            return row;
    return std::nullopt;
}
} // namespace ModrigUtils
