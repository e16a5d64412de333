// Calls something that may throw an Objective-C exception.
#pragma once

#include <functional>
#include <optional>
#include <string>

namespace tessel
{
// What the exception says of itself, or nothing when the call returned. C++ exceptions pass through. The
// call has an autorelease pool of its own.
std::optional<std::wstring> catchObjectiveC(const std::function<void()>& call);
} // namespace tessel
