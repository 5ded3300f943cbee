// Label: unit
#include "discs/opaquetoc.h"
#include "support/datarows.h"

namespace
{

OpaqueToc sample()
{
    OpaqueToc disc;
    disc.toc.tracks = {{150, true}, {450, false}};
    disc.toc.first = 3;
    disc.toc.leadOut = 900;
    return disc;
}

} // namespace

/// The text that goes from the drive to the look-up.
class tst_OpaqueToc : public QObject
{
    Q_OBJECT

private slots:
    void isTheSameWhenReadAgain()
    {
        OpaqueToc disc = sample();
        disc.known.title = u"Café \"12\""_s;
        disc.known.tracks.resize(2);
        disc.known.tracks[0].title = u"One"_s;
        disc.known.tracks[0].length = 4000;
        disc.words.barcode = u"0724384260958"_s;
        const QString text = disc.toText();
        QVERIFY(!text.contains(u'\n'));
        const OpaqueToc again = OpaqueToc::fromText(text).value();
        QCOMPARE(again.toc, disc.toc);
        QCOMPARE(again.known, disc.known);
        QCOMPARE(again.words, disc.words);
    }

    void wordsAloneWillDo()
    {
        OpaqueToc disc;
        disc.words.title = u"Arrival"_s;
        QCOMPARE(OpaqueToc::fromText(disc.toText()).value().words, disc.words);
    }

    void refusesWhatIsNone_data()
    {
        OpaqueToc impossible = sample();
        impossible.toc.leadOut = 450;
        OpaqueToc damaged = sample();
        damaged.known.title = u"Title"_s;
        const DataRows<QString> row("text");
        row("empty", "");
        row("nothing found", OpaqueToc().toText());
        row("no disc has it", impossible.toText());
        row("cut", sample().toText().chopped(3));
        row("record damaged", damaged.toText().replace(u"Title"_s, u"\\"_s));
        row("other things", "{\"toc\":7,\"words\":[\"a\"]}");
    }
    void refusesWhatIsNone()
    {
        QFETCH(QString, text);
        QVERIFY(!OpaqueToc::fromText(text));
    }
};

QTEST_APPLESS_MAIN(tst_OpaqueToc)
#include "tst_OpaqueToc.moc"
