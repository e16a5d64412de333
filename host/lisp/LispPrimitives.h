// What Lisp calls in the host: the functions under the prelude. For the files that know ECL.
#pragma once

#include "host/lisp/LispMachine.h"

namespace tessel
{
class LispInterrupter;

// Defines the functions in the package TESSEL-HOST. Once, before the prelude is evaluated.
void defineLispPrimitives();

// Whom they serve from now on, on this thread; null for nobody.
void connectLispPrimitives(LispSurroundings* surroundings, LispInterrupter* interrupter);

// Gives the stacks of this thread their reserve back, after an evaluation that may have ended in it.
void restoreLispStackLimits();

// Hands on what Lisp has printed since.
void flushLispOutput();
} // namespace tessel
