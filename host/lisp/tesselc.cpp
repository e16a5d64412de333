#include "host/lisp/CompilerProgram.h"

int main(int count, char** arguments)
{
    return tessel::runCompilerProgram(count, arguments);
}
