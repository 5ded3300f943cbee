#include "shell/mp3entries.h"

#include "mp3/collections.h"
#include "shell/MainScreen.h"

#include <QAction>

using namespace Qt::StringLiterals;

void connectMP3Entries(MainScreen &frame)
{
    QObject::connect(frame.command(u"mnuMP3"_s), &QAction::triggered, &frame, &collections::open);
}
