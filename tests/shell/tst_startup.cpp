// Label: unit
#include "platform/ado/connection.h"
#include "shell/services/clsRegistry.h"
#include "shell/services/globals.h"
#include "shell/startup.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

#include <QTest>

/// The settings side of a start, and the opening of the catalogue.
class tst_startup : public QObject
{
    Q_OBJECT

private slots:
    void settingsAreReadAndMended_data();
    void settingsAreReadAndMended();
    void anOlderCatalogueOnAFirstStart();
    void proxySettingsCountOnlyWhenOneIsUsed();
    void aFailedOpeningLeavesNoConnection();

private:
    static QVariant stored(const char *name)
    {
        return clsRegistry().GetValue(settingsReadKey, QLatin1String(name));
    }
    static void store(const char *name, const QVariant &value)
    {
        clsRegistry settings;
        settings.CreateKey(settingsKey);
        settings.SetValue(settingsKey, QLatin1String(name), value);
    }
};

void tst_startup::settingsAreReadAndMended_data()
{
    QTest::addColumn<QString>("name");
    QTest::addColumn<QVariant>("before");
    QTest::addColumn<int>("after");
    QTest::addColumn<int>("session");
    QTest::addColumn<int>("language");
    QTest::addColumn<bool>("conversion");
    const QVariant none;
    QTest::newRow("first session") << "Session" << none << 1 << 1 << 1 << false;
    QTest::newRow("next session") << "Session" << QVariant(41) << 42 << 42 << 1 << false;
    QTest::newRow("session as text")
        << "Session" << QVariant(QStringLiteral("6")) << 7 << 7 << 1 << false;
    QTest::newRow("session is words")
        << "Session" << QVariant(QStringLiteral("x")) << 1 << 1 << 1 << false;
    QTest::newRow("Dutch") << "Language" << QVariant(19) << 19 << 1 << 19 << false;
    QTest::newRow("no such language") << "Language" << QVariant(5) << 1 << 1 << 1 << false;
    QTest::newRow("language is words")
        << "Language" << QVariant(QStringLiteral("abc")) << 1 << 1 << 1 << false;
    QTest::newRow("generation 3") << "DBVersion" << QVariant(3) << 4 << 1 << 1 << true;
    QTest::newRow("generation 4") << "DBVersion" << QVariant(4) << 4 << 1 << 1 << false;
    QTest::newRow("generation 5") << "DBVersion" << QVariant(5) << 5 << 1 << 1 << false;
    QTest::newRow("no generation") << "DBVersion" << none << 4 << 1 << 1 << false;
}

void tst_startup::settingsAreReadAndMended()
{
    QFETCH(QString, name);
    QFETCH(QVariant, before);
    ScriptedDesktop desktop;
    if (before.isValid())
        store(name.toLatin1().constData(), before);
    const auto found = startup::readSettings(desktop.folder);
    QTEST(stored(name.toLatin1().constData()).toInt(), "after");
    QTEST(found.session, "session");
    QTEST(gLanguage, "language");
    QTEST(found.conversionPending, "conversion");
    if (name == QLatin1String("DBVersion"))
        QVERIFY2(!startup::readSettings(desktop.folder).conversionPending, "offered once only");
}

void tst_startup::anOlderCatalogueOnAFirstStart()
{
    for (const char *name : {"Compact.orv", "Compact3.orv", "compact4.orv"}) {
        ScriptedDesktop desktop;
        writeFile(desktop.folder + QLatin1Char('/') + QLatin1String(name), "old");
        QCOMPARE(startup::readSettings(desktop.folder).conversionPending,
                 qstrcmp(name, "compact4.orv") != 0);
    }
}

void tst_startup::proxySettingsCountOnlyWhenOneIsUsed()
{
    ScriptedDesktop desktop;
    store("ProxyServer", QStringLiteral("proxy"));
    store("ProxyServerPort", QStringLiteral("8080"));
    QCOMPARE(startup::ReadProxySettings(), QString());
    QVERIFY(!gUseProxy);
    QCOMPARE(gProxyServer, QString());
    QCOMPARE(gProxyServerPort, QStringLiteral("0"));
    store("UseProxy", 1);
    QCOMPARE(startup::ReadProxySettings(), QStringLiteral("1"));
    QVERIFY(gUseProxy);
    QCOMPARE(gProxyServer + gProxyServerPort, QStringLiteral("proxy8080"));
}

void tst_startup::aFailedOpeningLeavesNoConnection()
{
    QTemporaryDir folder;
    const QString file = writeFile(folder.filePath(QStringLiteral("Compact4.orv")), "no catalogue");
    QVERIFY_EXCEPTION_THROWN(startup::openCatalogue(file, false), ADODB::Error);
    QCOMPARE(gConnection->State(), ADODB::adStateClosed);
    QCOMPARE(gConnection->Errors.size(), std::size_t(1));
    gConnection.reset();
}

QTEST_MAIN(tst_startup)
#include "tst_startup.moc"
