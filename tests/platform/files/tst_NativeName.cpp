// Label: unit
#include "platform/files/nativename.h"
#include "support/datarows.h"

class tst_NativeName : public QObject
{
    Q_OBJECT

private slots:
    void everyNameLeadsBackToItsFile_data()
    {
        const DataRows<QByteArray, QString> row("bytes", "name");
        row("plain", "a.mp3", u"a.mp3"_s);
        row("UTF-8", "\xc3\xa9\xe2\x82\xac\xf0\x9f\x8e\xb5", u"é€🎵"_s);
        row("Latin-1", "Caf\xe9.mp3", u"Caf\uefe9.mp3"_s);
        row("cut off", "\xe2\x82", u"\uefe2\uef82"_s);
        row("cut off before a letter", "\xc3x", u"\uefc3x"_s);
        row("a character that stands for a byte", "\xee\xbe\x80", u"\uefee\uefbe\uef80"_s);
        row("too long a form", "\xc0\xaf", u"\uefc0\uefaf"_s);
        row("half a pair", "\xed\xa0\x80", u"\uefed\uefa0\uef80"_s);
    }

    void everyNameLeadsBackToItsFile()
    {
        QFETCH(QByteArray, bytes);
        QTEST(nameOfNative(bytes), "name");
        QCOMPARE(nativeName(nameOfNative(bytes)), bytes);
    }
};

QTEST_APPLESS_MAIN(tst_NativeName)
#include "tst_NativeName.moc"
