// Calls something that may throw an Objective-C exception.
#pragma once

#include <functional>

#include "host/text/Result.h"

namespace tessel
{
// Whether the call returned; otherwise what the exception says of itself. C++ exceptions pass through.
// There is no autorelease pool of the call's own, which would cost as much as a tenth of loading an
// application: what it leaves goes with the command that it belongs to.
Result<> catchObjectiveC(const std::function<void()>& call);
} // namespace tessel
