#include "catalogue/quoting.h"
#include "measure.h"
#include "opencatalogue.h"
#include "platform/ado/recordset.h"
#include "services/fileutilities.h"
#include "services/globals.h"
#include "workcommands.h"

using namespace Qt::StringLiterals;

namespace
{

qint64 nextIdOf(const QString &table)
{
    auto rows = gConnection->Execute(u"SELECT max(ID)+1 as ID FROM "_s + table);
    const auto id = rows.Fields(0).Value();
    return id.isNull() ? 1 : id.toLong();
}

} // namespace

void addCollection(const QStringList &arguments)
{
    openForWork(arguments[0]);
    const QString &folder = arguments[1];
    measured("addcollection", [&] {
        QStringList files = FindFilesInTree(folder, u"*.mp3"_s, 1);
        files.sort();
        ADODB::Transaction transaction(*gConnection);
        const qint64 collection = nextIdOf(u"MP3Collections"_s);
        ADODB::Command head(*gConnection,
                            "insert into MP3Collections(ID,Map,Album) values (?,?,?)");
        head.Execute({collection, folder, arguments[2]});
        ADODB::Command file(
            *gConnection,
            "insert into MP3Files(ID,Volgnummer,FileName,CollectionId) values (?,?,?,?)");
        qint64 id = nextIdOf(u"MP3Files"_s);
        for (qint64 number = 1; const QString &path : std::as_const(files))
            file.Execute({id++, number++, path.sliced(folder.size() + 1), collection});
        transaction.CommitTrans();
        return count("files", files.size());
    });
}
