#pragma once

#include <QProgressDialog>

class LongWork;

/// Stands before all other windows while a work runs whose screen shows no progress of its own:
/// what it is, how far, and Cancel, which is all that it lets in.
class WorkWindow : public QProgressDialog
{
    Q_OBJECT

public:
    explicit WorkWindow(LongWork &work);

    void showPercent(int percent);

private:
    QProgressBar *mBar;
};
