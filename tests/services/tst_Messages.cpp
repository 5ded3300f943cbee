// Label: unit
#include "services/globals.h"
#include "services/messages.h"
#include "services/messagetable.h"
#include "support/datarows.h"

#include <QSet>

/// The texts of the program: each of the table, and the look-up.
class tst_Messages : public QObject
{
    Q_OBJECT

private slots:
    void cleanup() { gLanguage = languageEnglish; }

    // The line breaks are CR alone.
    void table()
    {
        using namespace messagetable;
        QSet<QByteArray> keys;
        const auto look = [&](const Message &m) {
            QVERIFY2(!keys.contains(m.key), m.key);
            keys.insert(m.key);
            for (const char *text : {m.english, m.dutch}) {
                QVERIFY2(text && *text && !strchr(text, '\n'), m.key);
                QVERIFY2(QUtf8StringView(text).isValidUtf8(), m.key);
            }
        };
        for (std::size_t i = 0; i < fixedTextCount; ++i)
            look(fixedTexts[i]);
        for (std::size_t i = 0; i < furtherTextCount; ++i) {
            look(furtherTexts[i]);
            QVERIFY2(furtherTexts[i].key[0] == 'x', furtherTexts[i].key);
        }
    }

    void lookUp()
    {
        QCOMPARE(GetMessage("Track") + GetMessage("xReadOnly"),
                 u"TrackThe catalogue or its folder is read-only."_s);
        QCOMPARE(GetMessage("track"), u"Unknown"_s); // case counts
        gLanguage = languageDutch;
        QCOMPARE(GetMessage("Track") + GetMessage("xReadOnly"),
                 u"TracknrDe database of de map ervan is alleen-lezen."_s);
        QCOMPARE(GetMessage("MsgInvalidDiscValues"), u"Onbekend"_s); // asked for, and not there
        gLanguage = 2;
        QCOMPARE(GetMessage("Track"), QString());
    }
};

QTEST_APPLESS_MAIN(tst_Messages)
#include "tst_Messages.moc"
