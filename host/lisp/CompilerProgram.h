// The program `tesselc`, apart from its `main`: compiles Lisp files.
#pragma once

namespace tessel
{
// Exported for the program, which holds nothing else.
__attribute__((visibility("default"))) int runCompilerProgram(int count, const char* const* arguments);
} // namespace tessel
