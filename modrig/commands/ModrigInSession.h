// Modrig while it is loaded: it holds the lists that it has read, and stores them when its dialog is closed.
// Whoever changes what is stored has to see that Modrig reads it again.
#pragma once

#include "modrig/base/CStdStr.h"
#include "modrig/commands/KeptList.h"

namespace ModrigUtils
{
// Takes Modrig out of service for as long as the object lives, if it is loaded and can be. It reads the lists
// again when it is loaded, by its command; where its record does not say that, it is loaded at the end of the
// scope.
class ModrigOutOfService
{
public:
    ModrigOutOfService();
    ~ModrigOutOfService();
    ModrigOutOfService(const ModrigOutOfService&) = delete;
    ModrigOutOfService& operator=(const ModrigOutOfService&) = delete;

    // Whether nobody in this session holds the lists now.
    bool succeeded() const { return mSucceeded; }
    // Whether Modrig was loaded, and comes back by its command.
    bool waitsForItsCommand() const { return mWaits; }

private:
    CStdStr mPath; // empty when it was not loaded
    bool mSucceeded = true;
    bool mWaits = false;
};

// Why nobody can change the list now, whoever they are; empty when nothing is in the way.
[[nodiscard]] CStdStr WhyNobodyCanChange(const KeptList& list);

// Keeps the host's record of Modrig in step with the Startup Suite, as Modrig does itself: it is loaded at
// the start as long as there is something to load.
void UpdateRecordOfModrig(bool hasStartup);
} // namespace ModrigUtils
