#include "platform/files/ordinaryfile.h"

#include "platform/files/nativename.h"

#include <sys/stat.h>

bool isOrdinaryFile(const QString &name)
{
    struct stat about = {};
    return stat(nativeName(name).constData(), &about) == 0 && S_ISREG(about.st_mode);
}
