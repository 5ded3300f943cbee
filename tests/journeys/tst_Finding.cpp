// Label: journey
#include "collection/cdeditor.h"
#include "controls/list/DBListViewCTL.h"
#include "controls/tracks/trackgrid.h"
#include "support/editing.h"
#include "support/journey.h"

#include <QApplication>
#include <QPushButton>
#include <QStatusBar>
#include <QTabWidget>
#include <QToolButton>

/// A person enters discs, finds a song on one of them, keeps the list and prints what there is.
class tst_Finding : public Journey
{
    Q_OBJECT

private:
    static QByteArray content(const QString &name)
    {
        QFile file(name);
        return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
    }

    void enterCompilation()
    {
        mProgram->choose("mnuCDInsert");
        keyboard::fill({u"Mix"_s, {}, u"1985"_s});
        keyboard::fill({u"Zed"_s, u"One More"_s, u"Pop"_s, u"1985"_s});
        keyboard::fill({u"Édith"_s, u"Encore"_s, {}, {}});
        keyboard::press(Qt::Key_S, Qt::ControlModifier);
        mProgram->screen("frmCDRoot")->Unload();
    }

private slots:
    // Of the button as long as it can be pressed, and else of the menu "&Songcase".
    void anAccessKey_data()
    {
        const DataRows<bool> row("enabled");
        row("of a button", true);
        row("of a disabled one", false);
    }
    void anAccessKey()
    {
        QFETCH(bool, enabled);
        start(languageEnglish);
        mProgram->choose("mnuSearchArtistsTitles");
        QTRY_VERIFY(
            mProgram->control<QLineEdit>("frmSearchArtistsTitles", "txtArtistKey")->hasFocus());
        mProgram->control<QPushButton>("frmSearchArtistsTitles", "cmdSearch")->setEnabled(enabled);
        keyboard::press(Qt::Key_S, Qt::AltModifier);
        QWidget *menu = QApplication::activePopupWidget();
        QCOMPARE(bool(menu), !enabled);
        if (menu)
            menu->close();
        const auto *status = mProgram->control<QStatusBar>("frmSearchArtistsTitles", "StatusBar");
        QCOMPARE(status->currentMessage().startsWith(GetMessage("NumberFound")), enabled);
    }

    void aSongIsFoundKeptAndPrinted_data() { languages(); }
    void aSongIsFoundKeptAndPrinted()
    {
        QFETCH(int, language);
        start(language);
        enterCompilation();

        mProgram->choose("mnuSearchArtistsTitles");
        QTRY_VERIFY(
            mProgram->control<QLineEdit>("frmSearchArtistsTitles", "txtArtistKey")->hasFocus());
        keyboard::type(u"éd"_s);
        keyboard::press(Qt::Key_Return);
        QCOMPARE(
            mProgram->control<QStatusBar>("frmSearchArtistsTitles", "StatusBar")->currentMessage(),
            QString(GetMessage("NumberFound") + u'1'));

        const QString list = mDesktop->folder + u"/list.txt"_s;
        mDesktop->expectFile(list);
        mProgram->control<QPushButton>("frmSearchArtistsTitles", "cmdExport")->click();
        QCOMPARE(content(list),
                 "\"Édith\",\"Encore\",\"1\",\"2\",\"Mix\",\"\",\"\",\"Compilation\"\n");

        mProgram->control<DBListViewCTL>("frmSearchArtistsTitles", "ResultList")->setFocus();
        keyboard::press(Qt::Key_Return);
        QCOMPARE(mProgram->control<TrackGrid>("frmCDRoot", "TheDisk")->CurrentRow(), 2);

        mProgram->choose("mnuUpdate");
        mProgram->control<QTabWidget>("frmCDList", "CDTab")->setCurrentIndex(2);
        mProgram->control<QPushButton>("frmCDList", "cmdStartReport")->click();
        QCOMPARE(mProgram->screen("PlatenbakReport")->windowTitle(), u"Records"_s);
        const QString pdf = mDesktop->folder + u"/records.pdf"_s;
        mDesktop->expectFile(pdf);
        mProgram->control<QToolButton>("PlatenbakReport", "cmdPdf")->click();
        QVERIFY(content(pdf).startsWith("%PDF"));
    }
};

QTEST_MAIN(tst_Finding)
#include "tst_Finding.moc"
