#include "support/scripteddesktop.h"

#include "platform/desktop/drawingfreeze.h"
#include "platform/desktop/form.h"
#include "platform/desktop/modalloop.h"
#include "platform/desktop/qtdesktop.h"
#include "support/texts.h"

#include <QApplication>
#include <QTest>
#include <QTimer>

namespace
{

constexpr int modalAtMost = 10000; // milliseconds

void failTest(const QString &why)
{
    QTest::qFail(qPrintable(why), __FILE__, __LINE__);
}

const char *kindOf(BoxKind kind, BoxButtons buttons)
{
    if (buttons == BoxButtons::YesNo)
        return "yes-no";
    if (buttons == BoxButtons::YesNoCancel)
        return "yes-no-cancel";
    if (kind == BoxKind::Warning)
        return "warning";
    if (kind == BoxKind::Plain)
        return "plain";
    return kind == BoxKind::Error ? "error" : "information";
}

} // namespace

ScriptedDesktop::ScriptedDesktop()
    : mBefore(setCurrent(this)),
      folder(mTemporary.path()),
      settings(mTemporary.filePath(u"config/settings.json"_s))
{
}

ScriptedDesktop::~ScriptedDesktop()
{
    if (Desktop *now = setCurrent(mBefore); now != this)
        setCurrent(now);
}

void ScriptedDesktop::expectBox(const QString &part, BoxAnswer answer)
{
    mBoxes.push_back({part, answer});
}

void ScriptedDesktop::expectModal(const QString &name, std::function<void(Form &)> script)
{
    mModals.push_back({name, std::move(script)});
}

void ScriptedDesktop::verifyAllCame()
{
    for (const Box &box : mBoxes)
        failTest(u"This box did not come: "_s + box.part);
    for (const Modal &modal : mModals)
        failTest(u"This screen did not come: "_s + modal.name);
    for (const QString &file : mFiles)
        failTest(u"No dialog asked for: "_s + file);
    for (const Printer &printer : mPrinters)
        failTest(u"Nothing was printed: "_s + printer.file);
    mBoxes.clear();
    mModals.clear();
    mFiles.clear();
    mPrinters.clear();
}

BoxAnswer ScriptedDesktop::messageBox(BoxKind kind, BoxButtons buttons, const QString &text,
                                      const QString &title)
{
    const QString line = QLatin1String(kindOf(kind, buttons)) + u" ["_s + title + u"] "_s + text;
    boxes.append(line);
    if (duringBox)
        duringBox();
    if (mBoxes.empty() || !line.contains(mBoxes.front().part)) {
        failTest(u"Unexpected box: "_s + line +
                 (mBoxes.empty() ? QString() : u"; awaited: "_s + mBoxes.front().part));
        return buttons == BoxButtons::YesNoCancel ? vbCancel
                                                  : (buttons == BoxButtons::YesNo ? vbNo : vbOK);
    }
    const BoxAnswer answer = mBoxes.front().answer;
    mBoxes.pop_front();
    return answer;
}

void ScriptedDesktop::showModal(Form &form)
{
    const bool expected = !mModals.empty() && mModals.front().name == form.Name();
    std::function<void(Form &)> script = [](Form &f) { f.Unload(); };
    if (expected) {
        script = mModals.front().script;
        mModals.pop_front();
    } else {
        failTest(u"Unexpected modal screen: "_s + form.Name());
    }
    QPointer<Form> alive = &form;
    QTimer guard;
    guard.setSingleShot(true);
    QObject::connect(&guard, &QTimer::timeout, &form, [alive] {
        failTest(u"The modal screen did not end: "_s + alive->Name());
        alive->hide();
    });
    guard.start(modalAtMost);
    if (script)
        QTimer::singleShot(0, &form, [script, alive] {
            script(*alive);
            if (alive && QTest::currentTestFailed())
                alive->hide(); // the script may have ended in its midst
        });
    runModal(form);
}

QString ScriptedDesktop::nextFile(const char *dialog)
{
    if (mFiles.empty()) {
        failTest(u"Unexpected dialog: "_s + QLatin1String(dialog));
        return {};
    }
    const QString file = mFiles.front();
    mFiles.pop_front();
    return file;
}

QString ScriptedDesktop::openFileName(const FileQuestion &)
{
    return nextFile("open");
}

QStringList ScriptedDesktop::openFileNames(const FileQuestion &)
{
    return nextFile("open").split(u'\n', Qt::SkipEmptyParts);
}

QString ScriptedDesktop::saveFileName(const FileQuestion &)
{
    return nextFile("save");
}

QString ScriptedDesktop::folderName(const FileQuestion &)
{
    return nextFile("folder");
}

PrinterChoice ScriptedDesktop::choosePrinter(QPrinter &printer, int)
{
    if (mPrinters.empty()) {
        failTest(u"Unexpected dialog: printer"_s);
        return PrinterChoice::Cancelled;
    }
    const Printer chosen = mPrinters.front();
    mPrinters.pop_front();
    if (chosen.file.isEmpty())
        return PrinterChoice::NoPrinter;
    printer.setOutputFormat(QPrinter::PdfFormat);
    printer.setOutputFileName(chosen.file);
    printer.setPageOrder(chosen.order);
    return PrinterChoice::Chosen;
}

void ScriptedDesktop::setPointer(QWidget *window, PointerShape shape)
{
    QtDesktop().setPointer(window, shape);
}

void ScriptedDesktop::freeze(QWidget *window)
{
    drawingfreeze::freeze(window);
}

void ScriptedDesktop::pump()
{
    QtDesktop().pump();
}

void ScriptedDesktop::sendKeys(const QString &keys)
{
    QtDesktop().sendKeys(keys);
}

void ScriptedDesktop::openAddress(const QString &url, std::function<void()> notOpened)
{
    addresses.append(url);
    if (!browserThere)
        notOpened();
}

void inNextBox(const std::function<void(QMessageBox &)> &act)
{
    QTimer::singleShot(0, qApp, [act] {
        const QPointer<QMessageBox> box =
            qobject_cast<QMessageBox *>(QApplication::activeModalWidget());
        if (!box) {
            failTest(u"No box came"_s);
            return;
        }
        act(*box);
        if (box && box->isVisible())
            box->done(0);
    });
}
