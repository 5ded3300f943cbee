#include "shell/undoentry.h"

#include "mp3/UndoChanges.h"
#include "shell/MainScreen.h"

#include <QAction>

using namespace Qt::StringLiterals;

void connectUndoEntry(MainScreen &frame)
{
    QObject::connect(frame.command(u"mnuUndoChanges"_s), &QAction::triggered, &frame,
                     [] { defaultInstance<UndoChanges>().ShowModal(); });
}
