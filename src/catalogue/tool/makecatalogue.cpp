#include "catalogue/cataloguefile.h"
#include "platform/error/error.h"

#include <cstdio>

// make-catalogue FILE: writes an empty catalogue, for the build.
int main(int argc, char **argv)
{
    if (argc != 2)
        return 2;
    try {
        cataloguefile::create(QString::fromLocal8Bit(argv[1]));
        return 0;
    } catch (const Error &error) {
        std::fprintf(stderr, "%s\n", error.what());
        return 1;
    }
}
