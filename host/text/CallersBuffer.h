// Texts for the buffers that callers of the SDK bring along. Capacities are in characters, the terminator
// included.
#pragma once

#include <cstddef>
#include <string_view>

namespace tessel
{
// As much of the text as has room; nothing where there is no buffer.
inline void copyCut(std::wstring_view text, wchar_t* buffer, std::size_t capacity)
{
    if (buffer && capacity > 0)
        buffer[text.copy(buffer, capacity - 1)] = L'\0';
}

inline bool hasRoom(std::wstring_view text, std::size_t capacity)
{
    return text.size() < capacity;
}

// False, and the buffer is not touched, when the whole text has no room.
inline bool copyWhole(std::wstring_view text, wchar_t* buffer, std::size_t capacity)
{
    if (!hasRoom(text, capacity))
        return false;
    copyCut(text, buffer, capacity);
    return true;
}
} // namespace tessel
