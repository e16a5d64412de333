// The signal of a memory fault, shared by Lisp and everybody else.
//
// To interrupt a Lisp that is busy, ECL takes away its own right to write to its environment and waits for
// the fault. That one fault is ECL's; every other one is a real crash and goes the way it would have gone
// without Lisp.
#pragma once

#include <csignal>

namespace tessel
{
// What is to be done with faults that are not Lisp's. Called before ECL starts.
struct sigaction currentFaultAction();

// Called on the thread of Lisp after ECL has started and put its handler in place.
void shareMemoryFaults(const struct sigaction& previous);
} // namespace tessel
