// Label: unit
#include <QDir>
#include <QDirIterator>
#include <QFile>
#include <QRegularExpression>
#include <QTest>

/// The architecture as a test: which folder may include which, and how long a file may be.
class tst_Rooms : public QObject
{
    Q_OBJECT

private slots:
    void initTestCase();
    void everyFileHasARoom();
    void includesPointDownwards();
    void librariesStayInTheirRooms_data();
    void librariesStayInTheirRooms();
    void filesStayShort();

private:
    QMap<QString, QStringList> mSources; // lines by name below src/
};

namespace
{

// Lowest first: a room may include itself and those before it.
const QStringList rooms{
    QStringLiteral("platform/text"),
    QStringLiteral("platform/ado"),
    QStringLiteral("platform/desktop"),
    QStringLiteral("shell/services"),
    QStringLiteral("catalogue"),
    QStringLiteral("controls"),
    QStringLiteral("textimport"),
    QStringLiteral("discdata"),
    QStringLiteral("mp3"),
    QStringLiteral("collection"),
    QStringLiteral("shell"),
    QStringLiteral("main.cpp"),
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
    const QRegularExpression line(
        QStringLiteral("^\\s*#\\s*include\\s*") + QRegularExpression::escape(QString(open)) +
        QStringLiteral("([^>\"]+)") + QRegularExpression::escape(QString(close)));
    QStringList all;
    for (const QString &l : lines) {
        if (const auto match = line.match(l); match.hasMatch())
            all.append(match.captured(1));
    }
    return all;
}

} // namespace

void tst_Rooms::initTestCase()
{
    const QDir src(qEnvironmentVariable("SONGCASE_SOURCE") + QStringLiteral("/src"));
    QDirIterator it(src.path(), {QStringLiteral("*.cpp"), QStringLiteral("*.h")}, QDir::Files,
                    QDirIterator::Subdirectories);
    while (it.hasNext()) {
        QFile file(it.next());
        QVERIFY(file.open(QIODevice::ReadOnly));
        mSources[src.relativeFilePath(file.fileName())] =
            QString::fromUtf8(file.readAll()).split(QLatin1Char('\n'));
    }
    QVERIFY(mSources.size() > 50);
}

void tst_Rooms::everyFileHasARoom()
{
    for (auto it = mSources.cbegin(); it != mSources.cend(); ++it)
        QVERIFY2(roomOf(it.key()) >= 0, qPrintable(it.key()));
}

void tst_Rooms::includesPointDownwards()
{
    QStringList wrong;
    for (auto it = mSources.cbegin(); it != mSources.cend(); ++it) {
        for (const QString &included : includesIn(it.value(), u'"', u'"')) {
            const bool generated = included.startsWith(QLatin1String("ui_")) ||
                                   included.endsWith(QLatin1String(".moc"));
            const int room = roomOf(included); // -1 too if it is not written from src
            if (!generated && (room < 0 || room > roomOf(it.key())))
                wrong.append(it.key() + QStringLiteral(" includes ") + included);
        }
    }
    QVERIFY2(wrong.isEmpty(), qPrintable(wrong.join(QLatin1Char('\n'))));
}

void tst_Rooms::librariesStayInTheirRooms_data()
{
    QTest::addColumn<QString>("header");
    QTest::addColumn<QString>("allowed"); // starts of file names, "|" between
    const auto row = [](const char *header, const char *allowed) {
        QTest::newRow(header) << QString::fromLatin1(header) << QString::fromLatin1(allowed);
    };
    row("^sqlite3", "platform/ado/|catalogue/cataloguefile");
    row("^unicode/", "platform/text/");
    row("^taglib/|^(id3v2|mpeg|tag)[a-z0-9]*\\.h", "mp3/");
    row("^cdio/", "discdata/");
    row("^mdb|^glib", "catalogue/");
    row("^QSql|^QtSql", "nowhere");
    row("^QMessageBox|^QFileDialog|^QDesktopServices", "platform/desktop/");
    row("^QtTest|^QTest|^benchmark/", "nowhere");
}

void tst_Rooms::librariesStayInTheirRooms()
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
                wrong.append(it.key() + QStringLiteral(" includes ") + included);
        }
    }
    QVERIFY2(wrong.isEmpty(), qPrintable(wrong.join(QLatin1Char('\n'))));
}

void tst_Rooms::filesStayShort()
{
    QStringList tooLong;
    for (auto it = mSources.cbegin(); it != mSources.cend(); ++it) {
        const bool frame = it.key() == QLatin1String("shell/MainScreen.cpp");
        if (it.value().size() > (frame ? 400 : 650))
            tooLong.append(it.key() + QStringLiteral(": ") + QString::number(it.value().size()));
    }
    QVERIFY2(tooLong.isEmpty(), qPrintable(tooLong.join(QLatin1Char('\n'))));
}

QTEST_APPLESS_MAIN(tst_Rooms)
#include "tst_Rooms.moc"
