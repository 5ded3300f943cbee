#include "mp3/followednames.h"

#include "mp3/collectionfolder.h"
#include "platform/ado/command.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/form.h"
#include "services/globals.h"

#include <QDir>

using namespace Qt::StringLiterals;

namespace
{

// As the catalogue keeps texts, in composed letters.
QString keyOf(const QString &path)
{
    return QDir::cleanPath(path).normalized(QString::NormalizationForm_C);
}

// With its separator.
QString baseOf(const QString &folder)
{
    const QString path = keyOf(folder);
    return path.endsWith(QDir::separator()) ? path : path + QDir::separator();
}

bool holdsAny(const QString &folder, const RenamedFiles &renamed)
{
    return std::any_of(
        renamed.keyBegin(), renamed.keyEnd(),
        [base = baseOf(folder)](const QString &path) { return path.startsWith(base); });
}

void followInCollection(qint64 collection, const QString &folder, const RenamedFiles &renamed)
{
    ADODB::Command files(*gConnection, "select ID, FileName from MP3Files where CollectionId = ?");
    ADODB::Command rename(*gConnection, "update MP3Files set FileName = ? where ID = ?");
    for (auto rows = files.Execute({collection}); !rows.isEOF(); rows.MoveNext()) {
        const QString name = rows.Fields(1).Value().toText();
        const QString now = followedName(renamed, folder, name);
        if (now != name)
            rename.Execute({now, rows.Fields(0).Value()});
    }
}

void followInCatalogue(const RenamedFiles &renamed)
{
    ADODB::Transaction transaction(*gConnection);
    auto collections = gConnection->Execute(u"select ID, Map from MP3Collections"_s);
    for (; !collections.isEOF(); collections.MoveNext()) {
        const QString folder = collections.Fields(1).Value().toText();
        if (holdsAny(folder, renamed))
            followInCollection(collections.Fields(0).Value().toLong(), folder, renamed);
    }
    transaction.CommitTrans();
}

} // namespace

RenamedFiles renamedBy(const std::vector<std::pair<QString, QString>> &moves)
{
    RenamedFiles renamed, firstNames; // the latter by the names now
    for (const auto &[from, to] : moves) {
        const QString before = keyOf(from), now = keyOf(to);
        const QString first = firstNames.value(before, before);
        firstNames.remove(before);
        firstNames.insert(now, first);
        renamed.insert(first, now);
    }
    return renamed;
}

// An older catalogue may have stored "\" as the separator.
QString followedName(const RenamedFiles &renamed, const QString &folder, const QString &fileName)
{
    const QString base = baseOf(folder);
    const QString asHere = QString(fileName).replace(u'\\', QDir::separator());
    const QString now = renamed.value(keyOf(base + fileName), renamed.value(keyOf(base + asHere)));
    return now.startsWith(base) ? now.sliced(base.size()) : fileName;
}

void followNames(const RenamedFiles &renamed)
{
    if (!renamed.isEmpty())
        followInCatalogue(renamed);
    const auto forms = Form::openForms();
    for (Form *form : forms) {
        if (auto *editor = dynamic_cast<FollowsNames *>(form))
            editor->followNames(renamed);
    }
}
