// Label: journey
#include "controls/list/DBListViewCTL.h"
#include "support/journey.h"
#include "support/madesound.h"

#include <QDir>
#include <QLineEdit>
#include <QPushButton>
#include <QTabWidget>

/// From a folder of files to a collection, and on to a record of the catalogue.
class tst_Collections : public Journey
{
    Q_OBJECT

private:
    QString folder() const { return mDesktop->folder + u"/music"_s; }

    void put(const QString &name, int track)
    {
        QDir().mkpath(folder());
        writeFile(folder() + u'/' + name, id3Tag({{"TIT2", u"Song "_s + QString::number(track)},
                                                  {"TPE1", u"Zed"_s},
                                                  {"TALB", u"Best"_s},
                                                  {"TRCK", QString::number(track)}}) +
                                              silentMP3(50));
    }

    void press(const char *button)
    {
        mProgram->control<QPushButton>("frmCDRootMP3", button)->click();
    }

    DBListViewCTL *list() const
    {
        return mProgram->control<DBListViewCTL>("frmCDRootMP3", "TheMP3Collection");
    }

    QString files() const
    {
        QStringList names;
        for (int i = 1; i <= list()->ListItems().Count(); ++i)
            names.append(list()->ListItems().Item(i).SubItems(1));
        return names.join(u' ');
    }

    void openStored()
    {
        mProgram->control<QTabWidget>("frmCDList", "CDTab")->setCurrentIndex(3);
        mProgram->control<QPushButton>("frmCDList", "cmdUpdate")->click();
    }

private slots:
    void fromAFolderToARecord_data() { languages(); }
    void fromAFolderToARecord()
    {
        QFETCH(int, language);
        start(language);
        for (int track = 1; track <= 3; ++track)
            put(QString::number(track) + u".mp3"_s, track);

        mProgram->choose("mnuMP3");
        mProgram->control<QLineEdit>("frmCDRootMP3", "txtFolder")->setText(folder());
        mProgram->control<QLineEdit>("frmCDRootMP3", "txtTitel")->setText(u"Mine"_s);
        press("cmdScan");
        QTest::keyClick(list(), Qt::Key_Home);
        QTest::keyClick(list(), Qt::Key_Down, Qt::AltModifier);
        QCOMPARE(files(), u"2.mp3 1.mp3 3.mp3"_s);
        press("cmdOK");
        QVERIFY(!mProgram->screen("frmCDRootMP3"));
        QCOMPARE(column("MP3List", 2), texts("Mine"));

        openStored();
        QTest::keyClick(list(), Qt::Key_A, Qt::ControlModifier);
        press("cmdRename");
        QCOMPARE(files(), u"02-Zed-Song 2.mp3 01-Zed-Song 1.mp3 03-Zed-Song 3.mp3"_s);
        mDesktop->expectBox(GetMessage("AdAlbumToDatabase"), vbYes);
        mDesktop->expectBox(GetMessage("CDImported"));
        press("cmdImportAsCD");
        QCOMPARE(column("SngList", 2), texts("Best"));
        press("cmdOK");

        // The names are taken back; the editor that stands open follows.
        openStored();
        mDesktop->expectModal(u"UndoChanges"_s, [this](Form &form) {
            mDesktop->expectBox(GetMessage("xUndoQuestion") + u'3', vbYes);
            mDesktop->expectBox(GetMessage("xUndonePart1") + u'3');
            form.findChild<QPushButton *>(u"cmdUndo"_s)->click();
            form.Unload();
        });
        mProgram->choose("mnuUndoChanges");
        press("cmdRefreshList");
        QCOMPARE(files(), u"2.mp3 1.mp3 3.mp3"_s);
        press("cmdOK"); // nothing is left to save

        // The medium is taken out, and comes back.
        openStored();
        QVERIFY(QDir().rename(folder(), folder() + u"2"_s) && QDir().mkpath(folder()));
        mDesktop->expectBox(GetMessage("OneOrMoreFilesDoNotExist"));
        press("cmdRefreshList");
        QVERIFY(!mProgram->control<QPushButton>("frmCDRootMP3", "cmdOK")->isEnabled());
        QVERIFY(QDir().rmdir(folder()) && QDir().rename(folder() + u"2"_s, folder()));
        press("cmdRefreshList");
        QVERIFY(mProgram->control<QPushButton>("frmCDRootMP3", "cmdOK")->isEnabled());
        press("cmdCancel");

        mDesktop->expectBox(GetMessage("QuestDeleteMP3"), vbYes);
        mProgram->control<QPushButton>("frmCDList", "cmdDelete")->click();
        QVERIFY(column("MP3List", 2).isEmpty());
        QCOMPARE(QDir(folder()).entryList(QDir::Files).size(), 3);
    }
};

QTEST_MAIN(tst_Collections)
#include "tst_Collections.moc"
