#include "platform/work/workwindow.h"

#include "platform/text/messagetexts.h"
#include "platform/work/longwork.h"

#include <QProgressBar>

using namespace Qt::StringLiterals;

WorkWindow::WorkWindow(LongWork &work)
    : QProgressDialog(work.what(), text::ofKey("cmdCancelCaption"), 0, 0, work.window()),
      mBar(new QProgressBar) // the dialog's own handles events with each value
{
    setObjectName(u"WorkWindow"_s);
    setBar(mBar);
    mBar->setRange(0, 0);
    setWindowModality(Qt::ApplicationModal);
    connect(this, &QProgressDialog::canceled, this, [&work] { work.cancel(); });
}

void WorkWindow::showPercent(int percent)
{
    mBar->setRange(0, 100);
    mBar->setValue(percent);
}
