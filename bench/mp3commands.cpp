#include "catalogue/cataloguefile.h"
#include "controls/list/DBListViewCTL.h"
#include "measure.h"
#include "mp3/collectionrows.h"
#include "mp3/collectionstore.h"
#include "mp3/frmCDRootMP3.h"
#include "mp3/rownames.h"
#include "opencatalogue.h"
#include "platform/ado/connection.h"
#include "platform/work/longwork.h"
#include "services/fileutilities.h"
#include "services/globals.h"
#include "workcommands.h"

#include <QAbstractButton>
#include <QApplication>
#include <QScrollBar>
#include <QTemporaryDir>

using namespace Qt::StringLiterals;

namespace
{

void readRows(const char *name, CollectionRows &rows, const QString &folder, Form &screen)
{
    LongWork work(screen);
    measured(name, [&] {
        const auto reading = rows.read(folder, work);
        return count("rows", rows.count()) + count("unreadable", reading.unreadable.size()) +
               count("missing", reading.allExist ? 0 : 1);
    });
}

// From the top to the end in a hundred steps, painting each; gives the longest one.
double longestStep(frmCDRootMP3 &editor)
{
    auto *list = editor.findChild<DBListViewCTL *>();
    QScrollBar *bar = list->verticalScrollBar();
    double longest = 0;
    for (int step = 0; step <= 100; ++step) {
        const Stopwatch watch;
        bar->setValue(int(qint64(bar->maximum()) * step / 100));
        list->viewport()->repaint();
        longest = std::max(longest, watch.wall());
    }
    return longest;
}

} // namespace

void readTags(const QStringList &arguments)
{
    const QTemporaryDir own;
    cataloguefile::create(own.filePath(u"catalogue"_s));
    openForWork(own.filePath(u"catalogue"_s));
    Form screen(u"tags"_s);
    const QString &folder = arguments[0];
    QStringList files;
    measured("scan", [&] {
        files = FindFilesInTree(folder, u"*.mp3"_s, 1);
        return count("files", files.size());
    });
    CollectionRows rows;
    rows.load(-1);
    rows.append(rownames::ofFound(folder, files));
    readRows("read", rows, folder, screen);
    readRows("again", rows, folder, screen);
}

void openCollection(const QStringList &arguments)
{
    openForWork(arguments[0]);
    const qint64 id = arguments[1].toLongLong();
    auto *editor = new frmCDRootMP3;
    editor->Mode = u"U"_s;
    editor->CollectionId = id;
    measured("open", [&] {
        editor->Show();
        QApplication::processEvents();
        return std::string();
    });
    measured("refresh", [&] {
        editor->RefreshAndHandleButtons();
        return std::string();
    });
    std::printf("open_kib=%ld\n", peakMemory());
    std::printf("scroll: longest=%.4f\n", longestStep(*editor));
    editor->Unload();
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
    CollectionRows rows;
    rows.load(id);
    measured("save", [&] {
        ADODB::Transaction transaction(*gConnection);
        collectionstore::replaceFiles(id, *rows.WorkingRecords->rows());
        transaction.CommitTrans();
        return count("rows", rows.count());
    });
}

void addCollection(const QStringList &arguments)
{
    openForWork(arguments[0]);
    const QString &folder = arguments[1];
    CollectionRows rows;
    rows.load(-1);
    rows.append(rownames::ofFound(folder, FindFilesInTree(folder, u"*.mp3"_s, 1)));
    measured("addcollection", [&] {
        ADODB::Transaction transaction(*gConnection);
        const qint64 id = collectionstore::insertHeader({folder, arguments[2]});
        collectionstore::replaceFiles(id, *rows.WorkingRecords->rows());
        transaction.CommitTrans();
        return count("files", rows.count());
    });
}

void renameCollection(const QStringList &arguments)
{
    openForWork(arguments[0]);
    auto *editor = new frmCDRootMP3;
    editor->Mode = u"U"_s;
    editor->CollectionId = arguments[1].toLongLong();
    editor->Show();
    QApplication::processEvents();
    editor->findChild<DBListViewCTL *>()->selectAll();
    measured("rename", [&] {
        editor->findChild<QAbstractButton *>(u"cmdRename"_s)->click();
        return std::string();
    });
    delete editor;
}
