// Loading one application file into the host, and taking one out.
#pragma once

#include "modrig/base/CStdStr.h"

namespace ModrigUtils
{
// What became of a request to load.
inline constexpr int kNotLoaded = 0;
inline constexpr int kLoaded = 1;
inline constexpr int kAlreadyLoaded = 2;

// Names for the flags that the loader's functions take.
inline constexpr int kDoNotAddToHistory = 0;
inline constexpr int kAddToHistory = 1;
inline constexpr signed char kLoadAll = 1;
inline constexpr signed char kReportFailure = 1;
inline constexpr signed char kLoad = 1;
inline constexpr signed char kUnload = 0;

// Loads the file at the full path and records it in the list of loaded applications and, with `addToHistory`
// non-zero, in the History. A Lisp file is loaded each time it is asked for; a compiled module that is in the
// list already answers kAlreadyLoaded. While Lisp is switched off, Lisp and macro files answer kNotLoaded
// silently; any other failure is reported: by the loader's own messages and, with `reportFailure` non-zero,
// by kLoadFailed. `loadAll` non-zero: all parts of a Lisp application, where the host knows how.
[[nodiscard]] int PerformModrig(CStdStr path, int addToHistory, signed char loadAll,
                                signed char reportFailure);

// Hands the file to the host's linker or Lisp, by its extension; `load` 0 unloads. The lists are not touched.
// For Lisp, success means that the expressions are queued: what they do shows later. Files of other kinds are
// refused with kCannotLoadFile.
[[nodiscard]] bool LoadApplication(CStdStr path, signed char load, signed char loadAll);

// The two ways in which `LoadApplication` loads and unloads.
[[nodiscard]] bool LoadQMBFile(CStdStr path, signed char load);
[[nodiscard]] bool LoadLispFile(CStdStr path, signed char load, signed char loadAll);
} // namespace ModrigUtils
