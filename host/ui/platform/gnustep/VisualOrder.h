// Text in the order in which it stands on the screen.
#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <vector>

namespace tessel::windowing
{
// Whether something in the text is written from right to left.
bool hasRightToLeft(std::u16string_view text);

// The text, a line from left to right, with what is written from right to left turned round, and Arabic
// letters in the forms that they have beside each other. It comes back unchanged when that is not possible.
std::u16string visualOrder(std::u16string_view text);

// The same in two steps, for text that takes several lines: where they begin shows only when the letters have
// their forms. The text stays as long as it is.
std::u16string withJoinedLetters(std::u16string_view text);

// Each line turned round for itself, and ended by a line break. The lines begin at `starts`, which rises from
// 0.
std::u16string visualLines(std::u16string_view joined, const std::vector<std::size_t>& starts);
} // namespace tessel::windowing
