// Label: unit
#include "platform/files/filelock.h"
#include "services/clsRegistry.h"
#include "support/datarows.h"
#include "support/ordinaryuser.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QDir>
#include <QFile>
#include <QFileInfo>
#include <sys/wait.h>

/// The store of settings on a real file, and what it tells of failures.
class tst_clsRegistry : public QObject
{
    Q_OBJECT

private:
    std::unique_ptr<ScriptedDesktop> mDesktop;
    std::unique_ptr<clsRegistry> mRegistry;
    QStringList mEvents; // of mRegistry: action, key, value, number

    QString folder() const { return QFileInfo(mDesktop->settings).absolutePath(); }
    QByteArray content() const { return readFile(mDesktop->settings); }

    void set(const char *name, const QVariant &value)
    {
        mRegistry->SetValue(settingsKey, QLatin1String(name), value);
    }
    QVariant get(const char *name)
    {
        return mRegistry->GetValue(settingsReadKey, QLatin1String(name));
    }

private slots:
    void init()
    {
        mDesktop = std::make_unique<ScriptedDesktop>();
        mRegistry = std::make_unique<clsRegistry>();
        mEvents.clear();
        connect(
            mRegistry.get(), &clsRegistry::regFout, this,
            [this](const Error &error, const QString &source, const QString &action,
                   const QString &key, const QString &name) {
                QCOMPARE(source, u"clsRegistry"_s);
                QCOMPARE(error.Source, source);
                const auto code = unsigned(error.Number) - 0x80040000u;
                mEvents.append(QStringList{action, key, name, QString::number(code)}.join(u' '));
            });
        connect(mRegistry.get(), &clsRegistry::vbFout, this, [] { QFAIL("vbFout"); });
        QDir().mkpath(folder());
    }

    void keepsTexts_data()
    {
        const DataRows<QVariant> row("value");
        row("text", u"C:\\Muziek\\\u00e9\U0001F3B5"_s);
        row("empty text", u""_s);
        row("digits stay a text", u"0080"_s);
        row("number", 19);
        row("smallest", std::numeric_limits<int>::min());
    }

    void keepsTexts()
    {
        QFETCH(QVariant, value);
        mRegistry->CreateKey(settingsKey);
        set("Value", 7);
        set("Value", value);
        set("Value", 1.5); // neither text nor number: nothing
        set("Value", QVariant());
        QCOMPARE(clsRegistry().GetValue(settingsReadKey, u"VALUE"_s), value);
        QCOMPARE(get("Value").typeId(), value.typeId());
        QCOMPARE(mEvents, QStringList());
    }

    void spellingsOfTheKey()
    {
        mRegistry->CreateKey(u"Software\\Orvanta Software\\SongCase"_s);
        const QStringList spellings =
            texts("Software\\Orvanta Software\\SongCase\\", "SOFTWARE\\orvanta software\\songcase");
        for (const QString &write : spellings) {
            mRegistry->SetValue(write, u"Language"_s, 19);
            for (const QString &read : spellings)
                QCOMPARE(mRegistry->GetValue(read, u"LANGUAGE"_s), QVariant(19));
            mRegistry->DeleteValue(write, u"language"_s);
        }
        mRegistry->SetValue(u"Software"_s, u"a"_s, 1); // the keys above it are there with it
        QCOMPARE(mEvents, QStringList());
    }

    void missingOnes()
    {
        get("Session");
        set("Session", 1);
        QCOMPARE(content(), QByteArray("none"));
        mRegistry->CreateKey(settingsKey);
        QVERIFY(!get("Session").isValid());
        const QString read = u"GetValue "_s + settingsReadKey + u" Session 2"_s;
        QCOMPARE(mEvents,
                 QStringList({read, u"SetValue "_s + settingsKey + u" Session 2"_s, read}));
        mRegistry->ysnFailSoftRead = true;
        get("Session");
        QCOMPARE(mEvents.size(), 3);
        mRegistry->DeleteValue(settingsKey, u"Session"_s); // soft for reads alone
        QCOMPARE(mEvents.size(), 4);
    }

    // Bytes, and what a person may have typed into the file, read as empty and stay when others
    // change.
    void otherContentOfTheFile()
    {
        writeFile(mDesktop->settings,
                  R"({"80000002\\SOFTWARE\\Orvanta Software\\SongCase\\": {
                        "Blob": {"type": "binary", "value": "AAEC"},
                        "Odd": 5, "Far": {"type": "number", "value": 1e30}, "Number": {"type": "number", "value": 12},
                        "Text": {"type": "text", "value": "x"}}})");
        QCOMPARE(get("Number"), QVariant(12));
        QCOMPARE(get("Text"), QVariant(u"x"_s));
        QVERIFY(!get("Odd").isValid());
        QVERIFY(!get("Far").isValid());
        QVERIFY(!get("Blob").isValid());
        QCOMPARE(mEvents, QStringList());
        set("Text", u"y"_s);
        for (const char *kept : {"AAEC", "5", "1e+30"})
            QVERIFY2(content().contains(kept), kept);
        QCOMPARE(get("Number"), QVariant(12));
    }

    void damagedFileIsSetAside_data()
    {
        const DataRows<QByteArray> row("bytes");
        row("empty", "");
        row("cut off", R"({"80000002\\software": {"a": {"type": )");
        row("a list", "[1,2]");
        row("no keys", R"({"language": 19})");
        row("values without a type", R"({"window": {"width": 800, "open": true}})");
        row("types without a value", R"({"80000002\\software": {"a": {"type": "number"}}})");
    }

    void damagedFileIsSetAside()
    {
        QFETCH(QByteArray, bytes);
        for (int i = 0; i < 2; ++i) { // a second one in the same second
            writeFile(mDesktop->settings, bytes);
            QVERIFY(!get("Session").isValid());
            mRegistry->CreateKey(settingsKey);
            set("Session", 1);
            QCOMPARE(get("Session"), QVariant(1));
        }
        const auto aside = QDir(folder()).entryInfoList({u"*.damaged-*"_s}, QDir::Files);
        QCOMPARE(aside.size(), 2);
        for (const QFileInfo &info : aside)
            QCOMPARE(readFile(info.filePath()), bytes);
    }

    void unreadableFileIsNotReplaced()
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

    void belongsToItsUser()
    {
        mRegistry->CreateKey(settingsKey);
        set("ProxyPassword", u"secret"_s);
        const auto others =
            QFile::ReadGroup | QFile::WriteGroup | QFile::ReadOther | QFile::WriteOther;
        QVERIFY(!(QFile::permissions(mDesktop->settings) & others));
    }

    // A lock of another machine, or cut off while it was made, means nothing: who holds it counts.
    void nobodyIsLockedOut()
    {
        for (const QByteArray &content :
             {QByteArray(), QByteArray(64, 0), QByteArray("1\nsongcase\nrenamed-machine\n")}) {
            writeFile(mDesktop->settings + u".lock"_s, content);
            mRegistry->CreateKey(settingsKey);
            QCOMPARE(mEvents, QStringList());
        }
        FileLock other;
        QCOMPARE(other.take(mDesktop->settings + u".lock"_s), FileLock::Outcome::Taken);
        mRegistry->CreateKey(settingsKey);
        QCOMPARE(mEvents.size(), 1);
    }

    // Two programs at once: every write of both must be there afterwards.
    void twoWriters()
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
            write(u"child"_s);
            _exit(0);
        }
        write(u"parent"_s);
        int status = -1;
        QCOMPARE(waitpid(child, &status, 0), child);
        for (const auto &who : {u"child"_s, u"parent"_s}) {
            for (int i = 0; i < each; ++i)
                QCOMPARE(mRegistry->GetValue(settingsKey, who + QString::number(i)), QVariant(i));
        }
    }
};

QTEST_GUILESS_MAIN(tst_clsRegistry)
#include "tst_clsRegistry.moc"
