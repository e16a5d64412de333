// Why a call of the system failed.
#pragma once

#include "host/text/Result.h"

namespace tessel
{
// The end of a sentence, in the system's words where they are not translated. To be asked at once: the next
// call may set another number.
Failure systemFailure(int error);
} // namespace tessel
