#include "host/app/Program.h"

int main(int count, char** arguments)
{
    return tessel::runProgram(count, arguments);
}
