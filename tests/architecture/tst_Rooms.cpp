// Label: unit
#include "services/globals.h"
#include "services/messages.h"
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
    const QRegularExpression row(u"^\\| `([a-z0-9/]+/|main\\.cpp)` \\|"_s,
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
    {u"tags"_s, {u"platform/text"_s, u"platform/error"_s, u"platform/files"_s}},
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

// places: starts of file names, "|" between.
bool isOneOf(const QString &file, const QString &places)
{
    const QStringList starts = places.split(u'|');
    return std::any_of(starts.begin(), starts.end(),
                       [&](const QString &start) { return file.startsWith(start); });
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
        row("^thread$|^future$|^QThread|^QFuture|^QtConcurrent|^QProcess",
            "platform/work/|platform/desktop/openaddress");
        row("^Q(Tcp|Udp|Ssl)|^QNetwork", "platform/work/|discdata/");
        row("^QtTest|^QTest|^benchmark/", "nowhere");
    }

    void librariesStayInTheirRooms()
    {
        QFETCH(QString, header);
        QFETCH(QString, allowed);
        const QRegularExpression expression(header);
        QStringList wrong;
        for (auto it = mSources.cbegin(); it != mSources.cend(); ++it) {
            const bool fine = isOneOf(it.key(), allowed);
            for (const QString &included : includesIn(it.value(), u'<', u'>')) {
                if (!fine && expression.match(included).hasMatch())
                    wrong.append(it.key() + u" includes "_s + included);
            }
        }
        QVERIFY2(wrong.isEmpty(), qPrintable(wrong.join(u'\n')));
    }

    void callsStayInTheirPlaces_data()
    {
        // places: starts of file names, "|" between
        const DataRows<QString, QString, QString> row("call", "places", "example");
        row("events", "\\bprocessEvents\\b", "platform/desktop/|platform/work/",
            "QApplication::processEvents();");
        // How long ago a letter was typed belongs to the list alone.
        row("clock",
            "\\b(QElapsedTimer|QDeadlineTimer|std::chrono|current(Date|Time|DateTime)(Utc)?|"
            "current(M?)SecsSinceEpoch)\\b",
            "platform/|controls/list/DBListViewCTL", "QDateTime::currentDateTime()");
        row("chained arg", "\\.arg\\((?:[^()]|\\([^()]*\\))*\\)\\s*\\.arg\\(", "nowhere",
            "text.arg(f(x))\n    .arg(y)");
    }

    void callsStayInTheirPlaces()
    {
        QFETCH(QString, call);
        QFETCH(QString, places);
        QFETCH(QString, example);
        const QRegularExpression expression(call);
        QVERIFY(expression.match(example).hasMatch());
        QStringList wrong;
        for (auto it = mSources.cbegin(); it != mSources.cend(); ++it) {
            const auto match = expression.match(it.value().join(u'\n'));
            if (match.hasMatch() && !isOneOf(it.key(), places))
                wrong.append(it.key() + u": "_s + match.captured());
        }
        QVERIFY2(wrong.isEmpty(), qPrintable(wrong.join(u'\n')));
    }

    // Keys of texts by the calls that take them, by the tables of captions, and by how they begin.
    void textsThatAreAskedForExist()
    {
        static const QRegularExpression literal(u"(?<!\\w)\"([^\"]*)\"(?!_)"_s);
        static const QRegularExpression takers(
            u"\\b(?:GetMessage|message|refuse|errorText|paragraph)\\(((?:[^()]|\\([^()]*\\))*)\\)"_s);
        static const QRegularExpression tables(u"applyCaptions\\(.*?\\}\\);"_s,
                                               QRegularExpression::DotMatchesEverythingOption);
        static const QRegularExpression caption(u"\\{\\s*\"[^\"]+\",\\s*\"([^\"]+)\""_s);
        static const QRegularExpression start(
            u"(?<!\\w)\"((?:x[A-Z]|Msg|Quest|TT[A-Z]?[a-z])\\w*)\""_s);
        QSet<QString> keys;
        const auto take = [&keys](const QRegularExpression &which, const QString &from) {
            for (const auto &match : which.globalMatch(from))
                keys.insert(match.captured(1));
        };
        for (const QStringList &lines : std::as_const(mSources)) {
            const QString source = lines.join(u'\n');
            for (const auto &call : takers.globalMatch(source))
                take(literal, call.captured(1));
            for (const auto &table : tables.globalMatch(source))
                take(caption, table.captured());
            take(start, source);
        }
        QVERIFY(keys.size() > 150 && keys.contains(u"MainScreen.Caption"_s));
        keys.remove(u"MsgInvalidDiscValues"_s); // by design
        keys.removeIf([](const QString &key) {
            const QByteArray name = key.toLatin1();
            return GetMessage(QLatin1String(name), languageEnglish) != u"Unknown"_s;
        });
        QCOMPARE(QStringList(keys.begin(), keys.end()), QStringList());
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
