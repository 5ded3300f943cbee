// Label: unit
#include "discs/cddbanswer.h"
#include "platform/error/error.h"
#include "support/datarows.h"

/// The answers of CDDB servers around the records.
class tst_CddbAnswer : public QObject
{
    Q_OBJECT

private slots:
    void parts_data()
    {
        const DataRows<QByteArray, QByteArray> row("bytes", "said");
        row("one line", "202 No match.\r\n", "202 whole No match. |");
        row("no line end", "202", "202 whole  |");
        row("lines", "210 ok\r\na\r\nb\r\n.\r\nc\r\n", "210 whole ok |a\nb\n");
        row("LF alone", "210 ok\na\n.\n", "210 whole ok |a\n");
        row("points sent twice", "210 ok\n..\n...a\n.b\n.\n", "210 whole ok |.\n..a\n.b\n");
        row("cut", "210 ok\r\na\r\nb", "210 cut ok |a\nb\n");
        row("cut at once", "210 ok", "210 cut ok |");
        row("last line without end", "210 ok\na\n.", "210 whole ok |a\n");
        row("control signs",
            "500 a\x01"
            "b\tc\n",
            "500 whole ab c |");
        row("byte order mark",
            "\xEF\xBB\xBF"
            "200 x\n",
            "200 whole x |");
    }
    void parts()
    {
        QFETCH(QByteArray, bytes);
        const CddbAnswer answer = readCddbAnswer(bytes);
        const QByteArray said = QByteArray::number(answer.code) +
                                (answer.isWhole ? " whole " : " cut ") + answer.text.toUtf8() +
                                " |" + answer.body;
        QTEST(said, "said");
    }

    void refusesWhatIsNone_data()
    {
        const DataRows<QByteArray> row("bytes");
        row("empty", "");
        row("HTML", "<html>200 OK</html>");
        row("two digits", "20 x\n");
        row("four digits", "2000 x\n");
        row("digits of another script", "٢٠٠ x\n");
        row("first line empty", "\n200 x\n");
    }
    void refusesWhatIsNone()
    {
        QFETCH(QByteArray, bytes);
        QVERIFY_THROWS_EXCEPTION(Error, readCddbAnswer(bytes));
    }

    void kindsOfNo_data()
    {
        const DataRows<QByteArray, QByteArray> row("line", "kind");
        row("200 fine", "");
        row("401 No such CD entry", "");
        row("402 Server error", "trouble");
        row("403 Database entry is corrupt", "");
        row("403 Unknown application", "refusal");
        row("409 No handshake", "refusal");
        row("433 Too many users", "trouble");
        row("500 Unknown developer email", "refusal");
        row("530 Timeout", "trouble");
    }
    void kindsOfNo()
    {
        QFETCH(QByteArray, line);
        const CddbAnswer answer = readCddbAnswer(line);
        const QByteArray kind =
            QByteArray(answer.isRefusal() ? "refusal" : "") + (answer.isTrouble() ? "trouble" : "");
        QTEST(kind, "kind");
    }

    void candidates_data()
    {
        const DataRows<QByteArray, QString> row("bytes", "found");
        row("none", "202 No match\n", "");
        row("one", "200 rock 7d0b170A A / B / C\n", "rock 7d0b170A A|B / C 10");
        row("no artist", "200 rock 7d0b170a B\n", "rock 7d0b170a B|B 10");
        row("several, in order", "211 x\nmisc 00000002 B / b\nblues 00000001 A / a (Disc 2)\n.\n",
            "misc 00000002 B|b 2; blues 00000001 A|a 1");
        row("code page", "210 x\nrock 00000001 \xC4 / \xE4\n.\n", "rock 00000001 Ä|ä 1");
        row("lines that are none",
            "210 x\n\nrock\nrock 1 A / B\nr/../k 00000001 A / B\n"
            "rock 0000000g A / B\nrock 00000001 \nrock  00000001 A / B\n.\n",
            "");
    }
    void candidates()
    {
        QFETCH(QByteArray, bytes);
        QStringList found;
        for (const DiscRecord &disc : cddbCandidates(readCddbAnswer(bytes))) {
            QVERIFY(!disc.isWhole());
            found << QStringList{disc.keyA, disc.keyB, disc.artist.name + u'|' + disc.title,
                                 QString::number(disc.trackCount)}
                         .join(u' ');
        }
        QTEST(found.join(u"; "_s), "found");
    }

    void answersToOtherQuestionsAreNone()
    {
        QVERIFY_THROWS_EXCEPTION(Error, cddbCandidates(readCddbAnswer("201 level now 6\n")));
    }

    void aRecordThatRefuses()
    {
        DiscRecord disc;
        disc.tracks.resize(2);
        QVERIFY(!isRefusal(disc));
        disc.tracks[1].title = u"This is a Not Compatible app"_s;
        QVERIFY(isRefusal(disc));
    }
};

QTEST_APPLESS_MAIN(tst_CddbAnswer)
#include "tst_CddbAnswer.moc"
