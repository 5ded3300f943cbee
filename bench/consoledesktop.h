#pragma once

#include "platform/desktop/desktop.h"

/// The desktop of a program without a window: error boxes go to the standard error stream and are
/// remembered, questions are answered with Yes and counted, all that needs a screen does nothing.
class ConsoleDesktop : public Desktop
{
public:
    ConsoleDesktop() { setCurrent(this); }

    bool failed = false; // an error box was shown
    int questions = 0;

    BoxAnswer messageBox(BoxKind kind, BoxButtons buttons, const QString &text,
                         const QString &title) override;
    void showModal(Form &) override {}
    QString openFileName(const FileQuestion &) override { return {}; }
    QStringList openFileNames(const FileQuestion &) override { return {}; }
    QString saveFileName(const FileQuestion &) override { return {}; }
    QString folderName(const FileQuestion &) override { return {}; }
    PrinterChoice choosePrinter(QPrinter &, int) override { return PrinterChoice::NoPrinter; }
    QDateTime now() override { return QDateTime::currentDateTime(); }
    void setPointer(QWidget *, PointerShape) override {}
    void freeze(QWidget *) override {}
    void pump() override {}
    void sendKeys(const QString &) override {}
    void openAddress(const QString &, std::function<void()> notOpened) override { notOpened(); }
    QString settingsFile() override { return {}; }
    QString programFolder() override { return {}; }
};
