// Calls code of an application, which may throw whatever it likes.
#pragma once

#include <functional>

#include "host/text/Result.h"

namespace tessel
{
// Whether the call returned; otherwise what it threw, as in "its entry point threw ...".
Result<> catchAnything(const std::function<void()>& call);
} // namespace tessel
