#pragma once

#include <QDateTime>
#include <QPointer>
#include <QString>
#include <QWidget>
#include <functional>

class Form;
class QPrinter;

enum class BoxKind { Error, Warning, Information, Question, Plain }; // Plain: without a picture
enum class BoxButtons { Ok, YesNo, YesNoCancel };

/// The answers of a box, with the numbers that the screens keep.
enum BoxAnswer { vbOK = 1, vbCancel = 2, vbYes = 6, vbNo = 7 };

/// Mouse pointers by their numbers.
enum PointerShape { vbDefault = 0, vbHourglass = 11, vbCustom = 99 };

/// What a file dialog is asked with. Patterns in Qt's form: "Text (*.txt);;All (*)".
struct FileQuestion {
    QString title;
    QString folder;
    QString patterns;
    QString suffix;    // put behind a name to save that has none
    QString name = {}; // proposed for a file to save
};

/// What became of the question for a printer.
enum class PrinterChoice { Chosen, Cancelled, NoPrinter };

/// Everything that blocks, shows, waits or asks the machine goes through here, so that a test can
/// stand in for the person in front of the screen. No state and no logic: those are the callers'.
class Desktop
{
public:
    virtual ~Desktop() = default;

    virtual BoxAnswer messageBox(BoxKind kind, BoxButtons buttons, const QString &text,
                                 const QString &title) = 0;
    virtual void showModal(Form &form) = 0; // returns when the form is unloaded or hidden
    virtual QString openFileName(const FileQuestion &question) = 0;      // empty: cancelled
    virtual QStringList openFileNames(const FileQuestion &question) = 0; // of one folder
    virtual QString saveFileName(const FileQuestion &question) = 0;      // one that exists, too
    virtual QString folderName(const FileQuestion &question) = 0;

    /// Lets the user choose printer, pages and copies for a document of this many pages. The
    /// printer comes with the paper that is wanted. Nothing is shown on a machine that has none.
    virtual PrinterChoice choosePrinter(QPrinter &printer, int pages) = 0;
    virtual QDateTime now() = 0;
    virtual void setPointer(QWidget *window, PointerShape shape) = 0;
    virtual void freeze(QWidget *window) = 0; // nullptr: drawing goes on
    virtual void pump() = 0;                  // handles what is waiting, input included
    virtual void sendKeys(const QString &keys) = 0;

    /// Opens an address in the browser of the person. That nothing is there to open it with shows
    /// later, when the desktop has looked.
    virtual void openAddress(const QString &url, std::function<void()> notOpened) = 0;
    virtual QString settingsFile() = 0;
    virtual QString programFolder() = 0; // App.Path

    static Desktop &current();
    static Desktop *setCurrent(Desktop *desktop); // not owned; gives the one before
};

/// The title of boxes that have none of their own: the program's name in the language of the run.
void setBoxTitle(const QString &title);

/// The shorthands that the screens use.
void errorBox(const QString &text, const QString &title = {});
void warningBox(const QString &text);
void plainBox(const QString &text);
void informationBox(const QString &text, const QString &title = {});
BoxAnswer askYesNo(const QString &text, const QString &title = {});
BoxAnswer askYesNoCancel(const QString &text, const QString &title = {});

/// The hourglass on a window for as long as this object lives.
class Hourglass
{
public:
    explicit Hourglass(QWidget *window);
    ~Hourglass();
    Hourglass(const Hourglass &) = delete;
    Hourglass &operator=(const Hourglass &) = delete;

private:
    QPointer<QWidget> mWindow; // may be closed meanwhile
};

/// No drawing of a window for as long as this object lives. Freezes are not counted.
class Freeze
{
public:
    explicit Freeze(QWidget *window) { Desktop::current().freeze(window); }
    ~Freeze() { Desktop::current().freeze(nullptr); }
    Freeze(const Freeze &) = delete;
    Freeze &operator=(const Freeze &) = delete;
};
