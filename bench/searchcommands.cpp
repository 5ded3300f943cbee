#include "collection/resultlines.h"
#include "collection/searchstatement.h"
#include "controls/sortedrows.h"
#include "measure.h"
#include "opencatalogue.h"
#include "platform/ado/connection.h"
#include "platform/ado/recordset.h"
#include "platform/desktop/desktop.h"
#include "shell/services/globals.h"
#include "shell/services/textfiles.h"
#include "workcommands.h"

#include <QFileInfo>

namespace
{

SearchKey::Mode modeOf(const QString &name)
{
    if (name == QLatin1String("full"))
        return SearchKey::FullWord;
    if (name == QLatin1String("begin"))
        return SearchKey::BeginWord;
    return name == QLatin1String("end") ? SearchKey::EndWord : SearchKey::PartWord;
}

SearchKey keyOf(const QString &mode, const QString &field, const QString &word)
{
    SearchKey key;
    key.mode = modeOf(mode);
    const bool three = field == QLatin1String("three");
    if (three || field == QLatin1String("artist"))
        key.artist = word;
    if (three || field == QLatin1String("title"))
        key.title = word;
    if (three || field == QLatin1String("genre"))
        key.genre = word;
    if (field == QLatin1String("year"))
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
            errorBox(QStringLiteral("The file could not be written."));
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
