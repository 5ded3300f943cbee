// Label: unit
#include "controls/tracks/trackmodel.h"
#include "support/datarows.h"

#include <QRandomGenerator>

namespace
{

StoredTrack stored(qint64 link, const char *artist, const char *title, const char *genre = "",
                   const char *year = "")
{
    return {link,
            {QString::fromUtf8(artist), QString::fromUtf8(title), QString::fromUtf8(genre),
             QString::fromUtf8(year)}};
}

/// All cells: "," between cells and "/" behind rows, without the number and the waiting row.
QString textOf(const TrackModel &model)
{
    QString all;
    for (int row = 0; row < model.waitingRow(); ++row) {
        QStringList cells;
        for (int column = 1; column < model.columnCount(); ++column)
            cells.append(model.text(row, model.fieldOf(column)));
        all += cells.join(u',') + u'/';
    }
    return all;
}

QString numbersOf(const TrackModel &model)
{
    QStringList numbers;
    for (int row = 0; row < model.rowCount(); ++row)
        numbers.append(model.index(row, 0).data().toString());
    return numbers.join(u',');
}

} // namespace

/// The rows of a track grid without a screen.
class tst_TrackModel : public QObject
{
    Q_OBJECT

private slots:
    void parts_data()
    {
        // cells: "|" between cells, "/" between lines
        const DataRows<QString, QString> row("clipboard", "cells");
        row("a\tb\nc\td\n", "a|b/c|d");
        row("a\r\nb\r\rc", "a/b//c");
        row("\"Heroes\"\tx", "\"Heroes\"|x");
        row("\"two\nlines\"\tx", "two\nlines|x");
        row("\"tab\tin\"\n\"a \"\"b\"\"\"", "tab\tin/a \"b\"");
        row("\"open\tx", "\"open|x");
    }

    void parts()
    {
        QFETCH(QString, clipboard);
        QStringList lines;
        for (const QStringList &line : TrackModel::parted(clipboard))
            lines.append(line.join(u'|'));
        QTEST(lines.join(u'/'), "cells");
    }

    // What is copied is what is pasted, whatever signs it holds.
    void copiesComeBack_data()
    {
        const DataRows<QString> row("cell");
        for (const char *cell : {"", "\"", "\"\"", "x\"\"y", "\"x\"\"y\"", "\"Heroes\"", "\"a\tb\"",
                                 "tab\tin", "line\nin", " \"\"\"\" "})
            row(QByteArray(cell).replace('\n', "LF").replace('\t', "TAB") + '.',
                QString::fromLatin1(cell));
    }

    void copiesComeBack()
    {
        QFETCH(QString, cell);
        for (const QList<QStringList> &lines :
             {QList<QStringList>{{cell}}, {{u"a"_s, cell}, {cell, u"\"b"_s}}, {{u"a"_s}, {cell}}})
            QCOMPARE(TrackModel::parted(TrackModel::joined(lines)), lines);
    }

    void pastes_data()
    {
        // at: column, row
        const DataRows<bool, QPoint, QString, QString> row("withArtist", "at", "clipboard",
                                                           "becomes");
        row("a block", true, {2, 1}, "x\ty\nz", "A,a,,/B,x,y,1985/,z,,/");
        row("numbers in the number's column", true, {0, 0}, "1\tX\tx\n2\tY\ty",
            "X,x,,/Y,y,Pop,1985/");
        row("texts in the number's column", true, {0, 1}, "X\tx", "A,a,,/X,x,Pop,1985/");
        row("titles that are numbers", false, {0, 0}, "1999\n2000", "1999,,/2000,Pop,1985/");
        row("an empty line empties", false, {1, 0}, "\nz", ",,/z,Pop,1985/");
        row("breaks inside", false, {1, 0}, "\"a\nb\"", "a b,,/b,Pop,1985/");
    }

    void pastes()
    {
        QFETCH(bool, withArtist);
        QFETCH(QPoint, at);
        QFETCH(QString, clipboard);
        TrackModel model(withArtist);
        model.load({stored(1, "A", "a"), stored(2, "B", "b", "Pop", "1985")});
        const QString before = textOf(model);
        model.paste(at.y(), at.x(), TrackModel::parted(clipboard));
        QTEST(textOf(model), "becomes");
        model.undo();
        QCOMPARE(textOf(model), before);
        model.redo();
        QTEST(textOf(model), "becomes");
    }

    void emptyRowsAreNoTracks()
    {
        TrackModel model(true);
        model.load({stored(1, "A", "a"), stored(2, "B", "b")});
        model.insertTrack(1);
        QVERIFY(!model.isChanged());
        QCOMPARE(numbersOf(model), u"1,,2,*"_s);
        model.insertTrack(model.waitingRow());
        QCOMPARE(model.rowCount(), 4); // one is waiting there already
        model.setText(5, TitleField, u"f"_s);
        QCOMPARE(numbersOf(model), u"1,,2,,,3,*"_s);
        QCOMPARE(model.rowOfTrack(2), 5);
        model.paste(0, 1, {{QString(), QString()}});
        QCOMPARE(numbersOf(model), u",,1,,,2,*"_s);
        QCOMPARE(model.toSave().size(), 2);
        model.removeTrack(5);
        model.removeTrack(model.waitingRow());
        QCOMPARE(numbersOf(model), u",,1,,,*"_s);
    }

    // The id of a deleted link is given again, here to the row typed in its place.
    void undoBringsNoLinkBack()
    {
        TrackModel model(true);
        model.load({stored(7, "A", "a")});
        model.removeTrack(0);
        model.markSaved({});
        model.setText(0, TitleField, u"b"_s);
        model.markSaved({7});
        model.undo();
        model.undo();
        QCOMPARE(textOf(model), u"A,a,,/"_s);
        QCOMPARE(model.toSave().constFirst().linkId, 0);
        QCOMPARE(model.savedLinks(), QList<qint64>{7});
        model.redo();
        model.redo();
        QVERIFY(!model.isChanged());
    }

    void randomEditsComeBack()
    {
        QRandomGenerator random(20);
        const auto below = [&](int n) { return int(random.bounded(n)); };
        for (int round = 0; round < 200; ++round) {
            TrackModel model(round % 2);
            model.load({stored(1, "", "a"), stored(2, "", "b"), stored(3, "", "c")});
            QStringList states{textOf(model)};
            for (int step = 0; step < 12; ++step) {
                const int row = below(model.rowCount());
                const int edit = below(4);
                if (edit == 0)
                    model.insertTrack(row);
                else if (edit == 1)
                    model.removeTrack(row);
                else if (edit == 2)
                    model.paste(row, below(4), {{u"p"_s, u"q"_s}, {}});
                else
                    model.setText(row, TrackField(1 + below(3)), QString::number(below(3)));
                if (textOf(model) != states.last())
                    states.append(textOf(model));
            }
            QStringList back{textOf(model)}, again;
            while (model.undo().isValid())
                if (textOf(model) != back.last())
                    back.append(textOf(model));
            QVERIFY(!model.isChanged());
            std::reverse(back.begin(), back.end());
            QCOMPARE(back, states);
            while (model.redo().isValid()) {
            }
            QCOMPARE(textOf(model), states.last());
        }
    }
};

QTEST_GUILESS_MAIN(tst_TrackModel)
#include "tst_TrackModel.moc"
