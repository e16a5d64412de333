// Why a call of the system failed.
#pragma once

#include <cstring>

#include "host/text/Result.h"
#include "host/text/Unicode.h"

namespace tessel
{
// In the system's words, the end of a sentence. To be asked at once: the next call may set another number.
inline Failure systemFailure(int error)
{
    return {toWide(std::strerror(error))};
}
} // namespace tessel
