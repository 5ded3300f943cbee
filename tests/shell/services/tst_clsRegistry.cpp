// Label: unit
#include "shell/services/clsRegistry.h"
#include "support/ordinaryuser.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <QTest>
#include <sys/wait.h>

/// The store of settings on a real file, and what it tells of failures.
class tst_clsRegistry : public QObject
{
    Q_OBJECT

private slots:
    void init();
    void keepsTexts_data();
    void keepsTexts();
    void otherTypesDoNothing_data();
    void otherTypesDoNothing();
    void spellingsOfTheKey();
    void missingOnes();
    void deletes();
    void mainKeysAreApart();
    void otherContentOfTheFile();
    void damagedFileIsSetAside_data();
    void damagedFileIsSetAside();
    void unreadableFileIsNotReplaced();
    void readOnlyFolder();
    void belongsToItsUser();
    void twoWriters();

private:
    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<clsRegistry> mRegistry;
    QStringList mEvents; // of mRegistry: action, key, value, number

    QString folder() const { return QFileInfo(mDesktop->settings).absolutePath(); }
    QByteArray content() const;
    void set(const char *name, const QVariant &value)
    {
        mRegistry->SetValue(settingsKey, QLatin1String(name), value);
    }
    QVariant get(const char *name)
    {
        return mRegistry->GetValue(settingsReadKey, QLatin1String(name));
    }
};

void tst_clsRegistry::init()
{
    mDesktop = std::make_unique<ScriptedDesktop>();
    mRegistry = std::make_unique<clsRegistry>();
    mEvents.clear();
    connect(mRegistry.get(), &clsRegistry::regFout, this,
            [this](const ADODB::Error &error, const QString &source, const QString &action,
                   const QString &key, const QString &name) {
                QCOMPARE(source, QStringLiteral("clsRegistry"));
                QCOMPARE(error.Source, source);
                const auto code = unsigned(error.Number) - 0x80040000u;
                mEvents.append(QStringList{action, key, name, QString::number(code)}.join(u' '));
            });
    connect(mRegistry.get(), &clsRegistry::vbFout, this, [] { QFAIL("vbFout"); });
    QDir().mkpath(folder());
}

QByteArray tst_clsRegistry::content() const
{
    QFile file(mDesktop->settings);
    return file.open(QIODevice::ReadOnly) ? file.readAll() : QByteArray();
}

void tst_clsRegistry::keepsTexts_data()
{
    QTest::addColumn<QVariant>("value");
    QTest::newRow("text") << QVariant(QStringLiteral("C:\\Muziek\\\u00e9\U0001F3B5"));
    QTest::newRow("empty text") << QVariant(QStringLiteral(""));
    QTest::newRow("digits stay a text") << QVariant(QStringLiteral("0080"));
    QTest::newRow("number") << QVariant(19);
    QTest::newRow("zero") << QVariant(0);
    QTest::newRow("largest") << QVariant(std::numeric_limits<int>::max());
    QTest::newRow("smallest") << QVariant(std::numeric_limits<int>::min());
}

void tst_clsRegistry::keepsTexts()
{
    QFETCH(QVariant, value);
    mRegistry->CreateKey(settingsKey);
    set("Value", 7);
    set("Value", value);
    set("Other", 8);
    QCOMPARE(clsRegistry().GetValue(settingsReadKey, QStringLiteral("VALUE")), value);
    QCOMPARE(get("Value").typeId(), value.typeId());
    QCOMPARE(mEvents, QStringList());
}

void tst_clsRegistry::otherTypesDoNothing_data()
{
    QTest::addColumn<QVariant>("value");
    QTest::newRow("16 bits") << QVariant::fromValue(short(1));
    QTest::newRow("64 bits") << QVariant(qint64(1));
    QTest::newRow("unsigned") << QVariant(1u);
    QTest::newRow("boolean") << QVariant(true);
    QTest::newRow("fraction") << QVariant(1.0);
    QTest::newRow("bytes") << QVariant(QByteArray("x"));
    QTest::newRow("nothing") << QVariant();
}

void tst_clsRegistry::otherTypesDoNothing()
{
    QFETCH(QVariant, value);
    mRegistry->CreateKey(settingsKey);
    set("Value", QStringLiteral("before"));
    const QByteArray before = content();
    set("Value", value);
    set("New", value);
    QCOMPARE(content(), before);
    QCOMPARE(mEvents, QStringList());
}

void tst_clsRegistry::spellingsOfTheKey()
{
    mRegistry->CreateKey(QStringLiteral("Software\\Orvanta Software\\SongCase"));
    const QString spellings[] = {QStringLiteral("Software\\Orvanta Software\\SongCase\\"),
                                 QStringLiteral("Software\\Orvanta Software\\Songcase"),
                                 QStringLiteral("SOFTWARE\\orvanta software\\songcase\\")};
    for (const QString &write : spellings) {
        mRegistry->SetValue(write, QStringLiteral("Language"), 19);
        for (const QString &read : spellings)
            QCOMPARE(mRegistry->GetValue(read, QStringLiteral("LANGUAGE")), QVariant(19));
        mRegistry->DeleteValue(write, QStringLiteral("language"));
    }
    // The keys above it are there with it.
    mRegistry->SetValue(QStringLiteral("Software"), QStringLiteral("a"), 1);
    QCOMPARE(mEvents, QStringList());
}

void tst_clsRegistry::missingOnes()
{
    QVERIFY(!get("Session").isValid());
    set("Session", 1);
    QVERIFY(content().isEmpty());
    mRegistry->CreateKey(settingsKey);
    QVERIFY(!get("Session").isValid());
    const QString read = settingsReadKey, write = settingsKey;
    QCOMPARE(mEvents,
             (QStringList{QStringLiteral("GetValue ") + read + QStringLiteral(" Session 2"),
                          QStringLiteral("SetValue ") + write + QStringLiteral(" Session 2"),
                          QStringLiteral("GetValue ") + read + QStringLiteral(" Session 2")}));
    mEvents.clear();
    mRegistry->ysnFailSoftRead = true;
    QVERIFY(!get("Session").isValid());
    QCOMPARE(mEvents, QStringList());
    mRegistry->DeleteValue(write, QStringLiteral("Session")); // soft for reads alone
    QCOMPARE(mEvents.size(), 1);
}

void tst_clsRegistry::deletes()
{
    mRegistry->CreateKey(QStringLiteral("Software\\A\\B\\C"));
    mRegistry->CreateKey(QStringLiteral("Software\\AB"));
    mRegistry->SetValue(QStringLiteral("Software\\A\\B\\C"), QStringLiteral("v"), 1);
    mRegistry->SetValue(QStringLiteral("Software\\AB"), QStringLiteral("v"), 2);
    mRegistry->DeleteKey(QStringLiteral("software\\"), QStringLiteral("a"));
    QVERIFY(
        !mRegistry->GetValue(QStringLiteral("Software\\A\\B\\C"), QStringLiteral("v")).isValid());
    QCOMPARE(mRegistry->GetValue(QStringLiteral("Software\\AB"), QStringLiteral("v")), QVariant(2));
    mEvents.clear();
    mRegistry->DeleteKey(QStringLiteral("Software"), QStringLiteral("A"));
    mRegistry->DeleteValue(QStringLiteral("Software\\AB"), QStringLiteral("w"));
    QCOMPARE(mEvents, (QStringList{QStringLiteral("DeleteKey Software\\A  2"),
                                   QStringLiteral("DeleteValue Software\\AB w 2")}));
}

void tst_clsRegistry::mainKeysAreApart()
{
    mRegistry->CreateKey(settingsKey);
    set("Session", 3);
    mRegistry->MainKey = int(0x80000001);
    QVERIFY(!get("Session").isValid());
    mRegistry->CreateKey(settingsKey);
    set("Session", 4);
    mRegistry->MainKey = clsRegistry::HKEY_LOCAL_MACHINE;
    QCOMPARE(get("Session"), QVariant(3));
}

// Bytes, and what a person may have typed into the file, read as empty and stay when others change.
void tst_clsRegistry::otherContentOfTheFile()
{
    writeFile(mDesktop->settings,
              R"({"80000002\\SOFTWARE\\Orvanta Software\\SongCase\\": {
                    "Blob": {"type": "binary", "value": "AAEC"},
                    "Odd": 5, "Number": {"type": "number", "value": 12},
                    "Text": {"type": "text", "value": "x"}}})");
    QCOMPARE(get("Number"), QVariant(12));
    QCOMPARE(get("Text"), QVariant(QStringLiteral("x")));
    QVERIFY(!get("Odd").isValid());
    QVERIFY(!get("Blob").isValid());
    QCOMPARE(mEvents, QStringList());
    set("Text", QStringLiteral("y"));
    QVERIFY(content().contains("AAEC"));
    QCOMPARE(get("Number"), QVariant(12));
}

void tst_clsRegistry::damagedFileIsSetAside_data()
{
    QTest::addColumn<QByteArray>("bytes");
    QTest::newRow("empty") << QByteArray();
    QTest::newRow("cut off") << QByteArray(R"({"80000002\\software": {"a": {"type": )");
    QTest::newRow("not ours") << QByteArray("\x7F"
                                            "ELF\0\1",
                                            6);
    QTest::newRow("a list") << QByteArray("[1,2]");
}

void tst_clsRegistry::damagedFileIsSetAside()
{
    QFETCH(QByteArray, bytes);
    for (int i = 0; i < 2; ++i) { // a second one in the same second
        writeFile(mDesktop->settings, bytes);
        QVERIFY(!get("Session").isValid());
        mRegistry->CreateKey(settingsKey);
        set("Session", 1);
        QCOMPARE(get("Session"), QVariant(1));
    }
    const auto aside = QDir(folder()).entryInfoList({QStringLiteral("*.damaged-*")}, QDir::Files);
    QCOMPARE(aside.size(), 2);
    for (const QFileInfo &info : aside) {
        QFile file(info.filePath());
        QVERIFY(file.open(QIODevice::ReadOnly));
        QCOMPARE(file.readAll(), bytes);
    }
}

void tst_clsRegistry::unreadableFileIsNotReplaced()
{
    mRegistry->CreateKey(settingsKey);
    set("Session", 5);
    QFile(mDesktop->settings).setPermissions({});
    const auto open = QFile::Permissions(0x7777);
    QFile(folder()).setPermissions(open);
    QFile(QFileInfo(folder()).absolutePath()).setPermissions(open);
    {
        const OrdinaryUser user;
        QVERIFY(!get("Session").isValid());
        mRegistry->CreateKey(settingsKey);
        set("Session", 1);
        QCOMPARE(mEvents.size(), 3);
    }
    QFile(mDesktop->settings).setPermissions(QFile::ReadOwner | QFile::WriteOwner);
    QCOMPARE(get("Session"), QVariant(5));
}

void tst_clsRegistry::readOnlyFolder()
{
    mRegistry->CreateKey(settingsKey);
    set("Session", 5);
    QFile(mDesktop->settings).setPermissions(QFile::Permissions(0x4444));
    QFile(folder()).setPermissions(QFile::Permissions(0x5555));
    QFile(QFileInfo(folder()).absolutePath()).setPermissions(QFile::Permissions(0x5555));
    {
        const OrdinaryUser user;
        QCOMPARE(get("Session"), QVariant(5));
        set("Session", 6);
        QCOMPARE(mEvents.size(), 1);
        QVERIFY(mEvents[0].startsWith(QStringLiteral("SetValue")));
        QCOMPARE(get("Session"), QVariant(5));
    }
    QFile(QFileInfo(folder()).absolutePath()).setPermissions(QFile::Permissions(0x7700));
    QFile(folder()).setPermissions(QFile::Permissions(0x7700));
}

void tst_clsRegistry::belongsToItsUser()
{
    mRegistry->CreateKey(settingsKey);
    set("ProxyPassword", QStringLiteral("secret"));
    const auto others = QFile::ReadGroup | QFile::WriteGroup | QFile::ReadOther | QFile::WriteOther;
    QVERIFY(!(QFile::permissions(mDesktop->settings) & others));
    QCOMPARE(QDir(folder()).entryList(QDir::Files), QStringList{QStringLiteral("settings.json")});
}

// Two programs at once: every write of both must be there afterwards.
void tst_clsRegistry::twoWriters()
{
    mRegistry->CreateKey(settingsKey);
    constexpr int each = 25;
    const auto write = [&](const QString &who) {
        for (int i = 0; i < each; ++i)
            clsRegistry().SetValue(settingsKey, who + QString::number(i), i);
    };
    const pid_t child = fork();
    QVERIFY(child >= 0);
    if (child == 0) {
        write(QStringLiteral("child"));
        _exit(0);
    }
    write(QStringLiteral("parent"));
    int status = -1;
    QCOMPARE(waitpid(child, &status, 0), child);
    for (const auto &who : {QStringLiteral("child"), QStringLiteral("parent")}) {
        for (int i = 0; i < each; ++i)
            QCOMPARE(mRegistry->GetValue(settingsKey, who + QString::number(i)), QVariant(i));
    }
}

QTEST_GUILESS_MAIN(tst_clsRegistry)
#include "tst_clsRegistry.moc"
