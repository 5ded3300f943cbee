// Label: unit
#include "support/datarows.h"

#include <QDir>
#include <QDirIterator>
#include <QFile>
#include <QRegularExpression>

namespace
{

// Lowest first: a room may include itself and those before it.
const QStringList rooms{
    u"platform/text"_s,  u"platform/ado"_s, u"platform/desktop"_s,
    u"shell/services"_s, u"catalogue"_s,    u"controls"_s,
    u"textimport"_s,     u"discdata"_s,     u"mp3"_s,
    u"collection"_s,     u"shell"_s,        u"main.cpp"_s,
};

// The room with the longest fitting name: "shell/services/x.h" is not of "shell". -1: none.
int roomOf(const QString &file)
{
    int found = -1;
    for (int i = 0; i < rooms.size(); ++i) {
        const bool fits = file == rooms[i] || file.startsWith(rooms[i] + QLatin1Char('/'));
        if (fits && (found < 0 || rooms[i].size() > rooms[found].size()))
            found = i;
    }
    return found;
}

QStringList includesIn(const QStringList &lines, QChar open, QChar close)
{
    const QRegularExpression line(u"^\\s*#\\s*include\\s*"_s +
                                  QRegularExpression::escape(QString(open)) + u"([^>\"]+)"_s +
                                  QRegularExpression::escape(QString(close)));
    QStringList all;
    for (const QString &l : lines) {
        if (const auto match = line.match(l); match.hasMatch())
            all.append(match.captured(1));
    }
    return all;
}

} // namespace

/// The architecture as a test: which folder may include which, and how long a file may be.
class tst_Rooms : public QObject
{
    Q_OBJECT

private:
    QMap<QString, QStringList> mSources; // lines by name below src/

private slots:
    void initTestCase()
    {
        const QDir src(qEnvironmentVariable("SONGCASE_SOURCE") + u"/src"_s);
        QDirIterator it(src.path(), {u"*.cpp"_s, u"*.h"_s}, QDir::Files,
                        QDirIterator::Subdirectories);
        while (it.hasNext()) {
            QFile file(it.next());
            QVERIFY(file.open(QIODevice::ReadOnly));
            mSources[src.relativeFilePath(file.fileName())] =
                QString::fromUtf8(file.readAll()).split(QLatin1Char('\n'));
        }
        QVERIFY(mSources.size() > 50);
        for (auto file = mSources.cbegin(); file != mSources.cend(); ++file)
            QVERIFY2(roomOf(file.key()) >= 0, qPrintable(file.key()));
    }

    void includesPointDownwards()
    {
        QStringList wrong;
        for (auto it = mSources.cbegin(); it != mSources.cend(); ++it) {
            for (const QString &included : includesIn(it.value(), u'"', u'"')) {
                const bool generated = included.startsWith(QLatin1String("ui_")) ||
                                       included.endsWith(QLatin1String(".moc"));
                const int room = roomOf(included); // -1 too if it is not written from src
                if (!generated && (room < 0 || room > roomOf(it.key())))
                    wrong.append(it.key() + u" includes "_s + included);
            }
        }
        QVERIFY2(wrong.isEmpty(), qPrintable(wrong.join(QLatin1Char('\n'))));
    }

    void librariesStayInTheirRooms_data()
    {
        // allowed: starts of file names, "|" between
        const DataRows<QString, QString> row("header", "allowed");
        row("^sqlite3", "platform/ado/|catalogue/cataloguefile");
        row("^unicode/", "platform/text/");
        row("^taglib/|^(id3v2|mpeg|tag)[a-z0-9]*\\.h", "mp3/");
        row("^cdio/", "discdata/");
        row("^mdb|^glib", "catalogue/");
        row("^QSql|^QtSql", "nowhere");
        row("^QMessageBox|^QFileDialog|^QDesktopServices", "platform/desktop/");
        row("^QtTest|^QTest|^benchmark/", "nowhere");
    }

    void librariesStayInTheirRooms()
    {
        QFETCH(QString, header);
        QFETCH(QString, allowed);
        const QRegularExpression expression(header);
        const QStringList starts = allowed.split(QLatin1Char('|'));
        QStringList wrong;
        for (auto it = mSources.cbegin(); it != mSources.cend(); ++it) {
            const bool fine = std::any_of(starts.begin(), starts.end(), [&](const QString &start) {
                return it.key().startsWith(start);
            });
            for (const QString &included : includesIn(it.value(), u'<', u'>')) {
                if (!fine && expression.match(included).hasMatch())
                    wrong.append(it.key() + u" includes "_s + included);
            }
        }
        QVERIFY2(wrong.isEmpty(), qPrintable(wrong.join(QLatin1Char('\n'))));
    }

    void filesStayShort()
    {
        QStringList tooLong;
        for (auto it = mSources.cbegin(); it != mSources.cend(); ++it) {
            const bool frame = it.key() == QLatin1String("shell/MainScreen.cpp");
            if (it.value().size() > (frame ? 400 : 650))
                tooLong.append(it.key() + u": "_s + QString::number(it.value().size()));
        }
        QVERIFY2(tooLong.isEmpty(), qPrintable(tooLong.join(QLatin1Char('\n'))));
    }
};

QTEST_APPLESS_MAIN(tst_Rooms)
#include "tst_Rooms.moc"
