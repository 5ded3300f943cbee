// Label: unit
#include "shell/services/globals.h"
#include "shell/services/messages.h"
#include "shell/services/messagetable.h"

#include <QCryptographicHash>
#include <QSet>
#include <QTest>

/// The texts of the program: the fixed table as a whole, and the look-up.
class tst_Messages : public QObject
{
    Q_OBJECT

private slots:
    void cleanup() { gLanguage = languageEnglish; }
    void table();
    void lookUp_data();
    void lookUp();
};

// The fixed texts must not change, not by a blank. Their line breaks are CR alone.
void tst_Messages::table()
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

void tst_Messages::lookUp_data()
{
    QTest::addColumn<QByteArray>("key");
    QTest::addColumn<QString>("english");
    QTest::addColumn<QString>("dutch");
    const auto row = [](const char *key, const char *english, const char *dutch) {
        QTest::newRow(key) << QByteArray(key) << QString::fromUtf8(english)
                           << QString::fromUtf8(dutch);
    };
    row("MainScreen.Caption", "Dr. Orvanta's Songcase", "Dr. Orvanta's Liedkist");
    row("MsgSysErr", "System error", "Systeemfout");
    row("mnuCDDB", "Gracenote C&DDB®", "Gracenote C&DDB®");
    row("Track", "Track", "Tracknr");
    row("FNFpart2", " not found!\rProgram cannot start without it!",
        " is niet aangetroffen!\r Het programma kan derhalve niet starten!");
    row("UnableToRenameForbiddenSymbols",
        "Unable to rename file because \\/:*?<>| are forbidden symbols.",
        "Kan bestand niet hernoemen omdat \\/:*?<>| niet mogen worden gebruikt in een "
        "bestandsnaam.");
    row("QuestSaveChanges", "Do yo want to save changes?", "Wilt U de wijzigingen opslaan?");
    row("InvalidDiscValues",
        "Invalid value(s) of total number of discs and/or disc number!\rClick 'Edit CDDB data' and "
        "fill in the right number(s).",
        "Het totaal aantal discs en/of het discnummer bevat(ten) een ongeldige waarde! \rKlik op "
        "'Bewerk CDDB-gegevens' en vul het juiste aantal in.");
    row("MsgInvalidDiscValues", "Unknown", "Onbekend"); // asked for, and not there
    row("file", "Unknown", "Onbekend");                 // case counts
    row("", "Unknown", "Onbekend");
    row("xReadOnly", "The catalogue or its folder is read-only.",
        "De database of de map ervan is alleen-lezen.");
}

void tst_Messages::lookUp()
{
    QFETCH(QByteArray, key);
    QTEST(GetMessage(key.constData()), "english");
    gLanguage = languageDutch;
    QTEST(GetMessage(key.constData()), "dutch");
    for (const int other : {0, 2, 18, -1}) {
        gLanguage = other;
        QCOMPARE(GetMessage(key.constData()), QString());
    }
}

QTEST_APPLESS_MAIN(tst_Messages)
#include "tst_Messages.moc"
