// A moment of a length that no clock measures.
#pragma once

// Lets a moment pass that is as long as the number says, working.
inline void busyFor(unsigned steps)
{
    volatile unsigned counter = 0;
    for (unsigned i = 0; i < steps; ++i)
        counter = counter + 1;
}
