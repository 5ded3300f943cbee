#include "mp3/collectionstore.h"

#include "catalogue/quoting.h"
#include "mp3/collectionrow.h"
#include "platform/ado/command.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"

using namespace Qt::StringLiterals;

namespace collectionstore
{

namespace
{

QString selectHeader(qint64 collection)
{
    return u"select mpc.map as Folder , mpc.album as Title from mp3collections mpc where mpc.id = "_s +
           QString::number(collection);
}

QString insertStatement(qint64 id, const Header &header)
{
    return u"INSERT INTO MP3Collections(ID,MAP,ALBUM) VALUES ("_s + QString::number(id) + u',' +
           quoted(header.folder) + u',' + quoted(header.title) + u')';
}

QString updateStatement(qint64 id, const Header &header)
{
    return u"Update MP3Collections SET MAP = "_s + quoted(header.folder) + u",    ALBUM = "_s +
           quoted(header.title) + u" WHERE ID = "_s + QString::number(id);
}

QString deleteFiles(qint64 collection)
{
    return u"DELETE FROM MP3FILES WHERE COLLECTIONID= "_s + QString::number(collection);
}

// An empty table has the number of its NULL, which is 0.
constexpr const char *highestCollection = "select max(ID) from MP3Collections";
constexpr const char *highestFile = "select max(ID) from MP3files";
constexpr const char *insertFile =
    "INSERT INTO MP3FILES(ID,VOLGNUMMER,FILENAME,COLLECTIONID) VALUES (?,?,?,?)";

qint64 nextId(const char *highest)
{
    return ADODB::Command(*gConnection, highest).find({}).id + 1;
}

} // namespace

std::optional<Header> header(qint64 collection)
{
    ADODB::Recordset row;
    row.Open(selectHeader(collection), *gConnection);
    if (row.isEOF())
        return {};
    return Header{row.Fields(u"Folder").Value().toText(), row.Fields(u"Title").Value().toText()};
}

qint64 insertHeader(const Header &header)
{
    const qint64 id = nextId(highestCollection);
    gConnection->Execute(insertStatement(id, header));
    return id;
}

void updateHeader(qint64 collection, const Header &header)
{
    gConnection->Execute(updateStatement(collection, header));
}

// The highest id is asked for once: within the transaction nobody else writes.
void replaceFiles(qint64 collection, const ADODB::Rows &rows)
{
    gConnection->Execute(deleteFiles(collection));
    qint64 id = nextId(highestFile);
    ADODB::Command insert(*gConnection, insertFile);
    for (qsizetype row = 0; row < rows.rowCount(); ++row) {
        const ADODB::Value number = rows.value(row, int(CollectionField::Volgnummer));
        const QString name = rows.text(row, int(CollectionField::FileName));
        insert.Execute({id++, number, name, collection});
    }
}

} // namespace collectionstore
