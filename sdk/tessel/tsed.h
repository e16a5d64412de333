// The host's free functions for applications: variables, files, loaded modules, Lisp, help.
#pragma once

#include "tsresbuf.h"

// Reads a system variable (name in any case) into `result`; a string value is the caller's to free
// (`delete[] result->value.string`). TS_NORMAL, or TS_ERROR when there is no such variable: `result` is then
// as it was.
TESSEL_API int tsedGetVar(const wchar_t* name, TsResultBuffer* result);

// Looks for a file along the host's search path: the current folder, the host's own folder, then the folders
// of the system variable SEARCHPATH in order. On TS_NORMAL `found` (capacity in characters) holds the full
// path. TS_ERROR: not found, or the path does not fit. A full path is only checked for existence.
TESSEL_API int tsedFindFile(const wchar_t* name, wchar_t* found, std::size_t capacity);

// The file or folder that a person means by what is typed as an argument of a command, from the root on. "~"
// stands for a home folder, and what does not begin with a slash counts from the current folder. Each file
// has one such path, but for links, which stay as they were typed. On TS_NORMAL it stands in `path` (capacity
// in characters), whether anything is there or not. TS_ERROR: nothing was typed, the current folder is gone,
// or the path does not fit.
TESSEL_API int tsedTypedPath(const wchar_t* typed, wchar_t* path, std::size_t capacity);

// The full path of the application that is being called (its entry point or one of its commands), or an
// empty text outside of such a call. Valid until the call ends.
TESSEL_API const wchar_t* tsedGetAppName();

// The names (file name with extension) of the loaded compiled applications, as TS_STRING values in the order
// in which they were loaded; null when there are none. The caller frees the list with `tsutRelRb`.
TESSEL_API TsResultBuffer* tsedQmbLoaded();

// The full path of a loaded application of that name (any case); the first loaded where several share it.
// 0 on success; otherwise the buffer is not touched.
TESSEL_API int tsedGetModuleFileName(const wchar_t* moduleName, wchar_t* path, std::size_t capacity);

// Calls a Lisp function now: the first value is its name (TS_STRING), the rest its arguments. On TS_NORMAL
// `*result` is the value as a list (null for nil), the caller's to free with `tsutRelRb`. TS_ERROR after a
// Lisp error, which the host has then printed as one line.
TESSEL_API int tsedInvoke(const TsResultBuffer* call, TsResultBuffer** result);

// Opens a help topic. `file` null is the host's own help book. Answers whether the topic exists; a host
// without a display or a browser prints the page's path on the command line.
TESSEL_API bool tsedHelp(const wchar_t* file, const wchar_t* topic, int command);

// Queues a Lisp expression, to be evaluated when the host is idle, in the order of queueing. Its value is
// not printed; an error becomes one line on the command line.
TESSEL_API void qxr_queueexpr(const wchar_t* expression);

// Whether this host can load compiled Lisp (.qbc) and packaged Lisp applications (.rpk), and offers
// `_INTERNAL-LOAD-ALL-FILE`. The answer does not change while the host runs and is ready before any
// application is loaded.
TESSEL_API bool RemovingTsLISP();
