// The program Tessel, apart from its `main`.
#pragma once

#include "host/app/Export.h"

namespace tessel
{
// Reads the arguments, runs a session and answers the exit status.
TESSEL_PROGRAM_API int runProgram(int count, const char* const* arguments);
} // namespace tessel
