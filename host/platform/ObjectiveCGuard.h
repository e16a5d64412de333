// Calls something that may throw an Objective-C exception.
#pragma once

#include <functional>
#include <optional>
#include <string>

namespace tessel
{
// What the exception says of itself, or nothing when the call returned. C++ exceptions pass through.
// There is no autorelease pool of the call's own, which would cost as much as a tenth of loading an
// application: what it leaves goes with the command that it belongs to.
std::optional<std::wstring> catchObjectiveC(const std::function<void()>& call);
} // namespace tessel
