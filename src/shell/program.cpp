#include "shell/program.h"
int runProgram(int, char **)
{
    return 0;
}
