#include "tags/ordinaryfile.h"

#include <QFile>
#include <sys/stat.h>

bool isOrdinaryFile(const QString &name)
{
    struct stat about = {};
    return stat(QFile::encodeName(name).constData(), &about) == 0 && S_ISREG(about.st_mode);
}
