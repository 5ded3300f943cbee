#include "shell/cataloguewatch.h"

#include "platform/ado/connection.h"
#include "platform/desktop/desktop.h"
#include "platform/desktop/nestedloop.h"
#include "services/globals.h"
#include "services/messages.h"

#include <QGuiApplication>
#include <utility>

CatalogueWatch::CatalogueWatch(QObject *parent) : QObject(parent)
{
    // Queued: windows are being activated.
    const auto come = [this](Qt::ApplicationState state) {
        if (state == Qt::ApplicationActive)
            look();
    };
    connect(qApp, &QGuiApplication::applicationStateChanged, this, come, Qt::QueuedConnection);
}

// Not over a box or into a work: the next time will do.
void CatalogueWatch::look()
{
    if (!NestedLoop::none() || !gConnection || gConnection->State() != ADODB::adStateOpen)
        return;
    const bool moved = gConnection->hasMoved();
    if (!std::exchange(mTold, moved) && moved)
        errorBox(GetMessage("xErrMoved"));
}
