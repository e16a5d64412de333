// The module's life: what the host calls, and the start-up that follows.
#pragma once

#include <tessel/tsrx.h>

// Called by the host. Message 1 loads: TSRX_RET_ERROR, with nothing done, when the resource module is missing
// or the module is loaded already. Message 2 releases the resource module; the lists and the command stay,
// because the host ends both. Every other message is ignored.
extern "C" TESSEL_EXPORT int tsrxEntryPoint(unsigned message, void* application);

// Start-up: Startup Suite, History, command, demand-load record.
void initApp();

// The counterpart of `initApp`, which every application of the host has. There is nothing to give back.
void unloadApp();

namespace ModrigUtils
{
// The handler of the command MODRIG: runs the Load/Unload dialog with the module's texts.
void ModrigCreate();

// Keeps the host's demand-load record of this module in step with the Startup Suite: the host loads the
// module at its own start only while there is something to load.
void updateRegistry();
} // namespace ModrigUtils
