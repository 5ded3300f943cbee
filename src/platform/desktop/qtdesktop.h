#pragma once

#include "platform/desktop/desktop.h"

#include <QPointer>

/// The desktop of a real session.
class QtDesktop : public Desktop
{
public:
    BoxAnswer messageBox(BoxKind kind, BoxButtons buttons, const QString &text,
                         const QString &title) override;
    void showModal(Form &form) override;
    QString openFileName(const FileQuestion &question) override;
    QStringList openFileNames(const FileQuestion &question) override;
    QString saveFileName(const FileQuestion &question) override;
    QString folderName(const FileQuestion &question) override;
    PrinterChoice choosePrinter(QPrinter &printer, int pages) override;
    QDateTime now() override;
    void setPointer(QWidget *window, PointerShape shape) override;
    void freeze(QWidget *window) override;
    void pump() override;
    void sendKeys(const QString &keys) override;
    void openAddress(const QString &url, std::function<void()> notOpened) override;
    QString settingsFile() override;
    QString programFolder() override;
};
