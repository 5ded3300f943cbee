#include "platform/desktop/qtdesktop.h"

#include "platform/desktop/drawingfreeze.h"
#include "platform/desktop/modalloop.h"
#include "platform/desktop/nestedloop.h"
#include "platform/desktop/openaddress.h"
#include "platform/desktop/programfolder.h"
#include "platform/desktop/sentkey.h"
#include "platform/desktop/typedahead.h"
#include "platform/text/textrules.h"

#include <QApplication>
#include <QFileDialog>
#include <QKeySequence>
#include <QMessageBox>
#include <QPrintDialog>
#include <QPrinterInfo>
#include <QStandardPaths>

using namespace Qt::StringLiterals;

namespace
{

/// A question that only its buttons answer: Esc and the close button would be taken for one of
/// them.
class QuestionBox : public QMessageBox
{
public:
    using QMessageBox::QMessageBox;

    void onlyButtons() { mOnlyButtons = true; }

protected:
    void closeEvent(QCloseEvent *event) override
    {
        if (mOnlyButtons)
            event->ignore();
        else
            QMessageBox::closeEvent(event);
    }
    void keyPressEvent(QKeyEvent *event) override
    {
        if (!mOnlyButtons || event->key() != Qt::Key_Escape)
            QMessageBox::keyPressEvent(event);
    }

private:
    bool mOnlyButtons = false;
};

QMessageBox::StandardButtons buttonsOf(BoxButtons buttons)
{
    switch (buttons) {
    case BoxButtons::YesNo:
        return QMessageBox::Yes | QMessageBox::No;
    case BoxButtons::YesNoCancel:
        return QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel;
    case BoxButtons::Ok:
        break;
    }
    return QMessageBox::Ok;
}

QMessageBox::Icon iconOf(BoxKind kind)
{
    if (kind == BoxKind::Error)
        return QMessageBox::Critical;
    if (kind == BoxKind::Warning)
        return QMessageBox::Warning;
    if (kind == BoxKind::Plain)
        return QMessageBox::NoIcon;
    return kind == BoxKind::Question ? QMessageBox::Question : QMessageBox::Information;
}

BoxAnswer answerOf(int pressed)
{
    switch (pressed) {
    case QMessageBox::Yes:
        return vbYes;
    case QMessageBox::No:
        return vbNo;
    case QMessageBox::Cancel:
        return vbCancel;
    default:
        return vbOK;
    }
}

int run(QDialog &dialog)
{
    const NestedLoop nested;
    return dialog.exec();
}

QString chosen(QFileDialog &dialog)
{
    return run(dialog) == QDialog::Accepted ? dialog.selectedFiles().value(0) : QString();
}

void prepare(QFileDialog &dialog, const FileQuestion &question)
{
    dialog.setWindowTitle(question.title);
    if (!question.folder.isEmpty())
        dialog.setDirectory(question.folder);
    if (!question.patterns.isEmpty())
        dialog.setNameFilter(question.patterns);
    dialog.setDefaultSuffix(question.suffix);
    if (!question.name.isEmpty())
        dialog.selectFile(question.name);
}

// Pages typed as "2-3,5" are taken out by the caller and, with CUPS, once more by the server, which
// counts those that are left. "From 2 to 3" goes right.
void hideDoubledChoice(QPrintDialog &dialog)
{
    for (const char *name : {"pagesRadioButton", "pagesLineEdit"}) {
        if (auto *control = dialog.findChild<QWidget *>(QLatin1String(name)))
            control->hide();
    }
}

} // namespace

BoxAnswer QtDesktop::messageBox(BoxKind kind, BoxButtons buttons, const QString &text,
                                const QString &title)
{
    QuestionBox box(iconOf(kind), title, text::withLineFeeds(text), buttonsOf(buttons),
                    QApplication::activeWindow());
    box.setTextFormat(Qt::PlainText);
    if (buttons == BoxButtons::YesNo)
        box.onlyButtons();
    box.setDefaultButton(buttons == BoxButtons::Ok ? QMessageBox::Ok : QMessageBox::Yes);
    ignoreTypedAhead(&box, *this);
    setModalAnswered();
    return answerOf(run(box));
}

void QtDesktop::showModal(Form &form)
{
    runModal(form);
}

QString QtDesktop::openFileName(const FileQuestion &question)
{
    QFileDialog dialog(QApplication::activeWindow());
    prepare(dialog, question);
    dialog.setFileMode(QFileDialog::ExistingFile);
    return chosen(dialog);
}

QStringList QtDesktop::openFileNames(const FileQuestion &question)
{
    QFileDialog dialog(QApplication::activeWindow());
    prepare(dialog, question);
    dialog.setFileMode(QFileDialog::ExistingFiles);
    return run(dialog) == QDialog::Accepted ? dialog.selectedFiles() : QStringList();
}

QString QtDesktop::saveFileName(const FileQuestion &question)
{
    QFileDialog dialog(QApplication::activeWindow());
    prepare(dialog, question);
    dialog.setAcceptMode(QFileDialog::AcceptSave);
    dialog.setOption(QFileDialog::DontConfirmOverwrite); // the caller asks, in its own words
    return chosen(dialog);
}

QString QtDesktop::folderName(const FileQuestion &question)
{
    QFileDialog dialog(QApplication::activeWindow());
    prepare(dialog, question);
    dialog.setFileMode(QFileDialog::Directory);
    dialog.setOption(QFileDialog::ShowDirsOnly);
    return chosen(dialog);
}

PrinterChoice QtDesktop::choosePrinter(QPrinter &printer, int pages)
{
    if (QPrinterInfo::availablePrinterNames().isEmpty())
        return PrinterChoice::NoPrinter;
    QPrintDialog dialog(&printer, QApplication::activeWindow());
    dialog.setOptions(QAbstractPrintDialog::PrintPageRange |
                      QAbstractPrintDialog::PrintCurrentPage |
                      QAbstractPrintDialog::PrintCollateCopies);
    dialog.setMinMax(1, pages);
    dialog.setFromTo(1, pages);
    hideDoubledChoice(dialog);
    return run(dialog) == QDialog::Accepted ? PrinterChoice::Chosen : PrinterChoice::Cancelled;
}

QDateTime QtDesktop::now()
{
    return QDateTime::currentDateTime();
}

void QtDesktop::setPointer(QWidget *window, PointerShape shape)
{
    if (shape == vbDefault)
        window->unsetCursor();
    else
        window->setCursor(shape == vbHourglass ? Qt::WaitCursor : Qt::PointingHandCursor);
}

void QtDesktop::freeze(QWidget *window)
{
    drawingfreeze::freeze(window);
}

void QtDesktop::pump()
{
    const NestedLoop pumping;
    QApplication::processEvents();
}

void QtDesktop::sendKeys(const QString &keys)
{
    const QKeySequence sequence(keys);
    for (int i = 0; i < sequence.count(); ++i) {
        const QKeyCombination key = sequence[uint(i)];
        for (const auto type : {QEvent::KeyPress, QEvent::KeyRelease}) {
            // Each key goes to where the one before it has moved the focus.
            QWidget *to = QApplication::focusWidget();
            if (!to)
                to = QApplication::activeWindow();
            SentKey event(type, key.key(), key.keyboardModifiers());
            if (to)
                QApplication::sendEvent(to, &event);
        }
    }
}

void QtDesktop::openAddress(const QString &url, std::function<void()> notOpened)
{
    openInBrowser(url, notOpened);
}

QString QtDesktop::settingsFile()
{
    return QStandardPaths::writableLocation(QStandardPaths::AppConfigLocation) +
           u"/settings.json"_s;
}

QString QtDesktop::programFolder()
{
    return programfolder::find();
}
