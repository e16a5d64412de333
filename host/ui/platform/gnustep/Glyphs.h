// Characters that take more than sixteen bits.
#pragma once

namespace tessel::windowing
{
// From now on they are drawn, by fonts that have them.
void drawCharactersOfAnyLength();
} // namespace tessel::windowing
