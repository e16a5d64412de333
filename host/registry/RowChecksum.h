// The checksum that stands in each row of a registry's file. Used by the Registry's own files alone.
#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

namespace tessel
{
// Of numbers and texts in their order. Short pieces are gathered: most of the time would go into the
// beginnings and ends of the summing.
class RowChecksum
{
public:
    RowChecksum& add(std::int64_t number)
    {
        addBytes(&number, sizeof number);
        return *this;
    }
    // Its end belongs to a text: what moves from one to the next is not the same.
    RowChecksum& add(std::string_view text)
    {
        constexpr char kEnd = 0;
        addBytes(text.data(), text.size());
        addBytes(&kEnd, sizeof kEnd);
        return *this;
    }
    std::int64_t finish();

private:
    void addBytes(const void* bytes, std::size_t count);
    void sumUp();

    std::array<unsigned char, 512> mGathered;
    std::size_t mCount = 0;
    std::uint32_t mSum = 0;
};

inline std::int64_t checksumOfValue(std::int64_t key, std::string_view name, std::string_view fold,
                                    std::string_view data)
{
    RowChecksum sum; // RowChecksum() would clear the room for the pieces first
    return sum.add(key).add(name).add(fold).add(data).finish();
}
} // namespace tessel
