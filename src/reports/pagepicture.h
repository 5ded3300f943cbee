#pragma once

#include "reports/reportcontent.h"

#include <QPageLayout>
#include <QWidget>
#include <memory>

/// A small picture of the first page of a report on some paper, with its margins marked.
class PagePicture : public QWidget
{
    Q_OBJECT

public:
    explicit PagePicture(QWidget *parent = nullptr) : QWidget(parent) {}

    void setReport(std::shared_ptr<const ReportContent> content);
    void setPaper(const QPageLayout &paper);

protected:
    void paintEvent(QPaintEvent *event) override;

private:
    std::shared_ptr<const ReportContent> mContent;
    QPageLayout mPaper;
};
