// Label: unit
#include "platform/desktop/openaddress.h"
#include "support/datarows.h"
#include "support/testcatalogue.h"

#include <QElapsedTimer>
#include <QFile>
#include <QTest>

/// An address for the browser, given to what the desktop has for that.
class tst_OpenAddress : public QObject
{
    Q_OBJECT

private slots:
    void whetherABrowserIsFound_data()
    {
        // what stands for the desktop's program, none if empty
        const DataRows<QByteArray, bool> row("opener", "opened");
        row("a browser", "echo \"$1\" >\"$0.opened\"", true);
        row("there, but finds none", "exit 3", false);
        row("killed", "kill -9 $$", false);
        row("nothing there", "", false);
    }

    void whetherABrowserIsFound()
    {
        QFETCH(QByteArray, opener);
        QFETCH(bool, opened);
        const QTemporaryDir folder;
        const QString program = folder.filePath(u"xdg-open"_s);
        if (!opener.isEmpty()) {
            writeFile(program, "#!/bin/sh\n" + opener + "\n");
            QFile::setPermissions(program, QFile::Permissions(0x7700));
        }
        qputenv("PATH", QFile::encodeName(folder.path()));
        int told = 0;
        openInBrowser(u"file:///a b"_s, [&] { ++told; });
        QCOMPARE(told, 0); // never before it has returned
        if (opened)
            QTRY_COMPARE(readFile(program + u".opened"_s), QByteArray("file:///a b\n"));
        else
            QTRY_COMPARE(told, 1);
        QCOMPARE(told, opened ? 0 : 1);
    }
};

QTEST_MAIN(tst_OpenAddress)
#include "tst_OpenAddress.moc"
