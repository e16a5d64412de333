// Starting Lisp, which happens once in a process. For the files that know ECL.
#pragma once

#include <cstddef>

#include <ecl/ecl.h>

namespace tessel
{
class LispInterrupter;

// Room for telling the error and going on when the memory is exhausted by what the user keeps.
inline constexpr std::size_t kHeapReserve = std::size_t{16} << 20;

// Found once; the garbage collector knows them through their symbols.
struct LispFunctions
{
    cl_object beginSession;
    cl_object evaluate;
    cl_object invoke;
    cl_object compileText;
    cl_object interrupted;
    cl_object makeSymbol;
};

// Starts Lisp if it does not run yet, on this thread. Throws std::runtime_error.
const LispFunctions& lispFunctions();

// One for the process: a thread that joins Lisp takes memory that Lisp does not give back.
LispInterrupter& lispInterrupter();
} // namespace tessel
