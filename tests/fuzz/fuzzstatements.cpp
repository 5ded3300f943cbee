#include "catalogue/quoting.h"
#include "fuzz/fuzz.h"
#include "platform/ado/command.h"
#include "platform/ado/recordset.h"
#include "services/globals.h"
#include "support/testcatalogue.h"

namespace
{

TestCatalogue &catalogue()
{
    static TestCatalogue one;
    static const bool filled = [] {
        one.exec(u"insert into artiesten values (1,'Björk'),(2,'d''Arc');"
                 "insert into tracks values (1,1,'Jóga','Pop',1997)"_s);
        return true;
    }();
    Q_UNUSED(filled)
    return one;
}

qint64 count(const char *table)
{
    ADODB::Recordset rs;
    rs.Open(u"select count(*) from "_s + QLatin1String(table), *gConnection);
    return rs.Fields(0).Value().toLong();
}

void runStatement(const QByteArray &input)
{
    catalogue();
    const QString statement = QString::fromUtf8(input);
    ADODB::Transaction transaction(*gConnection);
    try {
        const ADODB::Recordset answer = gConnection->Execute(statement);
        if (answer.State() == ADODB::adStateOpen)
            fuzz::must(answer.RecordCount() >= 0, "rows");
    } catch (const Error &error) {
        fuzz::must(!error.Description.isEmpty(), "an error without words");
    }
    transaction.RollbackTrans();
    fuzz::must(count("artiesten") == 2 && count("tracks") == 1, "a change outlived its rollback");
}

// What a person types: quoted it comes back as it went in.
void runValue(const QByteArray &input)
{
    catalogue();
    const QString typed = QString::fromUtf8(input);
    ADODB::Transaction transaction(*gConnection);
    gConnection->Execute(u"Insert into Artiesten(ID,Naam) values (3,"_s + quoted(typed) + u')');
    ADODB::Recordset rs;
    rs.Open(u"Select Naam From Artiesten where ID = 3 and Naam = "_s + quoted(typed), *gConnection);
    fuzz::must(rs.RecordCount() == 1, "a name is not found again");
    fuzz::must(rs.Fields(0).Value().toText() == typed.normalized(QString::NormalizationForm_C),
               "a name comes back another");
    const ADODB::Value bound(typed);
    ADODB::Command search(*gConnection, "select ID from Artiesten where ID = 3 and Naam = ?");
    fuzz::must(search.find({bound}).rows == 1, "a name is another as a parameter");
    fuzz::must(count("artiesten") == 3, "a name has become a statement");
    transaction.RollbackTrans();
}

fuzz::Target statements(
    "statements",
    [] {
        return fuzz::Inputs{
            "select cdt.id as Id, art.naam as Artiest from cdtitels as cdt, artiesten as art where "
            "cdt.cd_type='E' and cdt.artiest_id=art.id order by cdt.titel asc",
            "Insert into Tracks(ID,Artiest_ID,Titel,Genre,Hitjaar) values "
            "(7,1,'it''s',\"Pop\",NULL)",
            "delete from tracks trk where not exists (select '1' from CompactDiscs where "
            "Track_ID=trk.ID)",
            "select left(art.naam,1), max(id+1) from artiesten art where "
            "iif(isnumeric(left(art.naam,1)),"
            "1,0)=1 and trim(art.naam) like '%b_r%' group by 1 having count(*)= 2 order by 1,2",
            "update tracks set Titel='x', Hitjaar=1985.5e1 where id between 1 and 2;",
            "SHAPE { select art.naam as Artiest , trk.titel as titel from artiesten as art, tracks "
            "as trk "
            "where art.id = trk.artiest_id order by 1,2 } as X compute X by Artiest, Titel",
            "select null as naam from tracks union select titel from cdtitels order by 1"};
    },
    runStatement);

fuzz::Target values(
    "values",
    [] {
        return fuzz::Inputs{"rock'n'roll", "x',1985),(51,1,'r','y", "Caf\xC3\xA9 \xF0\x9F\x8E\xB5",
                            "e\xCC\x81",   "\"q\" -- /* ; ?1 :a",   "50%2 off"};
    },
    runValue);

} // namespace
