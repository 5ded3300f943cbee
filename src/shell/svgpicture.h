#pragma once

#include <QPixmap>
#include <QWidget>

/// A picture of ours, sharp at any size and scale. Rendered once per size.
class SvgPicture : public QWidget
{
    Q_OBJECT

public:
    using QWidget::QWidget;
    void setSource(const QString &file) { mSource = file; }

    bool isPainted() const { return !mRendered.isNull(); }

signals:
    void Click();
    void Painted(); // once, when the first painting is done

protected:
    void paintEvent(QPaintEvent *event) override;
    void mousePressEvent(QMouseEvent *event) override;

private:
    QString mSource;
    QPixmap mRendered;
};
