// Label: unit
#include "support/damage.h"
#include "support/datarows.h"

/// Whatever a disk has done to a catalogue, a start and an end with it take no good row.
class tst_Damage : public QObject
{
    Q_OBJECT

private slots:
    void wholeOne()
    {
        for (const auto size : {damage::Size::Small, damage::Size::Large}) {
            const auto outcome = damage::startAndEnd(damage::wholeCatalogue(), size);
            QVERIFY(outcome.opened && !outcome.toldWhileCleaning);
            QCOMPARE(outcome.lost, QSet<QString>());
        }
    }

    void takesNoGoodRow_data()
    {
        const DataRows<bool> row("large");
        row("compared through at the start", false);
        row("too large for that", true);
    }

    void takesNoGoodRow()
    {
        QFETCH(bool, large);
        const auto size = large ? damage::Size::Large : damage::Size::Small;
        constexpr int many = 60;
        int opened = 0, told = 0;
        for (int number = 0; number < many; ++number) {
            const auto outcome = damage::startAndEnd(damage::damagedCatalogue(number), size);
            QVERIFY2(outcome.lost.isEmpty(), QByteArray::number(number).constData());
            opened += outcome.opened;
            told += outcome.toldWhileCleaning;
        }
        QVERIFY(opened < many);    // they do harm
        QCOMPARE(told > 0, large); // found at the start where that is looked for
    }
};

QTEST_GUILESS_MAIN(tst_Damage)
#include "tst_Damage.moc"
