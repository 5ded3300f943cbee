// Label: unit
#include "support/datarows.h"

#include <QDir>
#include <QDirIterator>
#include <QFile>
#include <QRegularExpression>

namespace
{

// The first column of the map in ARCHITECTURE.md, lowest room first: a room may include itself and
// those before it.
QStringList readRooms()
{
    QFile map(qEnvironmentVariable("SONGCASE_SOURCE") + u"/ARCHITECTURE.md"_s);
    if (!map.open(QIODevice::ReadOnly))
        return {};
    const QRegularExpression row(u"^\\| `([a-z/]+/|main\\.cpp)` \\|"_s,
                                 QRegularExpression::MultilineOption);
    QStringList rooms;
    for (auto it = row.globalMatch(QString::fromUtf8(map.readAll())); it.hasNext();) {
        const QString room = it.next().captured(1);
        rooms.prepend(room.endsWith(u'/') ? room.chopped(1) : room);
    }
    return rooms;
}

const QStringList rooms = readRooms();

// Rooms of values, without catalogue, screens and messages: what they may include besides
// themselves.
const QHash<QString, QStringList> valueRooms{
    {u"platform/text"_s, {}},
    {u"platform/error"_s, {u"platform/text"_s}},
    {u"tags"_s, {u"platform/text"_s, u"platform/error"_s}},
    {u"discs"_s, {u"platform/text"_s, u"platform/error"_s}},
    {u"helpers"_s, {u"platform/text"_s, u"platform/error"_s, u"discs"_s}},
};

// -1: none.
int roomOf(const QString &file)
{
    const auto holds = [&](const QString &room) {
        return file == room || file.startsWith(room + u'/');
    };
    const auto room = std::find_if(rooms.begin(), rooms.end(), holds);
    return room == rooms.end() ? -1 : int(room - rooms.begin());
}

// Whether a file of one room may include one of another.
bool mayInclude(int room, int included)
{
    if (room == included)
        return true;
    const auto values = valueRooms.constFind(rooms[room]);
    return values == valueRooms.end() ? included >= 0 && included < room
                                      : values->contains(rooms.value(included));
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
                QString::fromUtf8(file.readAll()).split(u'\n');
        }
        QVERIFY(mSources.size() > 50);
        QVERIFY(rooms.size() > 10);
        for (auto file = mSources.cbegin(); file != mSources.cend(); ++file)
            QVERIFY2(roomOf(file.key()) >= 0, qPrintable(file.key()));
    }

    void includesPointDownwards()
    {
        QStringList wrong;
        for (auto it = mSources.cbegin(); it != mSources.cend(); ++it) {
            for (const QString &included : includesIn(it.value(), u'"', u'"')) {
                // -1 too if it is not written from src
                if (!mayInclude(roomOf(it.key()), roomOf(included)))
                    wrong.append(it.key() + u" includes "_s + included);
            }
        }
        QVERIFY2(wrong.isEmpty(), qPrintable(wrong.join(u'\n')));
    }

    void librariesStayInTheirRooms_data()
    {
        // allowed: starts of file names, "|" between
        const DataRows<QString, QString> row("header", "allowed");
        row("^sqlite3", "platform/ado/|catalogue/cataloguefile");
        row("^unicode/", "platform/text/");
        row("^taglib/|^(id3v2|mpeg|tag)[a-z0-9]*\\.h", "tags/");
        row("^cdio/|^mdb|^glib", "helpers/");
        row("^discid/", "discdata/");
        row("^QSql|^QtSql", "nowhere");
        row("^QMessageBox|^QFileDialog|^QDesktopServices", "platform/desktop/");
        row("^thread$|^future$|^QThread|^QFuture|^QtConcurrent|^QProcess", "platform/work/");
        row("^Q(Tcp|Udp|Ssl)|^QNetwork", "platform/work/|discdata/");
        row("^QtTest|^QTest|^benchmark/", "nowhere");
    }

    void librariesStayInTheirRooms()
    {
        QFETCH(QString, header);
        QFETCH(QString, allowed);
        const QRegularExpression expression(header);
        const QStringList starts = allowed.split(u'|');
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
        QVERIFY2(wrong.isEmpty(), qPrintable(wrong.join(u'\n')));
    }

    void filesStayShort()
    {
        QStringList tooLong;
        for (auto it = mSources.cbegin(); it != mSources.cend(); ++it) {
            const bool frame = it.key() == "shell/MainScreen.cpp"_L1;
            if (it.value().size() > (frame ? 400 : 650))
                tooLong.append(it.key() + u": "_s + QString::number(it.value().size()));
        }
        QVERIFY2(tooLong.isEmpty(), qPrintable(tooLong.join(u'\n')));
    }
};

QTEST_APPLESS_MAIN(tst_Rooms)
#include "tst_Rooms.moc"
