#include "support/editing.h"

#include <QApplication>
#include <QTest>

namespace keyboard
{

void press(Qt::Key key, Qt::KeyboardModifiers modifiers)
{
    QWidget *to = QApplication::focusWidget();
    QVERIFY2(to, "nothing has the focus");
    QTest::keyClick(to, key, modifiers);
}

void type(const AnyText &text)
{
    const auto characters = text.toUcs4();
    for (const char32_t c : characters) {
        QWidget *to = QApplication::focusWidget();
        QVERIFY2(to, "nothing has the focus");
        QTest::sendKeyEvent(QTest::Click, to, Qt::Key_unknown, QString::fromUcs4(&c, 1),
                            Qt::NoModifier);
    }
}

void fill(const QStringList &fields)
{
    for (const QString &field : fields) {
        type(field);
        press(Qt::Key_Tab);
    }
}

} // namespace keyboard

Editing::Editing(int language)
{
    gLanguage = language;
    browser = new CountingBrowser;
}

Editing::~Editing()
{
    if (editor) {
        editor->findChild<QAbstractButton *>(u"cmdCancel"_s)->click();
        QVERIFY(!editor || editor->isUnloaded());
    }
    if (browser)
        browser->Unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    desktop.verifyAllCame();
}

void Editing::show(CdEditor *shown)
{
    editor = shown;
    editor->Show();
    if (!editor->isVisible())
        return;
    editor->activateWindow();
    QVERIFY(QTest::qWaitForWindowActive(editor));
}

void Editing::addTracks(const QStringList &tracks)
{
    disk()->setFocus();
    for (const QString &track : tracks) {
        disk()->setCurrentRow(disk()->model()->rowCount());
        disk()->setCurrentColumn(2);
        keyboard::fill(track.split(u'|'));
    }
}

void Editing::setCell(int row, int column, const AnyText &text)
{
    disk()->setFocus();
    disk()->setCurrentRow(row);
    disk()->setCurrentColumn(column);
    keyboard::type(text);
    disk()->CommitEdit();
}

QString Editing::cell(int row, int column) const
{
    return disk()->model()->index(row - 1, column - 1).data().toString();
}

QStringList Editing::tracks(qint64 id)
{
    return catalogue.rows(
        u"select DiskNo || '/' || TrackNo || ' ' || Naam || ' - ' || Titel "
        "from CompactDiscs c join Tracks t on t.ID = c.Track_ID join Artiesten a on "
        "a.ID = t.Artiest_ID where CDTitels_ID = "_s +
        QString::number(id) + u" order by DiskNo, TrackNo"_s);
}

QStringList openEditors()
{
    QStringList found;
    for (Form *form : Form::openForms()) {
        if (const auto *editor = qobject_cast<CdEditor *>(form))
            found.append(editor->Name() + u' ' + editor->Mode + u' ' +
                         QString::number(editor->CdId));
    }
    return found;
}
