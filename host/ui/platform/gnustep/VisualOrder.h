// Text in the order in which it stands on the screen.
#pragma once

#include <string>
#include <string_view>

namespace tessel::windowing
{
// Whether something in the text is written from right to left.
bool hasRightToLeft(std::u16string_view text);

// The text, a line from left to right, with what is written from right to left turned round, and Arabic
// letters in the forms that they have beside each other. It comes back unchanged when that is not possible.
std::u16string visualOrder(std::u16string_view text);
} // namespace tessel::windowing
