#pragma once

#include "platform/desktop/desktop.h"

#include <QMessageBox>
#include <QPrinter>
#include <QStringList>
#include <QTemporaryDir>
#include <deque>
#include <functional>

/// Stands in for the person in front of the screen. Boxes, modal screens and file dialogs must have
/// been announced, in their order; one that nobody expected fails the running test with its text
/// and is answered at once, so that nothing hangs. Boxes are recorded as readable lines:
/// "error|warning|information|plain|yes-no|yes-no-cancel [title] text".
class ScriptedDesktop : public Desktop
{
    QTemporaryDir mTemporary; // first: folder and settings lie in it
    Desktop *mBefore;

public:
    ScriptedDesktop();
    ~ScriptedDesktop() override;

    /// The next box must contain this text (in its line) and is answered so.
    void expectBox(const QString &part, BoxAnswer answer = vbOK);

    /// The next modal screen must have this name; the script runs inside its real event loop.
    /// Without a script the screen is left to end by itself.
    void expectModal(const QString &name, std::function<void(Form &)> script = {});
    void expectFile(const QString &name) { mFiles.push_back(name); }
    void expectFiles(const QStringList &names) { mFiles.push_back(names.join(u'\n')); }

    /// The next question for a printer gets one that prints into this file; without a name the
    /// machine has none.
    void expectPrinter(const QString &file, QPrinter::PageOrder order = QPrinter::FirstPageFirst)
    {
        mPrinters.push_back({file, order});
    }

    /// Fails the test if something announced did not come.
    void verifyAllCame();

    QStringList boxes;               // lines of all boxes since the last clear
    QStringList addresses;           // opened
    std::function<void()> duringBox; // what happens while a box is open
    bool browserThere = true;
    QDateTime time{QDate(2026, 11, 22), QTime(12, 0)};
    QString folder;   // App.Path
    QString settings; // file

    BoxAnswer messageBox(BoxKind kind, BoxButtons buttons, const QString &text,
                         const QString &title) override;
    void showModal(Form &form) override;
    QString openFileName(const FileQuestion &question) override;
    QStringList openFileNames(const FileQuestion &question) override;
    QString saveFileName(const FileQuestion &question) override;
    QString folderName(const FileQuestion &question) override;
    PrinterChoice choosePrinter(QPrinter &printer, int pages) override;
    QDateTime now() override { return time; }
    void setPointer(QWidget *window, PointerShape shape) override;
    void freeze(QWidget *window) override;
    void pump() override;
    void sendKeys(const QString &keys) override;
    void openAddress(const QString &url, std::function<void()> notOpened) override;
    QString settingsFile() override { return settings; }
    QString programFolder() override { return folder; }

private:
    QString nextFile(const char *dialog);

    struct Box {
        QString part;
        BoxAnswer answer;
    };
    struct Modal {
        QString name;
        std::function<void(Form &)> script;
    };
    std::deque<Box> mBoxes;
    std::deque<Modal> mModals;
    struct Printer {
        QString file;
        QPrinter::PageOrder order;
    };
    std::deque<QString> mFiles;
    std::deque<Printer> mPrinters;
};

/// Does this in the next real box that comes, and ends the box whatever becomes of it: a QCOMPARE
/// that fails leaves its function at once, and the box would wait for ever.
void inNextBox(const std::function<void(QMessageBox &)> &act);
