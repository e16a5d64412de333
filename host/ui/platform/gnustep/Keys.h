// What the characters of a key's event hold.
#pragma once

#import <Foundation/Foundation.h>

namespace tessel
{
inline constexpr unichar kEscapeKey = 0x1B;
} // namespace tessel
