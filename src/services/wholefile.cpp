#include "services/wholefile.h"

#include <QSaveFile>

bool commitWhole(QSaveFile &file)
{
    if (!file.flush() || file.error() != QFileDevice::NoError)
        file.cancelWriting();
    return file.commit();
}
