// What every header of the Tessel SDK builds on: export marking and the status and type codes.
//
// Strings cross the host boundary as NUL-terminated `const wchar_t*` with 4-byte characters (one Unicode
// code point each). A caller that receives text passes a buffer and its capacity in characters, the
// terminator included. No exception crosses the boundary in either direction. Everything is called on the
// host's main thread.
#pragma once

#include <cstddef>
#include <cstdint>

static_assert(sizeof(wchar_t) == 4, "Tessel strings hold one Unicode code point per 4-byte character");

// Functions and classes that the host implements and exports.
#define TESSEL_API __attribute__((visibility("default")))
// Functions and data that an application exports to the host.
#define TESSEL_EXPORT __attribute__((visibility("default")))

// Types of the values in a result buffer (`TsResultBuffer::type`).
inline constexpr int TS_SHORT = 5003;  // 16-bit signed integer
inline constexpr int TS_LONG = 5004;   // 32-bit signed integer
inline constexpr int TS_STRING = 5005; // string
inline constexpr int TS_REAL = 5006;   // double
inline constexpr int TS_TRUE = 5007;   // logical true
inline constexpr int TS_NIL = 5008;    // logical false, the empty list

// Status codes of the tsed and tsut functions.
inline constexpr int TS_NORMAL = 5100; // done
inline constexpr int TS_ERROR = 5101;  // not done

// Status codes of fetching a remote file.
inline constexpr int TS_FETCHED = 20000;    // fetched over the network
inline constexpr int TS_FROM_CACHE = 20001; // an earlier local copy was taken
inline constexpr int TS_FETCH_FAILED = 20002;
