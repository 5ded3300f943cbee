#include "support/scripteddesktop.h"

#include "platform/desktop/drawingfreeze.h"
#include "platform/desktop/form.h"
#include "platform/desktop/modalloop.h"
#include "platform/desktop/qtdesktop.h"

#include <QPrinter>
#include <QTest>
#include <QTimer>

namespace
{

constexpr int modalAtMost = 30000; // milliseconds

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
    if (kind == BoxKind::Plain)
        return "plain";
    return kind == BoxKind::Error ? "error" : "information";
}

} // namespace

ScriptedDesktop::ScriptedDesktop()
    : folder(mTemporary.path()),
      settings(mTemporary.filePath(QStringLiteral("config/settings.json")))
{
    setCurrent(this);
}

ScriptedDesktop::~ScriptedDesktop() = default;

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
        failTest(QStringLiteral("This box did not come: ") + box.part);
    for (const Modal &modal : mModals)
        failTest(QStringLiteral("This screen did not come: ") + modal.name);
    for (const QString &file : mFiles)
        failTest(QStringLiteral("No dialog asked for: ") + file);
    for (const QString &printer : mPrinters)
        failTest(QStringLiteral("Nothing was printed: ") + printer);
    mBoxes.clear();
    mModals.clear();
    mFiles.clear();
    mPrinters.clear();
}

BoxAnswer ScriptedDesktop::messageBox(BoxKind kind, BoxButtons buttons, const QString &text,
                                      const QString &title)
{
    const QString line = QLatin1String(kindOf(kind, buttons)) + QStringLiteral(" [") + title +
                         QStringLiteral("] ") + text;
    boxes.append(line);
    if (mBoxes.empty() || !line.contains(mBoxes.front().part)) {
        failTest(
            QStringLiteral("Unexpected box: ") + line +
            (mBoxes.empty() ? QString() : QStringLiteral("; awaited: ") + mBoxes.front().part));
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
        failTest(QStringLiteral("Unexpected modal screen: ") + form.Name());
    }
    QPointer<Form> alive = &form;
    QTimer guard;
    guard.setSingleShot(true);
    QObject::connect(&guard, &QTimer::timeout, &form, [alive] {
        failTest(QStringLiteral("The modal screen did not end: ") + alive->Name());
        alive->hide();
    });
    guard.start(modalAtMost);
    if (script)
        QTimer::singleShot(0, &form, [script, alive] { script(*alive); });
    runModal(form);
}

QString ScriptedDesktop::nextFile(const char *dialog)
{
    if (mFiles.empty()) {
        failTest(QStringLiteral("Unexpected dialog: ") + QLatin1String(dialog));
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
        failTest(QStringLiteral("Unexpected dialog: printer"));
        return PrinterChoice::Cancelled;
    }
    const QString file = mPrinters.front();
    mPrinters.pop_front();
    if (file.isEmpty())
        return PrinterChoice::NoPrinter;
    printer.setOutputFormat(QPrinter::PdfFormat);
    printer.setOutputFileName(file);
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

bool ScriptedDesktop::openAddress(const QString &url)
{
    addresses.append(url);
    return browserThere;
}
