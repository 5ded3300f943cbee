#include "helpers/jet.h"

#include <cstdio>

int main(int count, char **arguments)
{
    if (count < 3) {
        std::fputs("songcase-jet FILE TABLE...\n", stderr);
        return int(jet::Result::Usage);
    }
    return int(jet::printTables(arguments[1], {arguments + 2, arguments + count}));
}
