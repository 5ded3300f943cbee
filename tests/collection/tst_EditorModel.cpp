// Label: screen
#include "catalogue/cleanorphans.h"
#include "catalogue/quoting.h"
#include "collection/editors.h"
#include "collection/frmCDRoot.h"
#include "collection/frmCDRootE.h"
#include "platform/ado/connection.h"
#include "support/editing.h"

#include <QRandomGenerator>
#include <map>
#include <set>

namespace
{

struct Song {
    QString artist, title;
    friend auto operator<=>(const Song &, const Song &) = default;
};
using Disc = std::vector<Song>;

/// A record as a person thinks of it.
struct Record {
    bool isAlbum = false;
    QString artist, title;
    std::map<int, Disc> discs; // only those with tracks
};

/// The catalogue as a person thinks of it: the records by their ids.
using Picture = std::map<qint64, Record>;

// Names that differ in nothing but case would be one for the catalogue.
const char *const artists[] = {"Anna", "Bob", "Cleo", "D'Arc", "100%1", "Édith", "Edith"};
const char *const songs[] = {"One", "Two", "Three", "It's", "_", "Fünf", "\U0001F3B5"};

} // namespace

/// Thousands of random actions in the editors, beside a picture in memory of what the catalogue
/// should hold. After each save, both must say the same, and nothing may dangle.
class tst_EditorModel : public QObject
{
    Q_OBJECT

private:
    // A new record, or one of those that there are.
    void openEditor()
    {
        QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
        mShown = {};
        qint64 id = 0;
        if (!mPicture.empty() && random(3) > 0) {
            const auto chosen = std::next(mPicture.begin(), random(int(mPicture.size())));
            id = mShown.id = chosen->first;
            mShown.record = chosen->second;
            mShown.isNew = false;
            mShown.tabs = mShown.record.discs.rbegin()->first;
        } else {
            mShown.record.isAlbum = random(2);
        }
        const QString mode = mShown.isNew ? u"I"_s : u"U"_s;
        if (mShown.record.isAlbum)
            mE->open<frmCDRootE>(mode, id);
        else
            mE->open<frmCDRoot>(mode, id);
        QCOMPARE(mE->tabs()->count(), mShown.tabs);
        showsDisc(1);
        if (mShown.isNew)
            changeHead();
    }

    void act()
    {
        using M = tst_EditorModel;
        void (M::*const actions[])() = {
            &M::addTrack,   &M::addTrack, &M::addTrack,    &M::changeTrack,    &M::removeTrack,
            &M::changeHead, &M::goToDisc, &M::addDisc,     &M::deleteDisc,     &M::saveNow,
            &M::saveNow,    &M::failOnce, &M::closeEditor, &M::deleteInBrowser};
        (this->*actions[random(int(std::size(actions)))])();
    }

    void addTrack()
    {
        const Song added = song();
        mE->addTracks(
            {mShown.record.isAlbum ? added.title : QString(added.artist + u'|' + added.title)});
        mShown.disc.push_back(added);
    }

    void changeTrack()
    {
        if (mShown.disc.empty())
            return;
        const int row = random(int(mShown.disc.size()));
        const Song changed = song();
        Song &shown = mShown.disc[std::size_t(row)];
        shown.title = changed.title;
        if (!mShown.record.isAlbum && random(2)) {
            shown.artist = changed.artist;
            mE->setCell(row + 1, 2, changed.artist);
        }
        mE->setCell(row + 1, mShown.record.isAlbum ? 2 : 3, changed.title);
    }

    void removeTrack()
    {
        if (mShown.disc.empty())
            return;
        const int row = random(int(mShown.disc.size()));
        mE->disk()->setFocus();
        mE->disk()->setCurrentRow(row + 1);
        mE->button(5)->trigger();
        mShown.disc.erase(mShown.disc.begin() + row);
    }

    void changeHead()
    {
        mShown.record.title = song().title;
        mE->field("txtTitel")->setText(mShown.record.title);
        if (!mShown.record.isAlbum)
            return;
        mShown.record.artist = song().artist;
        mE->field("txtArtiest")->setText(mShown.record.artist);
    }

    // The next save says that the record was deleted, and offers to enter it anew.
    void expectAnew()
    {
        if (mShown.isLost)
            mE->desktop.expectBox(GetMessage("xSaveAnew"), vbYes);
    }

    void goToDisc()
    {
        const int tab = random(mShown.tabs);
        if (tab == mShown.discNo - 1)
            return;
        expectAnew();
        mE->tabs()->setCurrentIndex(tab);
        shownIsSaved();
        showsDisc(tab + 1);
    }

    void showsDisc(int number)
    {
        mShown.discNo = number;
        const auto found = mShown.record.discs.find(number);
        mShown.disc = found == mShown.record.discs.end() ? Disc() : found->second;
        QCOMPARE(mE->disk()->model()->rowCount(), int(mShown.disc.size()) + 1);
    }

    void addDisc()
    {
        if (mShown.tabs == 4)
            return;
        expectAnew();
        mE->button(1)->trigger();
        shownIsSaved();
        mShown.discNo = ++mShown.tabs;
        mShown.disc.clear();
        QCOMPARE(mE->tabs()->currentIndex(), mShown.discNo - 1);
    }

    // The head is read again, and the tabs are those of the discs that there are. A record without
    // tracks is told to be gone.
    void deleteDisc()
    {
        if (mShown.tabs == 1 || mShown.isLost) {
            mE->desktop.expectBox(GetMessage(mShown.tabs == 1 ? "MsgDiscDel" : "xRecordDeleted"));
            mE->button(2)->trigger();
            compare();
            return;
        }
        const qint64 id = mE->editor->CdId;
        std::map<int, Disc> &discs = mPicture[id].discs;
        std::map<int, Disc> left;
        for (const auto &[number, disc] : discs) {
            if (number != mShown.discNo)
                left[number - (number > mShown.discNo)] = disc;
        }
        discs = left;
        if (left.empty()) {
            mPicture.erase(id);
            mE->desktop.expectBox(u"3021"_s);
        }
        mE->button(2)->trigger();
        compare();
        mShown.tabs = mE->tabs()->count();
        if (!left.empty()) {
            QCOMPARE(mShown.tabs, left.rbegin()->first);
            mShown.record = mPicture[id];
        } else {
            QCOMPARE(mShown.tabs, 1);
            mShown.record.discs.clear();
            changeHead();
        }
        showsDisc(mE->tabs()->currentIndex() + 1);
    }

    void saveNow()
    {
        expectAnew();
        if (random(2))
            mE->editor->SaveKeepingPosition();
        else
            mE->editor->SaveAtUserRequest();
        shownIsSaved();
        QVERIFY(!mE->disk()->IsChanged());
    }

    void closeEditor()
    {
        if (random(3) == 0) {
            mE->editor->findChild<QAbstractButton *>(u"cmdCancel"_s)->click();
        } else {
            expectAnew();
            mE->editor->SaveAtUserRequest();
            shownIsSaved();
            QVERIFY2(mE->editor->close(), "nothing is left to ask about");
        }
        compare();
    }

    // A save that fails half way leaves the catalogue as it was; the next one catches up.
    void failOnce()
    {
        const QStringList before = stored();
        mE->catalogue.exec("create trigger refuse before insert on CompactDiscs "
                           "begin select raise(abort, 'refused'); end");
        const int boxes = int(mE->desktop.boxes.size());
        mE->addTracks({mShown.record.isAlbum ? u"Late"_s : u"Zoe|Late"_s});
        mShown.disc.push_back({u"Zoe"_s, u"Late"_s});
        expectAnew();
        mE->desktop.expectBox(u"refused"_s);
        mE->editor->SaveAtUserRequest();
        QCOMPARE(int(mE->desktop.boxes.size()), boxes + 1 + mShown.isLost);
        mE->catalogue.exec("drop trigger refuse");
        QCOMPARE(stored(), before);
        saveNow();
    }

    // All of it comes back with the next save, under an id of its own: the old one may have been
    // given to somebody who has typed it in again.
    void deleteInBrowser()
    {
        const qint64 id = mE->editor->CdId;
        if (mShown.isNew || mShown.isLost || !mPicture.contains(id) || random(3) > 0)
            return;
        const Record before = mPicture[id];
        editors::deleteRecord(id);
        CleanOrphans();
        mPicture.erase(id);
        mShown.isLost = true;
        compare();
        if (!before.isAlbum && random(2))
            retype(id, before.title);
    }

    void retype(qint64 id, const QString &title)
    {
        const auto highest = [&](const char *table) {
            return mE->catalogue.rows(
                QString(u"select ifnull(max(ID), 0) + 1 from "_s + QLatin1String(table)))[0];
        };
        const QString zed = mE->catalogue.rows("select ID from Artiesten where Naam='Zed'")
                                .value(0, highest("Artiesten"));
        mE->catalogue.exec(u"insert or ignore into Artiesten values (%1, 'Zed'); "
                           "insert into Tracks values (%2, %1, 'Retyped %4', null, null); "
                           "insert into CDTitels values (%3, %5, null, 'V', null, null); "
                           "insert into CompactDiscs values (%6, %3, 1, 1, %2, null)"_s.arg(
                               zed, highest("Tracks"), QString::number(id),
                               QString::number(++mRetyped), quoted(title),
                               highest("CompactDiscs")));
        mPicture[id] = {false, {}, title, {{1, {{u"Zed"_s, u"Retyped %1"_s.arg(mRetyped)}}}}};
        compare();
    }

    // What the save of the disc that shows has to leave behind.
    void shownIsSaved()
    {
        Record &record = mShown.record;
        record.discs.erase(mShown.discNo);
        if (!mShown.disc.empty())
            record.discs[mShown.discNo] = mShown.disc;
        if (!mShown.isLost)
            mPicture.erase(mShown.id); // one that was without tracks gets another
        mShown.isNew = mShown.isLost = false;
        mShown.id = mE->editor->CdId;
        if (!record.discs.empty())
            mPicture[mShown.id] = record;
        compare();
    }

    void compare()
    {
        QCOMPARE(stored(), pictured());
        // The faults that there are, by name.
        QCOMPARE(mE->catalogue.rows(R"(
            select 'link without a title' from CompactDiscs where CDTitels_ID not in (select ID from CDTitels)
            union all select 'link without a track' from CompactDiscs where Track_ID not in (select ID from Tracks)
            union all select 'track without a link' from Tracks where ID not in (select Track_ID from CompactDiscs)
            union all select 'track without an artist' from Tracks where Artiest_ID not in (select ID from Artiesten)
            union all select 'title without a link' from CDTitels
                where ID not in (select CDTitels_ID from CompactDiscs)
            union all select 'artist without a use' from Artiesten where ID not in (select Artiest_ID from Tracks)
                and ID not in (select Artiest_ID from CDTitels where Artiest_ID is not null)
            union all select 'artist twice' from Artiesten group by Naam having count(*) > 1
            union all select 'track twice' from Tracks group by Artiest_ID, Titel having count(*) > 1)"),
                 QStringList());
    }

    QStringList pictured() const
    {
        QStringList lines;
        for (const auto &[id, record] : mPicture) {
            const bool isAlbum = record.isAlbum;
            for (const auto &[number, disc] : record.discs) {
                for (int track = 1; const Song &song : disc)
                    lines.append(u"%1|%2|%3|%4|%5|%6|%7"_s.arg(
                        QString::number(id), record.title, isAlbum ? record.artist : u"NULL"_s,
                        QString::number(number), QString::number(track++),
                        isAlbum ? record.artist : song.artist, song.title));
            }
        }
        return lines;
    }

    QStringList stored()
    {
        return mE->catalogue.rows(
            "select d.ID, d.Titel, b.Naam, DiskNo, TrackNo, a.Naam, t.Titel from CompactDiscs c "
            "join CDTitels d on d.ID = c.CDTitels_ID join Tracks t on t.ID = c.Track_ID "
            "join Artiesten a on a.ID = t.Artiest_ID left join Artiesten b on b.ID = d.Artiest_ID "
            "order by d.ID, DiskNo, TrackNo");
    }

    Song song()
    {
        return {QString::fromUtf8(artists[random(int(std::size(artists)))]),
                QString::fromUtf8(songs[random(int(std::size(songs)))])};
    }

    int random(int below) { return int(mRandom.bounded(below)); }

    // What the editor shows, ahead of the picture until it is saved.
    struct Shown {
        Record record;
        int discNo = 1, tabs = 1;
        Disc disc; // the one in the grid
        bool isNew = true;
        qint64 id = 0;
        bool isLost = false; // deleted in the browser
    };

    QRandomGenerator mRandom;
    std::unique_ptr<Editing> mE;
    Picture mPicture;
    Shown mShown;
    int mRetyped = 0;

private slots:
    void randomActions_data()
    {
        const DataRows<int> row("seed");
        for (const int seed : {1, 2, 3})
            row(seed);
    }

    void randomActions()
    {
        QFETCH(int, seed);
        mRandom.seed(quint32(seed));
        mE = std::make_unique<Editing>(languageEnglish);
        mPicture.clear();
        for (int i = 0; i < 800 && !QTest::currentTestFailed(); ++i) {
            if (!mE->editor || mE->editor->isUnloaded())
                openEditor();
            act();
        }
        mE.reset();
    }
};

QTEST_MAIN(tst_EditorModel)
#include "tst_EditorModel.moc"
