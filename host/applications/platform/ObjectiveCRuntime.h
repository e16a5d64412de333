// What the platforms do differently about libraries that bring Objective-C classes along.
#pragma once

#include <string>

namespace tessel
{
// Whether a bundle with this program must be loaded by the platform's bundle class, not as a plain library.
bool needsBundleLoading(const std::string& program);

// Whether the library must stay mapped until the process ends because the Objective-C runtime points into it.
bool mustStayMapped(void* library);

// A function that the library calls and nobody has, where the platform's bundle class does not look for it
// itself; empty when there is none.
std::string firstUnresolvedFunction(void* library);
} // namespace tessel
