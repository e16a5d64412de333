// Text in any script.
#pragma once

namespace tessel::windowing
{
// From now on characters that a font has not got are drawn with another that has them, what is written from
// right to left is drawn so, and a backslash in a file name is a letter like any other.
void showEveryScript();
} // namespace tessel::windowing
