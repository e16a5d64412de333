// What the program Tessel, and tests that run a host in their own process, need from the host's library.
// Everything else of it is hidden; applications see the SDK only.
#pragma once

#define TESSEL_PROGRAM_API __attribute__((visibility("default")))
