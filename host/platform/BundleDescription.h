// The description file of a bundle, looked at before the platform's bundle class reads it. That class takes
// what it finds for what it expects: a list in the place of a name raises an exception, a list in lists
// without end fills the stack, and other files leave lines of the toolkit's own on standard error.
#pragma once

#include <string>

#include "host/text/Result.h"

namespace tessel
{
// Whether the bundle class may read the description of the bundle in the folder; why not is the end of a
// sentence. A bundle without a description passes: the class knows what to answer.
Result<> checkDescription(const std::string& folder);
} // namespace tessel
