#include "collection/resultlines.h"
#include "collection/searchstatement.h"
#include "controls/list/sortedrows.h"
#include "measure.h"
#include "opencatalogue.h"
#include "platform/ado/connection.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/desktop.h"
#include "services/globals.h"
#include "services/textfiles.h"
#include "workcommands.h"

#include <QFileInfo>

using namespace Qt::StringLiterals;

namespace
{

SearchKey::Mode modeOf(const QString &name)
{
    if (name == "full"_L1)
        return SearchKey::FullWord;
    if (name == "begin"_L1)
        return SearchKey::BeginWord;
    return name == "end"_L1 ? SearchKey::EndWord : SearchKey::PartWord;
}

SearchKey keyOf(const QString &mode, const QString &field, const QString &word)
{
    SearchKey key;
    key.mode = modeOf(mode);
    const bool three = field == "three"_L1;
    if (three || field == "artist"_L1)
        key.artist = word;
    if (three || field == "title"_L1)
        key.title = word;
    if (three || field == "genre"_L1)
        key.genre = word;
    if (field == "year"_L1)
        key.firstYear = word;
    return key;
}

} // namespace

void exportAll(const QStringList &arguments)
{
    openForWork(arguments[0]);
    ADODB::Recordset found;
    measured("search", [&] {
        found.Open(searchStatement({}), *gConnection);
        return count("rows", found.RecordCount());
    });
    const auto rows = found.rows();
    std::vector<std::uint32_t> order;
    measured("sort by title", [&] {
        order = sortedRows(*rows, 1);
        return count("rows", qint64(order.size()));
    });
    measured("export", [&] {
        OutputTextFile file;
        bool written = OpenOutputFile(arguments[1], file);
        for (const auto row : order) {
            QStringList texts;
            for (int column = 0; column < rows->columnCount(); ++column)
                texts.append(rows->text(row, column));
            written = written && WriteTextLine(file, resultLine(texts));
        }
        if (!written || !CloseTextFile(file))
            errorBox(u"The file could not be written."_s);
        return count("bytes", QFileInfo(arguments[1]).size());
    });
}

void search(const QStringList &arguments)
{
    openForWork(arguments[0]);
    ADODB::Recordset found;
    measured("search", [&] {
        found.Open(searchStatement(keyOf(arguments[1], arguments[2], arguments[3])), *gConnection);
        return count("rows", found.RecordCount());
    });
}
