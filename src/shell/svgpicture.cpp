#include "shell/svgpicture.h"

#include <QPainter>
#include <QSvgRenderer>

void SvgPicture::paintEvent(QPaintEvent *)
{
    const QSize pixels = size() * devicePixelRatioF();
    if (!isPainted())
        QMetaObject::invokeMethod(this, &SvgPicture::Painted, Qt::QueuedConnection);
    if (mRendered.size() != pixels) {
        mRendered = QPixmap(pixels);
        mRendered.fill(Qt::transparent);
        QPainter painter(&mRendered);
        QSvgRenderer(mSource).render(&painter);
        painter.end();
        mRendered.setDevicePixelRatio(devicePixelRatioF());
    }
    QPainter(this).drawPixmap(0, 0, mRendered);
}

void SvgPicture::mousePressEvent(QMouseEvent *)
{
    emit Click();
}
