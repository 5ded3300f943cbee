// Label: unit
#include "platform/ado/connection.h"
#include "services/clsRegistry.h"
#include "services/globals.h"
#include "shell/startup.h"
#include "support/datarows.h"
#include "support/scripteddesktop.h"
#include "support/testcatalogue.h"

/// The settings side of a start, and the opening of the catalogue.
class tst_startup : public QObject
{
    Q_OBJECT

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

private slots:
    void settingsAreReadAndMended_data()
    {
        const DataRows<QString, QVariant, int, int, int, bool> row(
            "name", "before", "after", "session", "language", "conversion");
        const QVariant none;
        row("first session", "Session", none, 1, 1, 1, false);
        row("next session", "Session", 41, 42, 42, 1, false);
        row("session as text", "Session", u"6"_s, 7, 7, 1, false);
        row("session is words", "Session", u"x"_s, 1, 1, 1, false);
        row("session beyond all numbers", "Session", u"1e30"_s, 1, 1, 1, false);
        row("session just beyond", "Session", u"2147483648"_s, 1, 1, 1, false);
        row("the last session", "Session", 2147483647, 2147483647, 2147483647, 1, false);
        row("language beyond all numbers", "Language", u"1e30"_s, 1, 1, 1, false);
        row("generation beyond all numbers", "DBVersion", u"-1e30"_s, 4, 1, 1, false);
        row("Dutch", "Language", 19, 19, 1, 19, false);
        row("no such language", "Language", 5, 1, 1, 1, false);
        row("language is words", "Language", u"abc"_s, 1, 1, 1, false);
        row("generation 3", "DBVersion", 3, 4, 1, 1, true);
        row("generation 4", "DBVersion", 4, 4, 1, 1, false);
        row("no generation", "DBVersion", none, 4, 1, 1, false);
    }

    void settingsAreReadAndMended()
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
        if (name == "DBVersion"_L1)
            QVERIFY2(!startup::readSettings(desktop.folder).conversionPending, "offered once only");
    }

    void proxySettingsCountOnlyWhenOneIsUsed()
    {
        ScriptedDesktop desktop;
        const auto names =
            texts("ProxyServer", "ProxyServerPort", "ProxyUserName", "ProxyPassword");
        for (const QString &name : names)
            store(name.toLatin1().constData(), name);
        for (const char *use : {"", "1", "0", "1", "yes"}) { // what was read before goes
            if (*use)
                store("UseProxy", QString::fromLatin1(use));
            QCOMPARE(startup::ReadProxySettings(), QLatin1String(use));
            QCOMPARE(gUseProxy, *use == '1');
            const QStringList read{gProxyServer, gProxyServerPort, gProxyUserName, gProxyPassword};
            QCOMPARE(read, gUseProxy ? names : texts("", "0", "", ""));
        }
    }
};

QTEST_MAIN(tst_startup)
#include "tst_startup.moc"
