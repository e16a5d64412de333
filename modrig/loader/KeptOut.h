// The applications that the host does not load by itself, in a host that can tell.
#pragma once

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
// Whether the host lets a person choose.
[[nodiscard]] bool HostKeepsApplicationsOut();

// The host's sentence about why the application is kept out; empty for one that is not.
[[nodiscard]] CStdStr WhyKeptOut(const CStdStr& path);

// Keeps it out at starts, or lets it in again. What goes wrong the host tells.
void KeepOut(const CStdStr& path);
void LetIn(const CStdStr& path);
} // namespace ModrigUtils
