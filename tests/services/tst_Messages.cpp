// Label: unit
#include "services/globals.h"
#include "services/messages.h"
#include "services/messagetable.h"
#include "support/datarows.h"

#include <QCryptographicHash>
#include <QSet>

/// The texts of the program: the fixed table as a whole, and the look-up.
class tst_Messages : public QObject
{
    Q_OBJECT

private slots:
    void cleanup() { gLanguage = languageEnglish; }

    // The fixed texts must not change, not by a blank. Their line breaks are CR alone.
    void table()
    {
        using namespace messagetable;
        QCOMPARE(fixedTextCount, std::size_t(314));
        QSet<QByteArray> keys;
        QCryptographicHash hash(QCryptographicHash::Sha1);
        const auto look = [&](const Message &m) {
            QVERIFY2(!keys.contains(m.key), m.key);
            keys.insert(m.key);
            for (const char *text : {m.english, m.dutch}) {
                QVERIFY2(text && *text && !strchr(text, '\n'), m.key);
                QVERIFY2(QUtf8StringView(text).isValidUtf8(), m.key);
            }
        };
        for (std::size_t i = 0; i < fixedTextCount; ++i) {
            const Message &m = fixedTexts[i];
            look(m);
            for (const char *part : {m.key, m.english, m.dutch})
                hash.addData(QByteArrayView(part, qsizetype(strlen(part)) + 1));
        }
        QCOMPARE(hash.result().toHex(), QByteArray("ba546efbaa3ce87d8eba6765013a5846349896e7"));
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
