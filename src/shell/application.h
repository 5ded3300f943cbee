#pragma once

#include <QApplication>

/// The application of a real session. An error that no routine has caught ends the program here,
/// with a report and with every open transaction rolled back.
class Application : public QApplication
{
    Q_OBJECT

public:
    using QApplication::QApplication;
    bool notify(QObject *receiver, QEvent *event) override;

    /// Sets the texts of Qt itself (Yes, No, file dialogs) to the language of the run.
    void translateQt();
};

/// Names that folders, windows and the desktop know the program by; to be set before the object is
/// made.
void nameApplication();
