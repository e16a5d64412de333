// Starting Lisp, which happens once in a process. For the files that know ECL.
#pragma once

#include <cstddef>

#include <ecl/ecl.h>

#include "host/text/Result.h"

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
    cl_object symbolsBeginning;
    cl_object compileText;
    cl_object interrupted;
    cl_object makeSymbol;
};

// Starts Lisp if that has not been tried yet, on this thread.
const Result<LispFunctions>& startLisp();

// Of the Lisp that was started.
const LispFunctions& lispFunctions();

// One for the process: a thread that joins Lisp takes memory that Lisp does not give back.
// Fails when the system has none to give, and can be asked again.
Result<LispInterrupter*> lispInterrupter();
} // namespace tessel
